#pragma once

#include "platform/foundation/CGGeometry.h"

#include <functional>
#include <memory>

namespace orvo {

class UITableView;
class UIView;
class WidgetCard;
class WidgetHost;

/// Keys that mean something to a card.
enum class CardKey { Tab, BackTab, Up, Down, PageUp, PageDown, Home, End, Return, Space, Escape };

/// What keys go to.
enum class CardFocus { None, Rows, Button };

/// What lies at a point of a card.
enum class CardPart {
    Nothing,
    Header, ///< what the window is moved by
    Button,
    Row, ///< one that does something when it is pressed
    Content,
};

/// Brings what a person does with a card to its button and its table. Points are in the card's
/// coordinates. Nothing has the focus until keys are used. Main thread.
class CardInput {
public:
    CardInput(std::shared_ptr<WidgetCard> card, std::shared_ptr<WidgetHost> host);

    /// The table that the widget shows; nil where there is none.
    [[nodiscard]] std::shared_ptr<UITableView> table() const;
    [[nodiscard]] CardPart partAt(CGPoint point) const;
    /// A part that has gone has no focus.
    [[nodiscard]] CardFocus focus() const;
    /// Called where Escape finds nothing to end on the card.
    void setEscape(std::function<void()> escape) { _escape = std::move(escape); }

    // A pointer
    void pressBegan(CGPoint point);
    /// A press that leaves the part where it began is over.
    void pressMoved(CGPoint point);
    void pressEnded(CGPoint point);
    void pressCancelled();
    [[nodiscard]] bool isPressing() const noexcept { return _pressed != CardPart::Nothing; }

    // A finger, which scrolls once it has moved by more than `PanDistance` along the card
    static constexpr CGFloat PanDistance = 10;
    void touchBegan(CGPoint point);
    void touchMoved(CGPoint point);
    void touchEnded(CGPoint point);

    /// Positive distances show what is further down. Answers whether anything moved.
    bool scrollBy(CGPoint distance);

    // Keys
    /// Answers whether the key did something.
    bool pressKey(CardKey key);
    /// The window is the one that is typed into, or no more: the focus is shown meanwhile.
    void setActive(bool active);
    /// Moves the focus to a part that is there.
    void setFocus(CardFocus focus);

private:
    [[nodiscard]] bool isThere(CardFocus focus) const;
    void showFocus();
    bool moveFocus(bool isForward);
    bool pressRowKey(CardKey key);
    bool activate();
    bool escape();

    std::shared_ptr<WidgetCard> _card;
    std::shared_ptr<WidgetHost> _host;
    std::function<void()> _escape;
    CardPart _pressed = CardPart::Nothing;
    CardFocus _focus = CardFocus::None;
    bool _active = true;
    bool _pans = false;
    CGPoint _touchStart;
    CGPoint _touchLast;
};

} // namespace orvo
