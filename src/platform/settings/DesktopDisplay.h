#pragma once

/// The display that a person would see the program's windows on.
namespace orvo::DesktopDisplay {

/// Whether the environment names one. A display of this machine must be served by somebody: a name
/// that was left behind is none. One of another machine is believed. Where somebody has chosen a
/// platform of the toolkit, it is the display of that platform; one that needs no display is
/// believed, unless nobody sees what it draws.
[[nodiscard]] bool isThere();

/// Windows are pixels here: the toolkit is to load no graphics driver for them. Something else that
/// the environment asks for counts. Before the application object is made, on the main thread.
void useNoGraphicsDrivers();

} // namespace orvo::DesktopDisplay
