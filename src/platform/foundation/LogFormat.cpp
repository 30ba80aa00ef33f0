#include "platform/foundation/LogFormat.h"

#include <algorithm>
#include <fmt/printf.h>
#include <optional>

namespace orvo {

namespace {

constexpr std::string_view Conversions = "@sdiuoxXcpfFeEgGaA";
constexpr int WidestField = 1000;

/// One `%…` of a format.
struct Placeholder {
    bool isPrivate = false;
    std::string flags;
    std::optional<int> width;
    std::optional<int> precision;
    char conversion = 0;

    /// In the form that the formatting library reads.
    [[nodiscard]] std::string as(char kind) const {
        std::string text = "%" + flags;
        if (width)
            text += std::to_string(*width);
        if (precision)
            text += "." + std::to_string(*precision);
        return text + kind;
    }
};

class Formatter {
public:
    Formatter(std::string_view format, std::span<const LogArgument> arguments)
        : _rest(format)
        , _arguments(arguments) {}

    LogText run() {
        while (!_rest.empty()) {
            const auto percent = std::min(_rest.find('%'), _rest.size());
            appendBoth(_rest.substr(0, percent));
            _rest.remove_prefix(percent);
            if (!_rest.empty())
                placeholder();
        }
        return std::move(_text);
    }

private:
    void placeholder() {
        const auto whole = _rest;
        const auto restOfArguments = _arguments;
        _rest.remove_prefix(1);
        if (accept('%'))
            return appendBoth("%");
        Placeholder holder;
        if (!readAnnotations(holder) || !readConversion(holder)) {
            // Not of the language: it stands as it is.
            _arguments = restOfArguments;
            _rest = whole.substr(1);
            return appendBoth("%");
        }
        const auto value = nextValue(holder);
        _text.message += value;
        _text.redacted += holder.isPrivate ? "<private>" : value;
    }

    /// `{public, …}`
    bool readAnnotations(Placeholder& holder) {
        if (!accept('{'))
            return true;
        const auto end = _rest.find('}');
        if (end == std::string_view::npos)
            return false;
        auto list = _rest.substr(0, end);
        _rest.remove_prefix(end + 1);
        while (!list.empty()) {
            const auto comma = std::min(list.find(','), list.size());
            auto word = list.substr(0, comma);
            list.remove_prefix(std::min(comma + 1, list.size()));
            while (word.starts_with(' '))
                word.remove_prefix(1);
            while (word.ends_with(' '))
                word.remove_suffix(1);
            holder.isPrivate |= word == "private" || word == "sensitive";
        }
        return true;
    }

    void readNumbers(Placeholder& holder) {
        while (!_rest.empty() &&
               std::string_view("-+ #0").find(_rest.front()) != std::string_view::npos) {
            if (holder.flags.find(_rest.front()) == std::string::npos)
                holder.flags += _rest.front();
            _rest.remove_prefix(1);
        }
        holder.width = number();
        if (holder.width && *holder.width < 0) {
            holder.flags += '-';
            holder.width = -*holder.width;
        }
        if (accept('.')) {
            holder.precision = number().value_or(0);
            if (*holder.precision < 0)
                holder.precision.reset();
        }
    }

    bool readConversion(Placeholder& holder) {
        readNumbers(holder);
        while (!_rest.empty() &&
               std::string_view("hlqjztL").find(_rest.front()) != std::string_view::npos)
            _rest.remove_prefix(1); // the values know their own sizes
        if (_rest.empty() || Conversions.find(_rest.front()) == std::string_view::npos)
            return false;
        holder.conversion = _rest.front();
        _rest.remove_prefix(1);
        return true;
    }

    /// Digits, or `*` for the next value.
    std::optional<int> number() {
        if (accept('*')) {
            if (_arguments.empty())
                return std::nullopt;
            const auto value = _arguments.front().value();
            _arguments = _arguments.subspan(1);
            const auto* number = std::get_if<std::int64_t>(&value);
            return number ? std::optional(static_cast<int>(
                                std::clamp<std::int64_t>(*number, -WidestField, WidestField)))
                          : std::nullopt;
        }
        std::optional<int> number;
        for (; !_rest.empty() && _rest.front() >= '0' && _rest.front() <= '9';
             _rest.remove_prefix(1))
            number = std::min(number.value_or(0) * 10 + (_rest.front() - '0'), WidestField);
        return number;
    }

    std::string nextValue(const Placeholder& holder) {
        if (_arguments.empty())
            return "(missing)";
        const auto value = _arguments.front().value();
        _arguments = _arguments.subspan(1);
        return std::visit([&](auto plain) { return text(holder, plain); }, value);
    }

    static bool isFractional(char conversion) {
        return std::string_view("fFeEgGaA").find(conversion) != std::string_view::npos;
    }

    template <class Integer>
    requires std::is_integral_v<Integer>
    static std::string text(const Placeholder& holder, Integer value) {
        switch (holder.conversion) {
        case 'x':
        case 'X':
        case 'o':
            return fmt::sprintf(holder.as(holder.conversion), static_cast<std::uint64_t>(value));
        case 'p':
            return fmt::sprintf("%#x", static_cast<std::uint64_t>(value));
        case 'c':
            return text(holder, std::string_view(std::string(1, static_cast<char>(value))));
        case '@':
        case 's':
            return fmt::format("{}", value);
        default:
            break;
        }
        Placeholder whole = holder;
        if (isFractional(holder.conversion))
            whole.precision.reset(); // it was meant for digits after the point
        return fmt::sprintf(whole.as(std::is_signed_v<Integer> ? 'd' : 'u'), value);
    }

    static std::string text(const Placeholder& holder, double value) {
        if (isFractional(holder.conversion))
            return fmt::sprintf(holder.as(holder.conversion), value);
        return fmt::format("{}", value);
    }

    static std::string text(const Placeholder& holder, std::string_view value) {
        Placeholder plain = holder;
        std::erase_if(plain.flags, [](char flag) { return flag != '-'; });
        if (holder.conversion != 's' && holder.conversion != '@')
            plain.precision.reset();
        return fmt::sprintf(plain.as('s'), value);
    }

    static std::string text(const Placeholder& holder, const NSObject* value) {
        if (holder.conversion == 'p')
            return fmt::format("{}", static_cast<const void*>(value));
        return text(holder, std::string_view(descriptionOf(value)));
    }

    bool accept(char c) {
        if (!_rest.starts_with(c))
            return false;
        _rest.remove_prefix(1);
        return true;
    }

    void appendBoth(std::string_view plain) {
        _text.message += plain;
        _text.redacted += plain;
    }

    std::string_view _rest;
    std::span<const LogArgument> _arguments;
    LogText _text;
};

} // namespace

LogText formatLog(std::string_view format, std::span<const LogArgument> arguments) {
    return Formatter(format, arguments).run();
}

} // namespace orvo
