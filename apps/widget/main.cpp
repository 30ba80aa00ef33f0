#include "Classes.h"
#include "platform/extension/NSExtensionMain.h"
#include "platform/extension/window/DesktopApplication.h"
#include "platform/extension/window/DesktopWidget.h"
#include "platform/settings/DesktopDisplay.h"
#include "print/WidgetProgram.h"

#include <iostream>
#include <sys/stat.h>

namespace {

/// By which desktops know the program's window.
constexpr const char* DesktopFile = "com.zentu.Orvo.TransitWidget";

std::optional<orvo::WidgetWindowing> windowing() {
    if (!orvo::DesktopDisplay::isThere())
        return std::nullopt;
    return orvo::WidgetWindowing{
        .makeApplication = [] { orvo::makeDesktopApplication(DesktopFile); },
        .run = orvo::runDesktopWidget};
}

/// The host of this program: a window, a picture, a print or a tap, as the command line says.
int runWidget(const orvo::Extension& extension, const std::vector<std::string>& arguments) {
    const auto terminal = orvo::Terminal::standard(orvo::WidgetOptions::ProgramName);
    orvo::WidgetProgram program(extension, terminal, windowing());
    const auto code = program.run(arguments);
    std::cout.flush();
    if (std::cout)
        return static_cast<int>(code);
    terminal.error("the output cannot be written");
    return static_cast<int>(orvo::ExitCode::Failed);
}

} // namespace

int main(int argc, char** argv) {
    // What is kept is the person's own: where they live, which lines they ride.
    umask(S_IRWXG | S_IRWXO);
    orvo::CodingClassTable::current().set(orvo::codingClasses());
    orvo::principalClasses().set(orvo::widgetPrincipalClasses());
    orvo::extensionHostProgram().set(runWidget);
    return orvo::NSExtensionMain(argc, argv);
}
