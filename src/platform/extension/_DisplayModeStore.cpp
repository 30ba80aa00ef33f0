#include "platform/extension/_DisplayModeStore.h"

#include "platform/foundation/Log.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSUserDefaults.h"

namespace orvo::_DisplayModeStore {

namespace {

constexpr const char* Compact = "compact";
constexpr const char* Expanded = "expanded";

} // namespace

std::optional<NCWidgetDisplayMode> load(const std::string& bundleIdentifier) {
    const auto name = NSUserDefaults::initWithSuiteName(SuiteName)->stringForKey(bundleIdentifier);
    if (name == Compact)
        return NCWidgetDisplayMode::Compact;
    if (name == Expanded)
        return NCWidgetDisplayMode::Expanded;
    return std::nullopt;
}

void save(const std::string& bundleIdentifier, NCWidgetDisplayMode mode) {
    const char* name = mode == NCWidgetDisplayMode::Expanded ? Expanded : Compact;
    const auto error = NSUserDefaults::initWithSuiteName(SuiteName)->setObject_forKey(
        NSString::string(name), bundleIdentifier);
    if (error)
        Log::findOrCreate("WidgetHost")->error("%@", error);
}

} // namespace orvo::_DisplayModeStore
