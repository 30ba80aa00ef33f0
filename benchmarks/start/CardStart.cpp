#include "Classes.h"
#include "StartReport.h"
#include "platform/extension/NSExtensionMain.h"
#include "platform/extension/window/DesktopApplication.h"
#include "platform/extension/window/DesktopWidget.h"
#include "platform/extension/window/WidgetWindow.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"

// The widget in its window, from what the demonstration city's profile has saved. With "stay" it
// stays, to be looked at.
int main(int argc, char** argv) {
    using namespace orvo;
    const bool stays = argc > 1 && std::string(argv[1]) == "stay";
    Environment::profile().set(ProfileFolders::demonstration());
    CodingClassTable::current().set(codingClasses());
    principalClasses().set(widgetPrincipalClasses());
    extensionHostProgram().set(
        [stays](const Extension& extension, const std::vector<std::string>&) {
            makeDesktopApplication("com.zentu.Orvo.TransitWidget");
            if (stays)
                return runDesktopWidget(extension, {});
            const auto host = WidgetHost::hostWithExtension_settings(extension, {});
            const auto window = WidgetWindow::windowWithHost(host);
            window->setFirstFrameShown([] { start::reportAndLeave(); });
            window->show();
            return RunLoop::main().run();
        });
    return NSExtensionMain(argc, argv);
}
