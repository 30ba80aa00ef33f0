#pragma once

/// The program where it has a screen.
namespace orvo::WindowApplication {

/// Whether there is a display that answers, on which a person would see windows. Looks at the
/// environment and for the display's socket; a display on another machine is taken at its word.
[[nodiscard]] bool haveDisplay();

/// Makes the application object that windows need, where there is none yet. A display that does not
/// answer after all ends the process with the toolkit's message, so ask `haveDisplay()` first. On
/// the main thread, before its run loop is used.
void make();

/// Whether this process has one, so that windows can be made.
[[nodiscard]] bool isMade();

} // namespace orvo::WindowApplication
