#pragma once

#include "orvo/console/CommandSpec.h"

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

namespace orvo {

/// A command line that does not follow its command's specification.
struct UsageError {
    std::string message; ///< what is wrong, without a full stop
    std::string cure;    ///< what to do, a sentence; may be empty
};

/// What a person gave to one command.
class Arguments {
public:
    [[nodiscard]] bool has(std::string_view option) const;
    /// The last one given. Nothing when the option was not given.
    [[nodiscard]] std::optional<std::string> value(std::string_view option) const;
    /// In the order given.
    [[nodiscard]] std::vector<std::string> values(std::string_view option) const;
    [[nodiscard]] const std::vector<std::string>& operands() const noexcept { return _operands; }
    /// The operand at that place, or nothing.
    [[nodiscard]] std::optional<std::string> operand(std::size_t index) const;

private:
    friend class ArgumentParser;
    std::multimap<std::string, std::string, std::less<>> _options;
    std::vector<std::string> _operands;
};

/// Reads words as one command's arguments, global options included. `--name=value` and
/// `--name value` are the same; `--` ends the options; an option may be shortened as long as it is
/// clear which is meant. A value may begin with a dash only after `=`.
class ArgumentParser {
public:
    /// `program`: what to type for the program, in cures.
    explicit ArgumentParser(const CommandSpec& command, std::string program = "orvo")
        : _command(command)
        , _program(std::move(program)) {}

    [[nodiscard]] std::variant<Arguments, UsageError>
    parse(const std::vector<std::string>& words) const;

private:
    const CommandSpec& _command;
    std::string _program;
};

/// The one of `candidates` that was probably meant by `word`, or nothing when none is near.
[[nodiscard]] std::optional<std::string> nearest(std::string_view word,
                                                 const std::vector<std::string>& candidates);

} // namespace orvo
