#include "orvo/console/Arguments.h"

#include "platform/foundation/EditDistance.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <fmt/ranges.h>
#include <utility>

namespace orvo {

bool Arguments::has(std::string_view option) const {
    return _options.find(option) != _options.end();
}

std::optional<std::string> Arguments::value(std::string_view option) const {
    const auto [first, last] = _options.equal_range(option);
    if (first == last)
        return std::nullopt;
    return std::prev(last)->second;
}

std::vector<std::string> Arguments::values(std::string_view option) const {
    std::vector<std::string> values;
    const auto [first, last] = _options.equal_range(option);
    for (auto it = first; it != last; ++it)
        values.push_back(it->second);
    return values;
}

std::optional<std::string> Arguments::operand(std::size_t index) const {
    return index < _operands.size() ? std::optional(_operands[index]) : std::nullopt;
}

namespace {

/// No option begins with a digit: `-33.9,-70.1` is a place.
bool looksLikeOption(std::string_view word) {
    return word.size() > 1 && word[0] == '-' && word[1] != '.' &&
           !(word[1] >= '0' && word[1] <= '9');
}

/// One pass over the words of a command line.
class Reading {
public:
    Reading(const CommandSpec& command,
            const std::string& program,
            const std::vector<std::string>& words)
        : _command(command)
        , _program(program)
        , _words(words) {
        _options = command.options;
        _options.insert(_options.end(), globalOptions().begin(), globalOptions().end());
    }

    std::optional<UsageError> read() {
        bool onlyOperands = false;
        while (_next < _words.size()) {
            const std::string& word = _words[_next++];
            if (!onlyOperands && word == "--") {
                onlyOperands = true;
            } else if (!onlyOperands && looksLikeOption(word)) {
                if (auto error = readOption(word))
                    return error;
            } else {
                _operands.push_back(word);
            }
        }
        if (isGiven("help"))
            return std::nullopt;
        if (auto error = checkOperands())
            return error;
        for (const auto& option : _options) {
            if (option.isRequired && !isGiven(option.name))
                return UsageError{fmt::format("--{} is missing", option.name),
                                  fmt::format("Write --{} {}.", option.name, option.value)};
        }
        return std::nullopt;
    }

    /// Options with their values, in the order in which they were given.
    using Given = std::vector<std::pair<std::string, std::string>>;
    [[nodiscard]] const Given& given() const noexcept { return _given; }
    [[nodiscard]] const std::vector<std::string>& operands() const noexcept { return _operands; }

private:
    /// A program of one command has no word for it.
    [[nodiscard]] std::string withProgram(const std::string& rest) const {
        return _program + (_command.path.empty() ? "" : " ") + rest;
    }

    [[nodiscard]] bool isGiven(std::string_view name) const {
        return std::ranges::any_of(_given, [&](const auto& one) { return one.first == name; });
    }

    std::optional<UsageError> readOption(const std::string& word) {
        const std::size_t equals = word.find('=');
        const std::string name =
            word == "-h" ? "help"
                         : word.substr(2, equals == std::string::npos ? equals : equals - 2);
        const bool isLong = word == "-h" || word.rfind("--", 0) == 0;
        const auto found = isLong ? matching(name) : std::vector<const OptionSpec*>{};
        if (found.size() != 1)
            return unknownOption(word.substr(0, equals), name, found);
        const OptionSpec& option = *found.front();
        if (option.value.empty()) {
            if (equals != std::string::npos)
                return UsageError{fmt::format("--{} takes no value", option.name), ""};
            _given.emplace_back(option.name, "");
            return std::nullopt;
        }
        if (equals != std::string::npos)
            return take(option, word.substr(equals + 1));
        if (_next == _words.size() || looksLikeOption(_words[_next]))
            return UsageError{fmt::format("--{} needs a value", option.name),
                              fmt::format("Write --{} {}.", option.name, option.value)};
        do {
            if (auto error = take(option, _words[_next++]))
                return error;
        } while (option.takesSeveral && _next < _words.size() && !looksLikeOption(_words[_next]));
        return std::nullopt;
    }

