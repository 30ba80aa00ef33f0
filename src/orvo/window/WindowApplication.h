#pragma once

/// The program where it has a screen.
namespace orvo::WindowApplication {

/// Makes the application object that windows need, where a person would see them and there is none
/// yet. On the main thread, before its run loop is used.
void make();

/// Whether this process has one, so that windows can be made.
[[nodiscard]] bool isMade();

} // namespace orvo::WindowApplication
