#pragma once

namespace orvo {

/// Makes the program's application object, for texts and pictures without a screen, where there is
/// none yet. It asks no desktop anything. On the main thread, before its run loop is used.
void makeHeadlessApplication();

} // namespace orvo
