#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace orvo {

class WidgetScene;

/// Pictures of the widget. Main thread.
namespace WidgetSnapshot {

/// Draws the card of the scene into a PNG file, which it replaces whole: `scale` pixels a point,
/// and says so in the file. Nothing, or why that failed, with the file's name; the file is then as
/// it was.
[[nodiscard]] std::optional<std::string>
write(const WidgetScene& scene, double scale, const std::filesystem::path& file);

} // namespace WidgetSnapshot

} // namespace orvo
