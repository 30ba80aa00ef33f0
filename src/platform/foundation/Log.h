#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <array>
#include <atomic>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>
#include <vector>

namespace orvo {

enum class LogLevel { Debug, Info, Default, Error, Fault };

/// One value of a log line: a number, text, or an object, each of the last two possibly nil. It
/// refers to what it was made from and is read only while the line is written, so that a line that
/// nobody wants costs nothing. Made in passing, so no constructor is explicit.
class LogArgument {
public:
    using Value =
        std::variant<std::int64_t, std::uint64_t, double, std::string_view, const NSObject*>;

    // NOLINTBEGIN(google-explicit-constructor)
    template <class T>
    requires std::is_integral_v<T> LogArgument(T value) {
        if constexpr (std::is_signed_v<T>)
            _value = static_cast<std::int64_t>(value);
        else
            _value = static_cast<std::uint64_t>(value);
    }
    template <class T>
    requires std::is_enum_v<T> LogArgument(T value)
        : LogArgument(static_cast<std::underlying_type_t<T>>(value)) {}
    LogArgument(double value)
        : _value(value) {}
    LogArgument(std::string_view text)
        : _value(text) {}
    LogArgument(const std::string& text)
        : _value(std::string_view(text)) {}
    LogArgument(const char* text) {
        if (text)
            _value = std::string_view(text);
    }
    LogArgument(const std::optional<std::string>& text) {
        if (text)
            _value = std::string_view(*text);
    }
    LogArgument(std::nullptr_t) {}
    LogArgument(const NSObject* object)
        : _value(object) {}
    template <class T>
    LogArgument(const std::shared_ptr<T>& object)
        : _value(static_cast<const NSObject*>(object.get())) {}
    // NOLINTEND(google-explicit-constructor)

    [[nodiscard]] const Value& value() const noexcept { return _value; }

private:
    Value _value = static_cast<const NSObject*>(nullptr);
};

/// A line as it was logged.
struct LogRecord {
    LogLevel level;
    std::string subsystem;
    std::string category;
    std::string format;
    std::string message;  ///< with every value
    std::string redacted; ///< values marked `%{private}` as `<private>`
};

/// Takes the lines. Any thread.
using LogSink = std::function<void(const LogRecord&)>;

/// The unified log of one subsystem and category. Formats are the platform's: `%@` (an object or
/// text), `%d` `%i` `%u` `%lu` `%ld` `%llu` `%lld` `%x` `%o`, `%s`, `%f` `%.2f` `%g` `%e`, `%c`,
/// `%p`, `%%`, with flags, width and precision, each also as `%{private}@` or `%{public}@`. A value
/// that is missing prints as `(missing)`, one of the wrong kind as what it is, and one too many not
/// at all. Any thread.
class Log {
public:
    static constexpr const char* DefaultSubsystem = "com.zentu.Orvo";

    /// The same object for the same subsystem and category, made when first asked for.
    [[nodiscard]] static std::shared_ptr<Log>
    findOrCreate(const std::string& category, const std::string& subsystem = DefaultSubsystem);

    /// Where lines go. Default: the system journal; standard error where `ORVO_LOG` says anything,
    /// unless that is connected to the journal. Private values are redacted, unless `ORVO_LOG`
    /// names `private`.
    static EnvironmentSlot<LogSink>& sink();
    /// The least level written, by category; `*` is every other category. Default: from `ORVO_LOG`,
    /// as `TransitWidget=debug,Result=error,*=info`; without it nothing below `Default`. A change
    /// holds at once.
    static EnvironmentSlot<std::vector<std::pair<std::string, LogLevel>>>& levels();

    Log(std::string subsystem, std::string category);

    [[nodiscard]] const std::string& category() const noexcept { return _category; }
    [[nodiscard]] const std::string& subsystem() const noexcept { return _subsystem; }
    /// Costs two atomic reads.
    [[nodiscard]] bool isEnabled(LogLevel level) const;

    template <class... Arguments>
    void debug(const char* format, const Arguments&... arguments) const {
        write(LogLevel::Debug, format, arguments...);
    }
    template <class... Arguments>
    void info(const char* format, const Arguments&... arguments) const {
        write(LogLevel::Info, format, arguments...);
    }
    template <class... Arguments>
    void error(const char* format, const Arguments&... arguments) const {
        write(LogLevel::Error, format, arguments...);
    }
    template <class... Arguments>
    void fault(const char* format, const Arguments&... arguments) const {
        write(LogLevel::Fault, format, arguments...);
    }
    template <class... Arguments>
    void write(LogLevel level, const char* format, const Arguments&... arguments) const {
        if (!isEnabled(level))
            return;
        const std::array<LogArgument, sizeof...(Arguments)> values{LogArgument(arguments)...};
        emit(level, format, values);
    }

private:
    void
    emit(LogLevel level, std::string_view format, std::span<const LogArgument> arguments) const;

    std::string _subsystem;
    std::string _category;
    mutable std::atomic<std::uint64_t> _leastLevel = 0;
};

} // namespace orvo
