#include "StartReport.h"
#include "platform/extension/window/DesktopApplication.h"

#include <QFont>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QPainter>
#include <QRasterWindow>

#include <fontconfig/fontconfig.h>
#include <string_view>

namespace {

constexpr int Lines = 5;
constexpr const char* FontFile = "/usr/share/fonts/opentype/inter/Inter-Regular.otf";

/// As much text as a card has, in the same font.
class BareWindow final : public QRasterWindow {
protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        painter.fillRect(0, 0, width(), height(), Qt::white);
        QFont font(QFontDatabase::applicationFontFamilies(_font).value(0));
        font.setPixelSize(17);
        font.setHintingPreference(QFont::PreferNoHinting);
        painter.setFont(font);
        for (int line = 0; line < Lines; ++line)
            painter.drawText(16, 40 + 24 * line, "Signal problem at Harbour: expect delays");
        QMetaObject::invokeMethod(
            this, [] { orvo::start::reportAndLeave(); }, Qt::QueuedConnection);
    }

private:
    int _font = QFontDatabase::addApplicationFont(FontFile);
};

} // namespace

// With "own-fonts" it knows no fonts of the system, as the card while it needs none of them.
int main(int argc, char** argv) {
    if (argc > 1 && argv[1] == std::string_view("own-fonts"))
        FcConfigSetCurrent(FcConfigCreate());
    orvo::makeDesktopApplication("com.zentu.Orvo.TransitWidget");
    BareWindow window;
    window.setFlags(Qt::Window | Qt::FramelessWindowHint);
    QSurfaceFormat transparent;
    transparent.setAlphaBufferSize(8);
    window.setFormat(transparent);
    window.resize(359, 146);
    window.show();
    return QGuiApplication::exec();
}
