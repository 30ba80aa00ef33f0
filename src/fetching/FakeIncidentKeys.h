#pragma once

namespace orvo {

/// The group's settings by which incidents are made up, for tests of the widget. Both are truth
/// values; one that is not set is false.

/// Makes up incidents for most of the lines without any.
inline constexpr const char* injectFakeIncidentsKey =
    "Orvo.TransitWidget.internal.injectFakeIncidents";
/// Makes up none, one or two of them for such a line, instead of one.
inline constexpr const char* randomNumberIncidentsKey =
    "Orvo.TransitWidget.internal.randomNumberIncidents";

} // namespace orvo
