#pragma once

#include "TableWidget.h"
#include "platform/extension/window/WidgetWindow.h"
#include "platform/uikit/ViewAnimator.h"
#include "support/GraphicalApplication.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPixmap>
#include <QScreen>
#include <QWheelEvent>
#include <QWindow>

namespace orvo::testing {

/// A widget in a window of the offscreen platform.
struct WindowWorld : TableWorld {
    WindowWorld()
        : animator(std::make_shared<ViewAnimator>())
        , animators(ViewAnimator::shared().overrideWith(animator))
        , window(WidgetWindow::windowWithHost(host)) {}

    void show() {
        window->show();
        settle();
    }
    /// Hands out what waits, and shows what has changed by it.
    void settle() {
        for (int times = 0; times < 3; ++times)
            turn();
        window->displayIfNeeded();
    }
    /// Lets a change of size come to its end.
    void finish() {
        monotonic->advance(1);
        settle();
    }
    void expand() {
        host->setDisplayMode(Mode::Expanded);
        finish();
    }
    static QWindow& toolkitWindow() { return *QGuiApplication::allWindows().constFirst(); }

    static void mouse(QEvent::Type type, QPointF point, Qt::MouseButton button = Qt::LeftButton) {
        const auto pressed =
            type == QEvent::MouseButtonPress ? Qt::MouseButtons(button) : Qt::MouseButtons();
        QMouseEvent event(type, point, point, point, button, pressed, Qt::NoModifier);
        QCoreApplication::sendEvent(&toolkitWindow(), &event);
    }
    static void click(QPointF point) {
        mouse(QEvent::MouseButtonPress, point);
        mouse(QEvent::MouseButtonRelease, point);
    }
    static void wheel(QPoint pixels, QPoint angle) {
        QWheelEvent event({100, 100},
                          {100, 100},
                          pixels,
                          angle,
                          Qt::NoButton,
                          Qt::NoModifier,
                          Qt::NoScrollPhase,
                          false);
        QCoreApplication::sendEvent(&toolkitWindow(), &event);
    }
    static void key(int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QKeyEvent event(QEvent::KeyPress, key, modifiers);
        QCoreApplication::sendEvent(&toolkitWindow(), &event);
    }
    /// What the desktop shows at a point.
    static QColor colorAt(QPoint point) {
        const auto& window = toolkitWindow();
        return window.screen()->grabWindow(window.winId()).toImage().pixelColor(point);
    }

    std::shared_ptr<ViewAnimator> animator;
    EnvironmentSlot<std::shared_ptr<ViewAnimator>>::Override animators;
    std::shared_ptr<WidgetWindow> window;
};

} // namespace orvo::testing
