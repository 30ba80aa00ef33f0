#include "platform/extension/window/CardInput.h"

#include "platform/extension/WidgetCard.h"
#include "platform/extension/WidgetHost.h"
#include "platform/extension/window/WindowPlacement.h"
#include "platform/uikit/table/UITableView.h"

#include <array>
#include <cmath>
#include <optional>

namespace orvo {

namespace {

std::shared_ptr<UITableView> tableIn(const std::shared_ptr<UIView>& view) {
    if (view->isHidden())
        return nullptr;
    if (auto table = std::dynamic_pointer_cast<UITableView>(view))
        return table;
    for (const auto& subview : view->subviews()) {
        if (auto table = tableIn(subview))
            return table;
    }
    return nullptr;
}

std::optional<UITableViewKey> tableKeyOf(CardKey key) {
    switch (key) {
    case CardKey::Up:
        return UITableViewKey::Up;
    case CardKey::Down:
        return UITableViewKey::Down;
    case CardKey::PageUp:
        return UITableViewKey::PageUp;
    case CardKey::PageDown:
        return UITableViewKey::PageDown;
    case CardKey::Home:
        return UITableViewKey::Home;
    case CardKey::End:
        return UITableViewKey::End;
    case CardKey::Tab:
    case CardKey::BackTab:
    case CardKey::Return:
    case CardKey::Space:
    case CardKey::Escape:
        break;
    }
    return std::nullopt;
}

} // namespace

CardInput::CardInput(std::shared_ptr<WidgetCard> card, std::shared_ptr<WidgetHost> host)
    : _card(std::move(card))
    , _host(std::move(host)) {}

std::shared_ptr<UITableView> CardInput::table() const {
    return tableIn(_host->view());
}

CardPart CardInput::partAt(CGPoint point) const {
    if (!rectContains(_card->bounds(), point))
        return CardPart::Nothing;
    if (rectContains(_card->buttonArea(), point))
        return CardPart::Button;
    if (point.y < WidgetCard::HeaderHeight)
        return CardPart::Header;
    if (const auto table = this->table()) {
        const auto inTable = _card->convertPoint_toView(point, *table);
        if (rectContains(table->bounds(), inTable) &&
            table->_shouldHighlightRowAtIndexPath(table->indexPathForRowAtPoint(inTable)))
            return CardPart::Row;
    }
    return CardPart::Content;
}

// A pointer

void CardInput::pressBegan(CGPoint point) {
    pressCancelled();
    setFocus(CardFocus::None); // whoever points knows where they are
    _pressed = partAt(point);
    if (_pressed == CardPart::Button)
        _card->setButtonHighlighted(true);
    if (const auto table = this->table(); table && _pressed == CardPart::Row)
        table->touchBegan(_card->convertPoint_toView(point, *table));
}

void CardInput::pressMoved(CGPoint point) {
    if (_pressed == CardPart::Button)
        _card->setButtonHighlighted(partAt(point) == CardPart::Button);
    if (const auto table = this->table(); table && _pressed == CardPart::Row)
        table->touchMoved(_card->convertPoint_toView(point, *table));
}

void CardInput::pressEnded(CGPoint point) {
    const auto pressed = std::exchange(_pressed, CardPart::Nothing);
    if (pressed == CardPart::Button) {
        _card->setButtonHighlighted(false);
        if (partAt(point) == CardPart::Button)
            _card->pressButton();
    }
    if (const auto table = this->table(); table && pressed == CardPart::Row)
        table->touchEnded(_card->convertPoint_toView(point, *table));
}

void CardInput::pressCancelled() {
    const auto pressed = std::exchange(_pressed, CardPart::Nothing);
    if (pressed == CardPart::Button)
        _card->setButtonHighlighted(false);
    if (const auto table = this->table(); table && pressed == CardPart::Row)
        table->touchCancelled();
}

// A finger

void CardInput::touchBegan(CGPoint point) {
    _pans = false;
    _touchStart = _touchLast = point;
    pressBegan(point);
}

void CardInput::touchMoved(CGPoint point) {
    if (!_pans && std::abs(point.y - _touchStart.y) > PanDistance) {
        _pans = true;
        pressCancelled();
    }
    if (_pans)
        scrollBy({0, _touchLast.y - point.y});
    else
        pressMoved(point);
    _touchLast = point;
}

void CardInput::touchEnded(CGPoint point) {
    if (!std::exchange(_pans, false))
        pressEnded(point);
}

bool CardInput::scrollBy(CGPoint distance) {
    const auto table = this->table();
    return table && table->scrollBy(distance);
}

// Keys

CardFocus CardInput::focus() const {
    return isThere(_focus) ? _focus : CardFocus::None;
}

bool CardInput::isThere(CardFocus focus) const {
    switch (focus) {
    case CardFocus::Rows: {
        const auto table = this->table();
        return table && table->numberOfSections() > 0 && table->numberOfRowsInSection(0) > 0;
    }
    case CardFocus::Button:
        return _card->buttonArea().size.width > 0;
    case CardFocus::None:
        break;
    }
    return true;
}

void CardInput::setActive(bool active) {
    _active = active;
    showFocus();
}

void CardInput::setFocus(CardFocus focus) {
    if (focus == _focus || !isThere(focus))
        return;
    _focus = focus;
    showFocus();
}

void CardInput::showFocus() {
    _card->setButtonFocused(_active && _focus == CardFocus::Button);
    const auto table = this->table();
    if (!table)
        return;
    const bool has = _active && _focus == CardFocus::Rows;
    if (has && !table->isFirstResponder())
        table->becomeFirstResponder();
    else if (!has && table->isFirstResponder())
        table->resignFirstResponder();
}

bool CardInput::pressKey(CardKey key) {
    switch (key) {
    case CardKey::Tab:
        return moveFocus(true);
    case CardKey::BackTab:
        return moveFocus(false);
    case CardKey::Return:
    case CardKey::Space:
        return activate();
    case CardKey::Escape:
        return escape();
    case CardKey::Up:
    case CardKey::Down:
    case CardKey::PageUp:
    case CardKey::PageDown:
    case CardKey::Home:
    case CardKey::End:
        break;
    }
    return pressRowKey(key);
}

/// Round and round: the rows, the button, the rows.
bool CardInput::moveFocus(bool isForward) {
    constexpr std::array Order{CardFocus::Rows, CardFocus::Button};
    const auto now = focus();
    const auto first = isForward ? Order[0] : Order[1];
    const auto second = isForward ? Order[1] : Order[0];
    setFocus(now == first || !isThere(first) ? second : first);
    return focus() != now;
}

bool CardInput::pressRowKey(CardKey key) {
    const auto table = this->table();
    if (!table || !isThere(CardFocus::Rows))
        return false;
    if (focus() != CardFocus::Rows) {
        // The key that brings the focus to the rows shows where it is and moves it no further.
        setFocus(CardFocus::Rows);
        return true;
    }
    return table->pressKey(*tableKeyOf(key));
}

bool CardInput::activate() {
    switch (focus()) {
    case CardFocus::Rows:
        return table()->pressKey(UITableViewKey::Return);
    case CardFocus::Button:
        _card->pressButton();
        return true;
    case CardFocus::None:
        break;
    }
    return false;
}

bool CardInput::escape() {
    if (isPressing()) {
        pressCancelled();
        return true;
    }
    if (_host->displayMode() == NCWidgetDisplayMode::Expanded) {
        _host->setDisplayMode(NCWidgetDisplayMode::Compact);
        return true;
    }
    if (!_escape)
        return false;
    _escape();
    return true;
}

} // namespace orvo