    std::optional<UsageError> take(const OptionSpec& option, const std::string& value) {
        if (option.completes == Completes::Word && std::ranges::count(option.words, value) == 0)
            return UsageError{fmt::format("--{} cannot be {}", option.name, value),
                              fmt::format("Choose one of {}.", fmt::join(option.words, ", "))};
        if (isGiven(option.name) && !option.takesSeveral)
            return UsageError{fmt::format("--{} is given twice", option.name), ""};
        _given.emplace_back(option.name, value);
        return std::nullopt;
    }

    [[nodiscard]] std::vector<const OptionSpec*> matching(const std::string& name) const {
        std::vector<const OptionSpec*> found;
        for (const auto& option : _options) {
            if (option.name == name)
                return {&option};
            if (!name.empty() && option.name.rfind(name, 0) == 0)
                found.push_back(&option);
        }
        return found;
    }

    [[nodiscard]] UsageError unknownOption(const std::string& given,
                                           const std::string& name,
                                           const std::vector<const OptionSpec*>& found) const {
        if (found.size() > 1) {
            std::vector<std::string> names;
            names.reserve(found.size());
            for (const auto* option : found)
                names.push_back("--" + option->name);
            return {fmt::format("{} may mean several options", given),
                    fmt::format("Choose one of {}.", fmt::join(names, ", "))};
        }
        std::vector<std::string> names;
        for (const auto& option : _options)
            names.push_back(option.name);
        const auto meant = nearest(name, names);
        return {fmt::format("there is no option {}", given),
                meant ? fmt::format("Did you mean --{}?", *meant)
                      : fmt::format("See: {} --help", withProgram(_command.name()))};
    }

    [[nodiscard]] std::optional<UsageError> checkOperands() const {
        std::size_t least = 0;
        bool unlimited = false;
        for (const auto& operand : _command.operands) {
            const bool mayBeMissing = operand.count == OperandSpec::Count::Optional ||
                                      operand.count == OperandSpec::Count::Any;
            least += mayBeMissing ? 0 : 1;
            unlimited = unlimited || operand.count == OperandSpec::Count::OneOrMore ||
                        operand.count == OperandSpec::Count::Any;
        }
        const std::string cure = fmt::format("Usage: {}", withProgram(_command.usage()));
        if (_operands.size() < least)
            return UsageError{
                fmt::format("{} is missing", _command.operands[_operands.size()].name), cure};
        if (!unlimited && _operands.size() > _command.operands.size())
            return UsageError{
                fmt::format("\"{}\" is one word too many", _operands[_command.operands.size()]),
                cure};
        for (std::size_t i = 0; i < std::min(_operands.size(), _command.operands.size()); ++i) {
            const auto& operand = _command.operands[i];
            if (operand.completes == Completes::Word && !operand.words.empty() &&
                std::ranges::count(operand.words, _operands[i]) == 0)
                return UsageError{fmt::format("{} cannot be \"{}\"", operand.name, _operands[i]),
                                  fmt::format("Choose one of {}.", fmt::join(operand.words, ", "))};
        }
        return std::nullopt;
    }

    const CommandSpec& _command;
    const std::string& _program;
    const std::vector<std::string>& _words;
    std::vector<OptionSpec> _options;
    Given _given;
    std::vector<std::string> _operands;
    std::size_t _next = 0;
};

} // namespace

std::variant<Arguments, UsageError>
ArgumentParser::parse(const std::vector<std::string>& words) const {
    Reading reading(_command, _program, words);
    if (auto error = reading.read())
        return *error;
    Arguments arguments;
    for (const auto& [name, value] : reading.given())
        arguments._options.emplace(name, value);
    arguments._operands = reading.operands();
    return arguments;
}

std::optional<std::string> nearest(std::string_view word,
                                   const std::vector<std::string>& candidates) {
    const auto letters = Text::utf16(word);
    std::optional<std::string> best;
    std::size_t bestDistance = std::max<std::size_t>(1, letters.size() / 3) + 1;
    for (const auto& candidate : candidates) {
        const bool begins = word.size() > 1 && candidate.rfind(word, 0) == 0;
        const std::size_t distance = begins ? 1 : editDistance(letters, Text::utf16(candidate));
        if (distance < bestDistance) {
            bestDistance = distance;
            best = candidate;
        }
    }
    return best;
}

} // namespace orvo
