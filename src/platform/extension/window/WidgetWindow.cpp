#include "platform/extension/window/WidgetWindow.h"

#include "platform/extension/WidgetCard.h"
#include "platform/extension/WidgetHost.h"
#include "platform/extension/window/CardInput.h"
#include "platform/extension/window/WindowPlacement.h"
#include "platform/extension/window/private/CardAccessibility.h"
#include "platform/extension/window/private/CardSurface.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/uikit/ViewAnimator.h"
#include "platform/uikit/ViewDrawing.h"
#include "platform/uikit/drawing/Canvas.h"

#include <QAbstractEventDispatcher>
#include <QMetaObject>

#include <algorithm>
#include <cmath>
#include <optional>

namespace orvo {

namespace {

constexpr const char* SizeChange = "size";

/// A change of the card's size, in points of the desktop.
struct Transition {
    CGRect from;
    CGRect to;
    std::function<void()> completion;
};

} // namespace

struct WidgetWindow::Private {
    explicit Private(const std::shared_ptr<WidgetHost>& shownHost);
    ~Private();
    Private(const Private&) = delete;
    Private& operator=(const Private&) = delete;

    [[nodiscard]] CardSurface::Handlers handlers();
    void showFrame();
    void draw(Canvas& canvas) const;
    void requestFrameWhereNeeded();
    void exposureChanged();
    void screenChanged();
    void applyTraits();
    void beginTransition(const Transition& next, const std::function<void()>& alongside);
    void placeCard(double progress);
    void endTransition();
    void sizeChanged();
    void setCardOffset(CGPoint offset);
    void fit();

