#include "platform/extension/ToolkitRemarks.h"

#include "platform/foundation/Log.h"

#include <QString>
#include <QtGlobal>

#include <cstdio>

namespace orvo {

namespace {

void logRemark(QtMsgType type, const QMessageLogContext&, const QString& message) {
    const auto log = Log::findOrCreate("Toolkit");
    const auto text = message.toStdString();
    if (type == QtFatalMsg)
        std::fprintf(stderr, "%s\n", text.c_str());
    if (type == QtCriticalMsg || type == QtFatalMsg)
        log->error("%s", text);
    else
        log->debug("%s", text);
}

} // namespace

void logToolkitRemarks() {
    qInstallMessageHandler(logRemark);
}

} // namespace orvo
