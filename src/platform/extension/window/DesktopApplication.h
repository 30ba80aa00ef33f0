#pragma once

#include <string>

namespace orvo {

/// Makes the program's application object, for windows, where there is none yet: quick to start,
/// without the themes and graphics drivers that a card has no use for. `desktopFile` is the name of
/// the program's desktop file, without its ending, by which desktops know its windows. A display
/// that does not answer ends the process with the toolkit's own message, so ask
/// `DesktopDisplay::isThere()` first. On the main thread, before its run loop is used.
void makeDesktopApplication(const std::string& desktopFile);

} // namespace orvo
