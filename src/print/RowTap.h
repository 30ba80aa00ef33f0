#pragma once

#include "platform/foundation/NSExtensionContext.h"

#include <cstdint>
#include <optional>
#include <string>

namespace orvo {

class WidgetScene;

/// A tap on a row, without a window to tap in. Main thread, whose run loop turns meanwhile.
namespace RowTap {

/// How long the map application has to answer, in seconds.
inline constexpr double Patience = 60;

/// Taps the row of the mode, counted from 0, and waits until the map application has taken what it
/// opens. Nothing, or why it did not. Without a mode it is the largest that there are rows for.
[[nodiscard]] std::optional<std::string>
perform(WidgetScene& scene, std::optional<NCWidgetDisplayMode> mode, std::uint64_t row);

} // namespace RowTap

} // namespace orvo
