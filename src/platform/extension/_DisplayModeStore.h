#pragma once

#include "platform/foundation/NSExtensionContext.h"

#include <optional>
#include <string>

/// The display mode that a person has chosen for a widget, kept in the profile between starts.
namespace orvo::_DisplayModeStore {

/// The suite of the host's defaults; the widget's bundle identifier is the key.
inline constexpr const char* SuiteName = "com.zentu.Orvo.WidgetHost";

/// Nothing where none was chosen, or what is kept is no mode.
[[nodiscard]] std::optional<NCWidgetDisplayMode> load(const std::string& bundleIdentifier);
/// A choice that cannot be written is said in the log.
void save(const std::string& bundleIdentifier, NCWidgetDisplayMode mode);

} // namespace orvo::_DisplayModeStore
