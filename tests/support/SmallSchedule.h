#pragma once

#include <filesystem>
#include <fstream>
#include <string>
#include <utility>
#include <vector>

namespace orvo::testing {

/// The files of a schedule of one agency, `CT` City Transit, whose lines have the given route_ids
/// in that order and short names made of them: `1` is called Line 1.
inline std::vector<std::pair<std::string, std::string>>
scheduleWithRoutes(const std::vector<std::string>& routes) {
    std::string rows = "route_id,agency_id,route_short_name,route_long_name,route_type\n";
    for (const auto& route : routes)
        rows += route + ",CT,Line " + route + ",,1\n";
    return {{"agency.txt",
             "agency_id,agency_name,agency_url,agency_timezone,agency_lang\n"
             "CT,City Transit,https://city.example,Europe/Berlin,en\n"},
            {"routes.txt", std::move(rows)}};
}

/// The same in a folder, which is made where it is not there.
inline std::filesystem::path writeSchedule(const std::filesystem::path& folder,
                                           const std::vector<std::string>& routes) {
    std::filesystem::create_directories(folder);
    for (const auto& [name, text] : scheduleWithRoutes(routes))
        std::ofstream(folder / name) << text;
    return folder;
}

} // namespace orvo::testing
