#include "platform/extension/window/private/CardSurface.h"

#include "platform/uikit/drawing/PixelCanvas.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QScreen>
#include <QTouchEvent>
#include <QWheelEvent>

#include <cmath>
#include <optional>
#include <vector>

namespace orvo {

namespace {

constexpr CGFloat WheelNotch = 48;        // points
constexpr double AngleOfWheelNotch = 120; // eighths of a degree
constexpr QSize AnySize(1 << 24, 1 << 24);

std::optional<CardKey> cardKeyOf(int key) {
    switch (key) {
    case Qt::Key_Tab:
        return CardKey::Tab;
    case Qt::Key_Backtab:
        return CardKey::BackTab;
    case Qt::Key_Up:
        return CardKey::Up;
    case Qt::Key_Down:
        return CardKey::Down;
    case Qt::Key_PageUp:
        return CardKey::PageUp;
    case Qt::Key_PageDown:
        return CardKey::PageDown;
    case Qt::Key_Home:
        return CardKey::Home;
    case Qt::Key_End:
        return CardKey::End;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        return CardKey::Return;
    case Qt::Key_Space:
        return CardKey::Space;
    case Qt::Key_Escape:
        return CardKey::Escape;
    default:
        return std::nullopt;
    }
}

/// The pixels of an image where they lie one row after the other, as a canvas wants them.
std::span<std::uint32_t> pixelsOf(QImage& image) {
    if (image.depth() != 32 || image.bytesPerLine() != qsizetype{4} * image.width())
        return {};
    return {reinterpret_cast<std::uint32_t*>(image.bits()),
            static_cast<std::size_t>(image.width()) * static_cast<std::size_t>(image.height())};
}

void drawInto(QImage& image, double scale, const std::function<void(Canvas&)>& draw) {
    const auto pixels = pixelsOf(image);
    std::ranges::fill(pixels, 0U);
    PixelCanvas canvas(pixels, image.width(), image.height(), scale);
    draw(canvas);
}

} // namespace

CardSurface::CardSurface(CardInput& input, Handlers handlers)
    : _input(&input)
    , _handlers(std::move(handlers))
    , _store(this) {
    setFlags(Qt::Window | Qt::FramelessWindowHint);
    QSurfaceFormat transparent;
    transparent.setAlphaBufferSize(8);
    setFormat(transparent);
    QObject::connect(this, &QWindow::screenChanged, this, [this] {
        watchScreen();
        _handlers.screenChanged();
    });
    watchScreen();
}

CardSurface::~CardSurface() {
    _handlers = {};
    QObject::disconnect(_screenWatch);
}

void CardSurface::watchScreen() {
    QObject::disconnect(_screenWatch);
    if (screen())
        _screenWatch = QObject::connect(screen(), &QScreen::availableGeometryChanged, this, [this] {
            _handlers.screenChanged();
        });
}

// Where it is

bool CardSurface::isSeen() const {
    return isExposed() && isVisible() && !(windowStates() & Qt::WindowMinimized);
}

CGRect CardSurface::frameOnScreen() const {
    const auto frame = geometry();
    return {{static_cast<CGFloat>(frame.x()), static_cast<CGFloat>(frame.y())},
            {static_cast<CGFloat>(frame.width()), static_cast<CGFloat>(frame.height())}};
}

void CardSurface::setFrameOnScreen(const CGRect& frame) {
    const QRect wanted(static_cast<int>(std::lround(frame.origin.x)),
                       static_cast<int>(std::lround(frame.origin.y)),
                       static_cast<int>(std::ceil(frame.size.width)),
                       static_cast<int>(std::ceil(frame.size.height)));
    // Where it stands before it is shown is the desktop's choice.
    const bool moves = isVisible() && wanted.topLeft() != geometry().topLeft();
    setMinimumSize({0, 0});
    setMaximumSize(AnySize);
    if (moves)
        setGeometry(wanted);
    else
        resize(wanted.size());
    setMinimumSize(wanted.size());
    setMaximumSize(wanted.size());
}

CGRect CardSurface::freePartOfScreen() const {
    const auto part = screen() ? screen()->availableGeometry() : QRect();
    return {{static_cast<CGFloat>(part.x()), static_cast<CGFloat>(part.y())},
            {static_cast<CGFloat>(part.width()), static_cast<CGFloat>(part.height())}};
}

// Pixels

bool CardSurface::isStale() const {
    return _presentedSize != size() || _presentedScale != devicePixelRatio();
}

void CardSurface::present(const std::function<void(Canvas&)>& draw) {
    if (!isExposed() || size().isEmpty())
        return;
    const QRegion whole(QRect(QPoint(), size()));
    _store.resize(size());
    _store.beginPaint(whole);
    const double scale = devicePixelRatio();
    auto* const device = _store.paintDevice();
    auto* const image =
        device->devType() == QInternal::Image ? static_cast<QImage*>(device) : nullptr;
    if (image && !pixelsOf(*image).empty()) {
        drawInto(*image, scale, draw);
    } else {
        QImage picture(size() * scale, QImage::Format_ARGB32_Premultiplied);
        drawInto(picture, scale, draw);
        picture.setDevicePixelRatio(scale);
        QPainter painter(device);
        painter.setCompositionMode(QPainter::CompositionMode_Source);
        painter.drawImage(QPoint(), picture);
    }
    _store.endPaint();
    _store.flush(whole);
    _presentedSize = size();
    _presentedScale = scale;
}

void CardSurface::paint(const QRegion& region) {
    if (!isStale())
        _store.flush(region);
    _handlers.frame();
}

QAccessibleInterface* CardSurface::accessibleRoot() const {
    return _handlers.accessibleRoot ? _handlers.accessibleRoot() : nullptr;
}

// Events

bool CardSurface::event(QEvent* event) {
    switch (event->type()) {
    case QEvent::UpdateRequest:
        _handlers.frame();
        return true;
    case QEvent::Paint:
        paint(static_cast<QPaintEvent*>(event)->region());
        return true;
    case QEvent::Expose:
    case QEvent::Hide:
    case QEvent::WindowStateChange: {
        const bool answer = QWindow::event(event);
        if (_handlers.exposureChanged)
            _handlers.exposureChanged();
        return answer;
    }
    case QEvent::Resize: {
        const bool answer = QWindow::event(event);
        if (_handlers.sizeChanged)
            _handlers.sizeChanged();
        return answer;
    }
    case QEvent::FocusIn:
        _handlers.activeChanged(true);
        return true;
    case QEvent::FocusOut:
        _input->pressCancelled();
        _handlers.activeChanged(false);
        return true;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
    case QEvent::MouseButtonRelease:
        return takeMouse(*static_cast<QMouseEvent*>(event));
    case QEvent::TouchBegin:
    case QEvent::TouchUpdate:
    case QEvent::TouchEnd:
    case QEvent::TouchCancel:
        return takeTouch(*static_cast<QTouchEvent*>(event));
    case QEvent::Wheel:
        return takeWheel(*static_cast<QWheelEvent*>(event));
    case QEvent::KeyPress:
        return takeKey(*static_cast<QKeyEvent*>(event));
    case QEvent::Close:
        if (const bool answer = QWindow::event(event); answer && event->isAccepted()) {
            _handlers.closed();
            return true;
        }
        return false;
    default:
        return QWindow::event(event);
    }
}

CGPoint CardSurface::cardPoint(QPointF position) const {
    return {position.x() - _cardOrigin.x, position.y() - _cardOrigin.y};
}

void CardSurface::showPointer(QPointF position) {
    const auto part = _input->partAt(cardPoint(position));
    const auto shape = part == CardPart::Button || part == CardPart::Row ? Qt::PointingHandCursor
                                                                         : Qt::ArrowCursor;
    if (cursor().shape() != shape)
        setCursor(shape);
}

bool CardSurface::takeMouse(QMouseEvent& event) {
    const auto point = cardPoint(event.position());
    if (event.type() == QEvent::MouseMove) {
        showPointer(event.position());
        _input->pressMoved(point);
        return true;
    }
    if (event.button() != Qt::LeftButton)
        return false;
    if (event.type() == QEvent::MouseButtonRelease) {
        _input->pressEnded(point);
        return true;
    }
    _input->pressBegan(point);
    if (_input->partAt(point) == CardPart::Header) {
        _input->pressCancelled(); // its end goes to whoever moves windows
        startSystemMove();
    }
    return true;
}

bool CardSurface::takeTouch(QTouchEvent& event) {
    if (event.type() == QEvent::TouchCancel) {
        _input->pressCancelled();
        return true;
    }
    const auto point = cardPoint(event.points().constFirst().position());
    if (event.type() == QEvent::TouchBegin)
        _input->touchBegan(point);
    else if (event.type() == QEvent::TouchEnd)
        _input->touchEnded(point);
    else
        _input->touchMoved(point);
    event.accept();
    return true;
}

bool CardSurface::takeWheel(QWheelEvent& event) {
    const QPointF notches = QPointF(event.angleDelta()) / AngleOfWheelNotch;
    const QPointF distance =
        event.pixelDelta().isNull() ? notches * WheelNotch : QPointF(event.pixelDelta());
    _input->scrollBy({0, -distance.y()});
    showPointer(event.position());
    event.accept();
    return true;
}

bool CardSurface::takeKey(QKeyEvent& event) {
    const bool closes = event.modifiers() == Qt::ControlModifier &&
                        (event.key() == Qt::Key_W || event.key() == Qt::Key_Q);
    if (closes) {
        close();
        return true;
    }
    const auto key = cardKeyOf(event.key());
    const bool handled = key && _input->pressKey(*key);
    event.setAccepted(handled);
    return handled;
}

} // namespace orvo
