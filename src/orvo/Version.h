#pragma once

namespace orvo {

/// The program's version, that of the project.
inline constexpr const char* Version = ORVO_VERSION;

} // namespace orvo
