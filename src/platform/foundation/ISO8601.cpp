#include "platform/foundation/ISO8601.h"

#include <chrono>
#include <cmath>
#include <fmt/format.h>

namespace orvo::ISO8601 {

namespace {

/// Reads from the front of a text; every step answers whether it fitted.
class Scanner {
public:
    explicit Scanner(std::string_view text)
        : _rest(text) {}

    [[nodiscard]] bool atEnd() const { return _rest.empty(); }

    bool accept(char c) {
        if (_rest.empty() || _rest.front() != c)
            return false;
        _rest.remove_prefix(1);
        return true;
    }

    bool digits(std::size_t count, int& value) {
        if (_rest.size() < count)
            return false;
        int read = 0;
        for (std::size_t i = 0; i < count; ++i) {
            if (_rest[i] < '0' || _rest[i] > '9')
                return false;
            read = read * 10 + (_rest[i] - '0');
        }
        _rest.remove_prefix(count);
        value = read;
        return true;
    }

    bool fraction(double& value) {
        double unit = 0.1;
        bool any = false;
        for (; !_rest.empty() && _rest.front() >= '0' && _rest.front() <= '9'; unit /= 10) {
            value += unit * (_rest.front() - '0');
            _rest.remove_prefix(1);
            any = true;
        }
        return any;
    }

private:
    std::string_view _rest;
};

/// Seconds east of UTC.
std::optional<int> parseZone(Scanner& scanner) {
    if (scanner.atEnd() || scanner.accept('Z') || scanner.accept('z'))
        return 0;
    const bool east = scanner.accept('+');
    if (!east && !scanner.accept('-'))
        return std::nullopt;
    int hours = 0;
    int minutes = 0;
    if (!scanner.digits(2, hours))
        return std::nullopt;
    const bool colon = scanner.accept(':');
    if ((colon || !scanner.atEnd()) && !scanner.digits(2, minutes))
        return std::nullopt;
    if (hours > 23 || minutes > 59)
        return std::nullopt;
    return (east ? 1 : -1) * (hours * 3600 + minutes * 60);
}

} // namespace

std::string string(double secondsSince1970) {
    using namespace std::chrono;
    constexpr double firstSecond = -62167219200.0; // 0000-01-01
    constexpr double endSecond = 253402300800.0;   // 10000-01-01
    if (!(secondsSince1970 >= firstSecond && secondsSince1970 < endSecond))
        return fmt::format("{}", secondsSince1970);
    const sys_seconds moment{seconds{static_cast<std::int64_t>(std::floor(secondsSince1970))}};
    const auto day = floor<days>(moment);
    const year_month_day date{day};
    const hh_mm_ss time{moment - day};
    return fmt::format("{:04}-{:02}-{:02}T{:02}:{:02}:{:02}Z",
                       static_cast<int>(date.year()),
                       static_cast<unsigned>(date.month()),
                       static_cast<unsigned>(date.day()),
                       time.hours().count(),
                       time.minutes().count(),
                       time.seconds().count());
}

std::optional<double> parse(std::string_view text) {
    using namespace std::chrono;
    Scanner scanner(text);
    int y = 0;
    int m = 0;
    int d = 0;
    if (!scanner.digits(4, y) || !scanner.accept('-') || !scanner.digits(2, m) ||
        !scanner.accept('-') || !scanner.digits(2, d))
        return std::nullopt;
    const year_month_day date{
        year{y}, month{static_cast<unsigned>(m)}, day{static_cast<unsigned>(d)}};
    if (!date.ok())
        return std::nullopt;
    const auto midnight = static_cast<double>(sys_days{date}.time_since_epoch().count()) * 86400.0;
    if (scanner.atEnd())
        return midnight;
    if (!scanner.accept('T') && !scanner.accept('t') && !scanner.accept(' '))
        return std::nullopt;
    int hours = 0;
    int minutes = 0;
    int wholeSeconds = 0;
    double fraction = 0;
    if (!scanner.digits(2, hours) || !scanner.accept(':') || !scanner.digits(2, minutes))
        return std::nullopt;
    if (scanner.accept(':')) {
        if (!scanner.digits(2, wholeSeconds))
            return std::nullopt;
        if (scanner.accept('.') && !scanner.fraction(fraction))
            return std::nullopt;
    }
    const auto zone = parseZone(scanner);
    if (!zone || !scanner.atEnd() || hours > 23 || minutes > 59 || wholeSeconds > 59)
        return std::nullopt;
    return midnight + hours * 3600 + minutes * 60 + wholeSeconds + fraction - *zone;
}

} // namespace orvo::ISO8601
