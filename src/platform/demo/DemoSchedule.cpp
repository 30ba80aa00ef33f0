#include "platform/demo/DemoSchedule.h"

#include "platform/demo/DemoCity.h"
#include "platform/foundation/ISO8601.h"

#include <fmt/format.h>

namespace orvo {

namespace {

constexpr double Day = 24 * 3600;

/// `20250615`, as schedules write dates.
std::string date(double time) {
    const std::string iso = ISO8601::string(time);
    return iso.substr(0, 4) + iso.substr(5, 2) + iso.substr(8, 2);
}

std::string routes() {
    std::string text = "route_id,agency_id,route_short_name,route_long_name,route_type,route_color,"
                       "route_text_color,route_sort_order\n";
    int order = 0;
    for (const auto& line : DemoCity::lines())
        text += fmt::format("{},{},{},{},{},{},{},{}\n",
                            line.routeId,
                            line.agencyId,
                            line.shortName,
                            line.longName,
                            line.routeType,
                            line.color,
                            line.textColor,
                            ++order);
    return text;
}

std::string translations() {
    std::string text = "table_name,field_name,language,translation,record_id\n";
    for (const auto& line : DemoCity::lines())
        text += fmt::format("routes,route_long_name,de,{},{}\n", line.germanLongName, line.routeId);
    return text;
}

/// One trip a line and direction is enough to tell which lines serve a stop.
std::string trips() {
    std::string text = "route_id,service_id,trip_id,direction_id\n";
    for (const auto& line : DemoCity::lines())
        text += fmt::format("{0},daily,{0}-out,0\n", line.routeId);
    return text;
}

std::string stopTimes() {
    std::string text = "trip_id,arrival_time,departure_time,stop_id,stop_sequence\n";
    for (const auto& line : DemoCity::lines()) {
        int minute = 0;
        for (const auto& stop : line.stopIds) {
            text += fmt::format("{0}-out,08:{1:02}:00,08:{1:02}:00,{2},{3}\n",
                                line.routeId,
                                minute,
                                stop,
                                minute / 5 + 1);
            minute += 5;
        }
    }
    return text;
}

} // namespace

std::map<std::string, std::string> demoSchedule(double written, const std::string& timeZone) {
    const std::string first = date(written - Day);
    const std::string last = date(written + 365 * Day);
    std::string agencies = "agency_id,agency_name,agency_url,agency_timezone,agency_lang\n";
    for (const auto& agency : DemoCity::agencies())
        agencies += fmt::format("{},{},{},{},en\n", agency.id, agency.name, agency.url, timeZone);
    std::string stops = "stop_id,stop_name,stop_lat,stop_lon\n";
    for (const auto& stop : DemoCity::stops())
        stops +=
            fmt::format("{},{},{:.4f},{:.4f}\n", stop.id, stop.name, stop.latitude, stop.longitude);
    return {
        {"agency.txt", agencies},
        {"routes.txt", routes()},
        {"stops.txt", stops},
        {"trips.txt", trips()},
        {"stop_times.txt", stopTimes()},
        {"translations.txt", translations()},
        {"calendar.txt",
         fmt::format("service_id,monday,tuesday,wednesday,thursday,friday,saturday,sunday,start_"
                     "date,end_date\ndaily,1,1,1,1,1,1,1,{},{}\n",
                     first,
                     last)},
        {"feed_info.txt",
         fmt::format("feed_publisher_name,feed_publisher_url,feed_lang,feed_start_date,feed_end_"
                     "date,feed_version\nMarrow Bay,https://mbt.example,en,{},{},demonstration\n",
                     first,
                     last)},
    };
}

} // namespace orvo
