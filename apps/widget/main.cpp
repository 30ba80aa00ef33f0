#include "Classes.h"
#include "platform/extension/NSExtensionMain.h"
#include "print/WidgetProgram.h"

#include <iostream>
#include <sys/stat.h>

namespace {

/// The host of this program: a picture, a print or a tap as the command line says.
int runWidget(const orvo::Extension& extension, const std::vector<std::string>& arguments) {
    const auto terminal = orvo::Terminal::standard(orvo::WidgetOptions::ProgramName);
    orvo::WidgetProgram program(extension, terminal);
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
