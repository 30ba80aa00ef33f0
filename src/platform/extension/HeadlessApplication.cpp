#include "platform/extension/HeadlessApplication.h"

#include "platform/foundation/Log.h"

#include <QGuiApplication>

#include <array>
#include <string>

namespace orvo {

namespace {

/// What the toolkit has to remark on its surroundings is nothing for a person who asked for rows.
void logRemark(QtMsgType type, const QMessageLogContext&, const QString& message) {
    const auto log = Log::findOrCreate("Toolkit");
    const auto text = message.toStdString();
    if (type == QtCriticalMsg || type == QtFatalMsg)
        log->error("%s", text);
    else
        log->debug("%s", text);
}

} // namespace

void makeHeadlessApplication() {
    if (QCoreApplication::instance())
        return;
    static std::string name = "orvo";
    static std::string option = "-platform";
    static std::string platform = "offscreen";
    static std::array<char*, 4> words = {name.data(), option.data(), platform.data(), nullptr};
    static int count = 3;
    qInstallMessageHandler(logRemark);
    QGuiApplication::setDesktopSettingsAware(false);
    // Never destroyed: it would go after what it stands on.
    new QGuiApplication(count, words.data());
}

} // namespace orvo
