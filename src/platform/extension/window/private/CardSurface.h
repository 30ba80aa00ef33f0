#pragma once

#include "platform/extension/window/CardInput.h"

#include <QBackingStore>
#include <QRegion>
#include <QWindow>

#include <functional>

class QKeyEvent;
class QMouseEvent;
class QTouchEvent;
class QWheelEvent;

namespace orvo {

class Canvas;

/// The toolkit's window under a card: a frameless one of pixels, whose free part one can look
/// through. It turns the toolkit's events into calls.
class CardSurface final : public QWindow {
public:
    struct Handlers {
        std::function<void()> frame;           ///< it is time to show what has changed
        std::function<void()> exposureChanged; ///< `isSeen()` may be another
        std::function<void()> screenChanged;   ///< its scale or its free part may be another
        std::function<void()> sizeChanged;     ///< by the program or by the desktop
        std::function<void(bool active)> activeChanged;
        std::function<void()> closed;
        std::function<QAccessibleInterface*()> accessibleRoot;
    };

    CardSurface(CardInput& input, Handlers handlers);
    /// Handlers are not called any more.
    ~CardSurface() override;

    /// Whether a person may see it: exposed, and not minimised.
    [[nodiscard]] bool isSeen() const;
    /// In points of the desktop; on a desktop that does not tell where windows are, at its origin.
    [[nodiscard]] CGRect frameOnScreen() const;
    /// A person cannot change its size. A desktop may give it another one all the same.
    void setFrameOnScreen(const CGRect& frame);
    /// The part of its screen that no panel takes.
    [[nodiscard]] CGRect freePartOfScreen() const;
    /// Where the card's top left is in the window.
    void setCardOrigin(CGPoint origin) { _cardOrigin = origin; }
    [[nodiscard]] CGPoint cardOrigin() const noexcept { return _cardOrigin; }

    /// Whether nothing has been shown yet, or in another size.
    [[nodiscard]] bool isStale() const;
    /// Shows what `draw` draws on nothing, in the window's coordinates.
    void present(const std::function<void(Canvas&)>& draw);

    [[nodiscard]] QAccessibleInterface* accessibleRoot() const override;

protected:
    bool event(QEvent* event) override;

private:
    void paint(const QRegion& region);
    void watchScreen();
    [[nodiscard]] CGPoint cardPoint(QPointF position) const;
    bool takeMouse(QMouseEvent& event);
    bool takeTouch(QTouchEvent& event);
    bool takeWheel(QWheelEvent& event);
    bool takeKey(QKeyEvent& event);
    void showPointer(QPointF position);

    CardInput* _input;
    Handlers _handlers;
    QBackingStore _store;
    CGPoint _cardOrigin;
    QSize _presentedSize;
    qreal _presentedScale = 0;
    QMetaObject::Connection _screenWatch;
};

} // namespace orvo
