#include "orvo/window/WindowTexts.h"

#include "orvo/console/PeriodText.h"
#include "platform/foundation/LocalizedFormat.h"
#include "platform/foundation/NSBundle.h"

namespace orvo::WindowTexts {

namespace {

std::string filled(const std::string& key, const std::vector<FormatArgument>& arguments) {
    return localizedStringWithFormat(text(key), arguments);
}

std::string counted(const std::string& key, std::size_t count) {
    return filled(key, {std::uint64_t{count}});
}

} // namespace

std::string text(const std::string& key) {
    return NSBundle::mainBundle()->localizedStringForKey_value_table(key, std::nullopt, "Windows");
}

std::string text(const std::string& key, const std::string& name) {
    return filled(key, {name});
}

std::string incidents(std::size_t count) {
    return counted("Incidents", count);
}

std::string moreLines(std::size_t count) {
    return counted("MoreLines", count);
}

std::string period(std::optional<double> start,
                   std::optional<double> end,
                   double now,
                   const std::optional<std::string>& timeZone) {
    const auto at = [&](double time) {
        return PeriodText::moment(time, now, timeZone);
    };
    const bool isComing = start && *start > now;
    if (isComing && end)
        return filled("Period_FromUntil", {at(*start), at(*end)});
    if (isComing)
        return filled("Period_From", {at(*start)});
    if (start && end)
        return filled("Period_SinceUntil", {at(*start), at(*end)});
    if (start)
        return filled("Period_Since", {at(*start)});
    return end ? filled("Period_Until", {at(*end)}) : text("Period_Open");
}

} // namespace orvo::WindowTexts
