#pragma once

#include <map>
#include <string>

namespace orvo {

/// The demonstration city's schedule: the text of each file by its name (`routes.txt`), valid from
/// the day before `written` (seconds since 1970) for a year. `timeZone` is an IANA name.
[[nodiscard]] std::map<std::string, std::string> demoSchedule(double written,
                                                              const std::string& timeZone);

} // namespace orvo