    std::shared_ptr<WidgetHost> host;
    std::shared_ptr<WidgetCard> card;
    std::shared_ptr<ViewAnimator> animator = ViewAnimator::shared().get();
    CardInput input;
    std::unique_ptr<CardSurface> surface;
    std::unique_ptr<CardAccessibility> accessibility;
    QMetaObject::Connection turnEnds;
    UITraitCollection desktopTraits = UITraitCollection::system().get();
    std::optional<Transition> transition;
    CGSize shownSize;   ///< of the card as it is seen, in points
    CGPoint cardOffset; ///< in the window, while it moves there
    bool isSeen = false;
    std::uint64_t framesShown = 0;
    std::function<void()> closed;
    std::function<void()> firstFrameShown;
};

WidgetWindow::Private::Private(const std::shared_ptr<WidgetHost>& shownHost)
    : host(shownHost)
    , card(WidgetCard::cardWithHost_offersButton(shownHost, true))
    , input(card, host)
    , surface(std::make_unique<CardSurface>(input, handlers()))
    , accessibility(std::make_unique<CardAccessibility>(*surface, card, host, input)) {
    const auto& name = host->extensionDescription().displayName;
    surface->setTitle(QString::fromUtf8(name.data(), static_cast<qsizetype>(name.size())));
    input.setEscape([this] { surface->close(); });
    // Views ask nobody for frames when they change: before the loop waits, what has changed is
    // looked for, which costs nothing where nothing has.
    turnEnds = QObject::connect(QAbstractEventDispatcher::instance(),
                                &QAbstractEventDispatcher::aboutToBlock,
                                surface.get(),
                                [this] { requestFrameWhereNeeded(); });
    screenChanged();
    shownSize = WidgetCard::sizeForContentSize(host->contentSize());
    surface->setFrameOnScreen({surface->frameOnScreen().origin, shownSize});
    fit();
}

WidgetWindow::Private::~Private() {
    QObject::disconnect(turnEnds);
    animator->setFrameRequest({});
    endTransition();
    accessibility.reset();
    surface.reset();
}

CardSurface::Handlers WidgetWindow::Private::handlers() {
    return {.frame = [this] { showFrame(); },
            .exposureChanged = [this] { exposureChanged(); },
            .screenChanged = [this] { screenChanged(); },
            .sizeChanged = [this] { sizeChanged(); },
            .activeChanged =
                [this](bool active) {
                    input.setActive(active);
                    accessibility->setActive(active);
                },
            .closed =
                [this] {
                    exposureChanged();
                    // Later: it may let go of this window, which is in the middle of an event.
                    DispatchQueue::mainQueue()->async([closed = closed] {
                        if (closed)
                            closed();
                    });
                },
            .accessibleRoot = [this]() -> QAccessibleInterface* {
                return accessibility ? accessibility->root() : nullptr;
            }};
}

// Frames

void WidgetWindow::Private::draw(Canvas& canvas) const {
    const auto origin = surface->cardOrigin();
    canvas.translate(origin.x, origin.y);
    // While it grows or shrinks it is as large as it will be, and seen in part.
    const auto& whole = card->frame().size;
    canvas.clip(
        {{0, 0},
         {std::min(shownSize.width, whole.width), std::min(shownSize.height, whole.height)}},
        WidgetCard::CornerRadius);
    drawViewHierarchy(*card, canvas);
}

void WidgetWindow::Private::showFrame() {
    if (!surface->isExposed())
        return;
    if (surface->devicePixelRatio() != UITraitCollection::system().get().displayScale)
        applyTraits();
    animator->advance();
    card->layoutIfNeeded();
    if (card->_needsDisplay() || surface->isStale()) {
        surface->present([this](Canvas& canvas) { draw(canvas); });
        ++framesShown;
        accessibility->update();
        if (auto shown = std::exchange(firstFrameShown, {}))
            shown();
    }
    exposureChanged();
    if (animator->isRunning())
        surface->requestUpdate();
}

void WidgetWindow::Private::requestFrameWhereNeeded() {
    if (framesShown == 0)
        return;
    card->layoutIfNeeded();
    if (isSeen && (card->_needsDisplay() || surface->isStale()))
        surface->requestUpdate();
    else
        accessibility->update();
}

void WidgetWindow::Private::exposureChanged() {
    const bool seen = surface->isSeen() && framesShown > 0;
    if (seen == isSeen)
        return;
    isSeen = seen;
    if (seen)
        animator->setFrameRequest([this] { surface->requestUpdate(); });
    else
        animator->setFrameRequest({});
    if (!seen)
        endTransition();
    host->setShown(seen);
}

// The screen and the desktop's looks

void WidgetWindow::Private::screenChanged() {
    const auto room = surface->freePartOfScreen().size.height - WidgetCard::HeaderHeight;
    host->setFreeHeight(std::max<CGFloat>(room, 0));
    applyTraits();
}

void WidgetWindow::Private::applyTraits() {
    auto traits = desktopTraits;
    traits.displayScale = surface->devicePixelRatio();
    host->setTraits(traits);
}

// The card's size

void WidgetWindow::Private::beginTransition(const Transition& next,
                                            const std::function<void()>& alongside) {
    transition = next;
    const auto size = next.to.size;
    card->setFrame({{0, 0}, {size.width, std::max(size.height, next.from.size.height)}});
    alongside();
    surface->setFrameOnScreen(rectUniting(next.from, next.to));
    animator->animate(*card, SizeChange, 0, TransitionSeconds, [this](double progress) {
        placeCard(progress);
        if (progress >= 1)
            endTransition();
    });
    if (!isSeen)
        endTransition(); // no frames come
}

void WidgetWindow::Private::placeCard(double progress) {
    if (!transition)
        return;
    const auto now = rectBetween(transition->from, transition->to, progress);
    const auto window = rectUniting(transition->from, transition->to);
    setCardOffset({now.origin.x - window.origin.x, now.origin.y - window.origin.y});
    shownSize = now.size;
    shownSize.height = UIRoundToViewScale(shownSize.height, card.get());
    card->setFrame(
        {{0, 0}, {now.size.width, std::max(shownSize.height, transition->to.size.height)}});
    card->setNeedsDisplay();
}

void WidgetWindow::Private::endTransition() {
    if (!transition)
        return;
    const auto ended = *std::exchange(transition, std::nullopt);
    animator->cancel(*card, SizeChange);
    shownSize = ended.to.size;
    surface->setFrameOnScreen(ended.to);
    card->setNeedsDisplay();
    fit();
    ended.completion();
}

void WidgetWindow::Private::sizeChanged() {
    if (!transition)
        fit();
}

/// In a window that the desktop made wider the card stands in the middle, at the top.
void WidgetWindow::Private::setCardOffset(CGPoint offset) {
    cardOffset = offset;
    const auto spare = surface->frameOnScreen().size.width - std::ceil(shownSize.width);
    surface->setCardOrigin({offset.x + std::max<CGFloat>(std::floor(spare / 2), 0), offset.y});
}

/// In a window that the desktop made smaller the card is smaller too: its rows scroll.
void WidgetWindow::Private::fit() {
    setCardOffset({0, 0});
    const auto room = surface->frameOnScreen().size;
    const CGRect frame{
        {0, 0}, {std::min(shownSize.width, room.width), std::min(shownSize.height, room.height)}};
    if (card->frame() == frame)
        return;
    card->setFrame(frame);
    card->setNeedsDisplay();
}

// The window

std::shared_ptr<WidgetWindow>
WidgetWindow::windowWithHost(const std::shared_ptr<WidgetHost>& host) {
    auto window = std::make_shared<WidgetWindow>();
    window->_initWithHost(host);
    return window;
}

WidgetWindow::WidgetWindow() = default;
WidgetWindow::~WidgetWindow() {
    if (_private)
        _private->host->setShown(false);
}

void WidgetWindow::_initWithHost(const std::shared_ptr<WidgetHost>& host) {
    _private = std::make_unique<Private>(host);
    host->setPresenter(std::static_pointer_cast<WidgetPresenter>(strong(this)));
}

void WidgetWindow::setTraits(const UITraitCollection& traits) {
    _private->desktopTraits = traits;
    _private->applyTraits();
}

void WidgetWindow::setClosed(std::function<void()> closed) {
    _private->closed = std::move(closed);
}

void WidgetWindow::setFirstFrameShown(std::function<void()> shown) {
    _private->firstFrameShown = std::move(shown);
}

void WidgetWindow::show() {
    _private->surface->show();
}

void WidgetWindow::hide() {
    _private->surface->hide();
}

void WidgetWindow::activate() {
    _private->surface->show();
    _private->surface->raise();
    _private->surface->requestActivate();
}

CGRect WidgetWindow::frame() const {
    return _private->surface->frameOnScreen();
}

bool WidgetWindow::isChangingSize() const {
    return _private->transition.has_value();
}

const std::shared_ptr<WidgetCard>& WidgetWindow::card() const noexcept {
    return _private->card;
}

void WidgetWindow::displayIfNeeded() {
    _private->showFrame();
}

std::uint64_t WidgetWindow::framesShown() const noexcept {
    return _private->framesShown;
}

// What the host says

void WidgetWindow::widgetHost_transitionToContentSize(WidgetHost&,
                                                      CGSize size,
                                                      std::function<void()> alongside,
                                                      std::function<void()> completion) {
    auto& window = *_private;
    const auto wanted = WidgetCard::sizeForContentSize(size);
    const auto frame = window.surface->frameOnScreen();
    const auto offset = window.cardOffset;
    const CGRect from{{frame.origin.x + offset.x, frame.origin.y + offset.y}, window.shownSize};
    window.endTransition();
    const auto to = windowFramePlacing(from.origin, wanted, window.surface->freePartOfScreen());
    window.beginTransition({from, to, std::move(completion)}, alongside);
}

void WidgetWindow::widgetHostDidChangeDisplayMode(WidgetHost&) {
    _private->card->update();
}

void WidgetWindow::widgetHostDidChangeView(WidgetHost&) {
    _private->card->update();
}

} // namespace orvo
