#include "platform/foundation/LogSettings.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr std::array LevelNames = {"debug", "info", "default", "error", "fault"};

std::optional<LogLevel> levelNamed(std::string_view name) {
    const auto* const found = std::ranges::find(LevelNames, name);
    if (found == LevelNames.end())
        return std::nullopt;
    return static_cast<LogLevel>(found - LevelNames.begin());
}

} // namespace

LogSettings LogSettings::parse(std::string_view text) {
    LogSettings settings;
    while (!text.empty()) {
        const auto comma = std::min(text.find(','), text.size());
        const auto part = text.substr(0, comma);
        text.remove_prefix(std::min(comma + 1, text.size()));
        const auto equals = part.rfind('=');
        const bool named = equals != std::string_view::npos;
        const auto level = levelNamed(named ? part.substr(equals + 1) : part);
        if (level)
            settings.levels.emplace_back(named ? part.substr(0, equals) : "*", *level);
        else if (part == "private")
            settings.showsPrivate = true;
        else if (!part.empty())
            settings.problems.push_back(fmt::format(
                "ORVO_LOG: '{}' is neither 'private' nor CATEGORY=LEVEL with one of the "
                "levels {}",
                part,
                fmt::join(LevelNames, ", ")));
    }
    return settings;
}

const LogSettings& LogSettings::ofProcess() {
    static const auto& settings = *new LogSettings([] {
        const char* text = std::getenv("ORVO_LOG");
        return parse(text ? text : "");
    }());
    return settings;
}

LogLevel LogSettings::least(const std::vector<std::pair<std::string, LogLevel>>& levels,
                            std::string_view category) {
    auto ofCategory = LogLevel::Default;
    auto ofOthers = LogLevel::Default;
    bool found = false;
    for (const auto& [name, level] : levels) {
        if (name == category) {
            ofCategory = level;
            found = true;
        } else if (name == "*") {
            ofOthers = level;
        }
    }
    return found ? ofCategory : ofOthers;
}

const char* nameOf(LogLevel level) {
    return LevelNames.at(static_cast<std::size_t>(level));
}

} // namespace orvo
