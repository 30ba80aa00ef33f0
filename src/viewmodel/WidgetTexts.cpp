#include "viewmodel/WidgetTexts.h"

#include "platform/geoservices/TransitLine.h"

#include <algorithm>

namespace orvo::WidgetTexts {

namespace {

std::string counted(const std::string& key, std::size_t count) {
    return localized(key, {std::uint64_t{count}});
}

/// Empty when the line contributes none.
std::string displayName(const TransitLine& line) {
    if (auto name = line.name(); name && !name->empty())
        return *name;
    const auto system = line.system();
    return system ? system->name().value_or("") : "";
}

std::vector<std::string> distinctNames(const std::vector<std::shared_ptr<TransitLine>>& lines) {
    std::vector<std::string> names;
    for (const auto& line : lines) {
        auto name = displayName(*line);
        if (!name.empty() && std::ranges::find(names, name) == names.end())
            names.push_back(std::move(name));
    }
    return names;
}

std::string listOfAllButLast(const std::vector<std::string>& names) {
    return localizedCommaDelimitedList({names.begin(), names.end() - 1});
}

std::string namesAlone(const std::vector<std::string>& names) {
    switch (names.size()) {
    case 1:
        return names[0];
    case 2:
        return localized("TransitWidget_2_Lines_Concatenated", {names[0], names[1]});
    default:
        return localized("TransitWidget_N_Lines_Names_Concatenated",
                         {listOfAllButLast(names), names.back()});
    }
}

std::string namesBeforeText(const std::vector<std::string>& names, const std::string& text) {
    switch (names.size()) {
    case 1:
        return localized("TransitWidget_Single_Line_Prepended_Incident_Text", {names[0], text});
    case 2:
        return localized("TransitWidget_2_Lines_Prepended_Incident_Text",
                         {names[0], names[1], text});
    default:
        return localized("TransitWidget_N_Lines_Prepended_Incident_Text",
                         {listOfAllButLast(names), names.back(), text});
    }
}

} // namespace

std::string localized(const std::string& key) {
    return NSBundle::mainBundle()->localizedStringForKey_value_table(
        key, "localized string not found", std::nullopt);
}

std::string localized(const std::string& key, const std::vector<FormatArgument>& arguments) {
    return localizedStringWithFormat(localized(key), arguments);
}

std::string noFavoritesTitle() {
    return localized("TransitWidget_NoFavoriteTransitLines_Title");
}
std::string noFavoritesSecondaryText() {
    return localized("TransitWidget_NoFavoriteTransitLines_SecondaryText");
}
std::string goodServiceTitle() {
    return localized("TransitWidget_GoodService_Title");
}
std::string goodServiceSecondaryText(std::size_t favoriteLines) {
    return counted("TransitWidget_GoodService_SecondaryText", favoriteLines);
}
std::string clearServiceSecondaryText(std::size_t clearLines) {
    return counted("TransitWidget_GoodService_Overflow_SecondaryText", clearLines);
}
std::string summaryText(std::size_t incidents) {
    return counted("TransitWidget_Summary_advisory_count", incidents);
}
std::string overflowTitle(std::size_t hiddenIncidents) {
    return counted("TransitWidget_advisory_overflow_title", hiddenIncidents);
}
std::string overflowSecondaryText(std::size_t lines) {
    return counted("TransitWidget_AdvisoriesOverflow_SecondaryText", lines);
}

std::optional<std::string>
_prependLineNames_toText(const std::vector<std::shared_ptr<TransitLine>>& lines,
                         const std::optional<std::string>& text) {
    const auto names = distinctNames(lines);
    if (names.empty())
        return text;
    return text && !text->empty() ? namesBeforeText(names, *text) : namesAlone(names);
}

} // namespace orvo::WidgetTexts
