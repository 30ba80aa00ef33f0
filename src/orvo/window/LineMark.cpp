#include "orvo/window/LineMark.h"

#include "orvo/console/DisplayText.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/mapuikit/IconManager.h"

namespace orvo {

namespace {

std::string textOn(const std::shared_ptr<TransitArtworkDataSource>& artwork) {
    const auto shield = artwork ? IconManager::shieldOfArtwork(*artwork) : nullptr;
    return DisplayText::oneLine(shield ? shield->shieldText().value_or("") : "");
}

std::string titleOf(const ScheduleLine& line) {
    return DisplayText::oneLine(line.longName.empty() ? line.name() : line.longName);
}

} // namespace

LineMark LineMark::ofLine(const TransitLine& line, const ScheduleStore* schedules) {
    LineMark mark;
    mark.muid = line.muid();
    mark.name = DisplayText::oneLine(line.name().value_or(""));
    mark.title = mark.name;
    mark.detail = DisplayText::oneLine(line.system() ? line.system()->name().value_or("") : "");
    mark.systemArtwork = line.system() ? line.system()->artwork() : nullptr;
    mark.artwork = line.alternateArtwork() ? line.alternateArtwork() : line.artwork();
    if (const auto known = schedules ? schedules->line(mark.muid) : std::nullopt) {
        mark.title = titleOf(*known);
        if (textOn(mark.artwork).empty())
            mark.artwork = makeTransitLine(*known)->alternateArtwork();
    }
    if (textOn(mark.artwork).empty())
        mark.artwork = nullptr;
    return mark;
}

LineMark LineMark::ofLine(const ScheduleLine& line) {
    auto mark = ofLine(*makeTransitLine(line), nullptr);
    mark.title = titleOf(line);
    return mark;
}

std::string LineMark::shieldText() const {
    return textOn(artwork);
}

std::string LineMark::pictureText() const {
    return textOn(picture());
}

std::string LineMark::spoken() const {
    std::string text;
    const std::string* before = nullptr;
    for (const std::string* part : {&name, &title, &detail}) {
        if (part->empty() || (before && *before == *part))
            continue;
        text += (text.empty() ? "" : ", ") + *part;
        before = part;
    }
    return text;
}

} // namespace orvo
