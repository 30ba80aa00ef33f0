#include "platform/extension/HeadlessApplication.h"

#include "platform/extension/ToolkitRemarks.h"

#include <QGuiApplication>

#include <array>
#include <string>

namespace orvo {

void makeHeadlessApplication() {
    if (QCoreApplication::instance())
        return;
    static std::string name = "orvo";
    static std::string option = "-platform";
    static std::string platform = "offscreen";
    static std::array<char*, 4> words = {name.data(), option.data(), platform.data(), nullptr};
    static int count = 3;
    logToolkitRemarks();
    QGuiApplication::setDesktopSettingsAware(false);
    // Never destroyed: it would go after what it stands on.
    new QGuiApplication(count, words.data());
}

} // namespace orvo
