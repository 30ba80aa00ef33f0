#include "print/WidgetDump.h"

#include "platform/extension/WidgetCard.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSUserDefaults.h"
#include "platform/foundation/PropertyList.h"
#include "platform/uikit/ViewDumps.h"
#include "print/WidgetScene.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "widget/OWTransitIncidentsViewController.h"

#include <algorithm>
#include <fmt/format.h>
#include <vector>

namespace orvo::WidgetDump {

namespace {

constexpr std::size_t IndentPerLevel = 2;

void append(std::string& text, const std::shared_ptr<NSObject>& object, std::size_t indent) {
    const std::string margin(indent, ' ');
    if (const auto array = std::dynamic_pointer_cast<NSArray>(object)) {
        text += "(\n";
        std::size_t index = 0;
        for (const auto& element : typed<NSObject>(array)) {
            text += fmt::format("{}  {}: ", margin, index++);
            append(text, element, indent + IndentPerLevel);
        }
        text += margin + ")\n";
        return;
    }
    if (const auto dictionary = std::dynamic_pointer_cast<NSDictionary>(object)) {
        std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries;
        for (const auto& [key, value] : dictionary->entries())
            entries.emplace_back(key->description(), value);
        std::ranges::sort(entries, {}, [](const auto& entry) { return entry.first; });
        text += "{\n";
        for (const auto& [key, value] : entries) {
            text += fmt::format("{}  {} = ", margin, key);
            append(text, value, indent + IndentPerLevel);
        }
        text += margin + "}\n";
        return;
    }
    if (const auto data = std::dynamic_pointer_cast<NSData>(object))
        text += fmt::format("{} bytes\n", data->bytes().size());
    else if (std::dynamic_pointer_cast<NSString>(object))
        text += fmt::format("\"{}\"\n", object->description());
    else
        text += object->description() + "\n";
}

} // namespace

std::string views(const WidgetScene& scene) {
    return dumpViews(*scene.card());
}

std::string constraints(const WidgetScene& scene) {
    auto text = dumpConstraints(*scene.card());
    const auto& table = scene.controller()->tableView();
    for (const auto& path : table->indexPathsForVisibleRows()) {
        const auto cell = table->cellForRowAtIndexPath(*path);
        text +=
            fmt::format("\nrow {}: {}\n{}", path->row(), cell->className(), dumpConstraints(*cell));
    }
    return text;
}

std::string archive() {
    const auto data =
        OrvoGroup::__orvo_groupUserDefaults()->dataForKey("Orvo.TransitWidget.savedUIData");
    if (!data)
        return {};
    std::shared_ptr<NSError> error;
    const auto root = PropertyList::read(data->bytes(), &error);
    return root ? propertyList(root) : error->localizedDescription() + "\n";
}

std::string propertyList(const std::shared_ptr<NSObject>& root) {
    std::string text;
    append(text, root, 0);
    return text;
}

} // namespace orvo::WidgetDump
