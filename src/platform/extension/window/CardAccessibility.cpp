#include "platform/extension/window/private/CardAccessibility.h"

#include "platform/extension/WidgetCard.h"
#include "platform/extension/WidgetHost.h"
#include "platform/extension/window/private/CardPartInterface.h"
#include "platform/uikit/table/UITableView.h"

#include <algorithm>

namespace orvo {

namespace {

std::shared_ptr<NSIndexPath> pathOf(std::size_t row) {
    return NSIndexPath::indexPathForRow_inSection(static_cast<std::int64_t>(row), 0);
}

} // namespace

EnvironmentSlot<CardAccessibility::Audience>& CardAccessibility::audience() {
    static EnvironmentSlot<Audience> slot([] {
        return Audience{.listens = [] { return QAccessible::isActive(); },
                        .tell =
                            [](QAccessibleEvent& event) {
                                QAccessible::updateAccessibility(&event);
                            }};
    });
    return slot;
}

CardAccessibility::CardAccessibility(CardSurface& surface,
                                     std::shared_ptr<WidgetCard> card,
                                     std::shared_ptr<WidgetHost> host,
                                     CardInput& input)
    : _surface(&surface)
    , _card(std::move(card))
    , _host(std::move(host))
    , _input(&input) {}

CardAccessibility::~CardAccessibility() {
    while (!_parts.empty())
        forget(_parts.begin()->first);
    if (auto* const root = CardRootInterface::of(*_surface))
        QAccessible::deleteAccessibleInterface(QAccessible::uniqueId(root));
}

QAccessibleInterface* CardAccessibility::root() {
    if (auto* const known = CardRootInterface::of(*_surface))
        return known;
    return CardRootInterface::make(*_surface, *this);
}

// Parts

QAccessibleInterface* CardAccessibility::part(Kind kind, std::size_t row) {
    const auto known = _parts.find({kind, row});
    if (known != _parts.end())
        return QAccessible::accessibleInterface(known->second);
    auto* const made = new CardPartInterface(*this, kind, row); // the toolkit keeps and deletes it
    _parts[{kind, row}] = QAccessible::registerAccessibleInterface(made);
    return made;
}

void CardAccessibility::forget(Part part) {
    const auto known = _parts.find(part);
    if (known == _parts.end())
        return;
    QAccessible::deleteAccessibleInterface(known->second);
    _parts.erase(known);
}

std::vector<QAccessibleInterface*> CardAccessibility::childrenOfRoot() {
    std::vector<QAccessibleInterface*> children{part(Kind::Title)};
    if (_card->buttonArea().size.width > 0)
        children.push_back(part(Kind::Button));
    children.push_back(part(Kind::List));
    return children;
}

std::size_t CardAccessibility::rowCount() const {
    const auto table = _input->table();
    return table && table->numberOfSections() > 0
               ? static_cast<std::size_t>(table->numberOfRowsInSection(0))
               : 0;
}

std::string CardAccessibility::nameOf(Kind kind, std::size_t row) const {
    switch (kind) {
    case Kind::Title:
    case Kind::List:
        return _host->extensionDescription().displayName;
    case Kind::Button:
        return _card->buttonTitle();
    case Kind::Row:
        break;
    }
    const auto table = _input->table();
    const auto cell = table ? table->cellForRowAtIndexPath(*pathOf(row)) : nullptr;
    return cell ? cell->accessibilityLabel().value_or("") : std::string();
}

QRect CardAccessibility::rectOf(Kind kind, std::size_t row) const {
    const auto table = _input->table();
    CGRect rect;
    switch (kind) {
    case Kind::Title:
        rect = {{0, 0}, {_card->frame().size.width, WidgetCard::HeaderHeight}};
        rect.size.width -= _card->buttonArea().size.width;
        if (_card->buttonArea().origin.x <= 0)
            rect.origin.x = _card->buttonArea().size.width;
        break;
    case Kind::Button:
        rect = _card->buttonArea();
        break;
    case Kind::List:
        rect = _card->convertRect_toView(_host->view()->bounds(), *_card);
        rect.origin.y = WidgetCard::HeaderHeight;
        break;
    case Kind::Row:
        if (table)
            rect = table->convertRect_toView(table->rectForRowAtIndexPath(*pathOf(row)), *_card);
        break;
    }
    const auto origin = _surface->cardOrigin();
    const QRectF inWindow(
        rect.origin.x + origin.x, rect.origin.y + origin.y, rect.size.width, rect.size.height);
    const auto pixels = inWindow.toAlignedRect();
    return {_surface->mapToGlobal(pixels.topLeft()), pixels.size()};
}

bool CardAccessibility::canPress(Kind kind, std::size_t row) const {
    if (kind == Kind::Button)
        return true;
    const auto table = _input->table();
    return kind == Kind::Row && table && table->_shouldHighlightRowAtIndexPath(pathOf(row));
}

void CardAccessibility::press(Kind kind, std::size_t row) {
    if (kind == Kind::Button)
        _card->pressButton();
    if (const auto table = _input->table(); table && kind == Kind::Row)
        table->_pressRowAtIndexPath(pathOf(row));
}

// Focus

std::optional<CardAccessibility::Part> CardAccessibility::focusedPart() const {
    switch (_input->focus()) {
    case CardFocus::Button:
        return Part{Kind::Button, 0};
    case CardFocus::Rows:
        if (const auto path = _input->table()->focusedIndexPath())
            return Part{Kind::Row, static_cast<std::size_t>(path->row())};
        break;
    case CardFocus::None:
        break;
    }
    return std::nullopt;
}

QAccessibleInterface* CardAccessibility::focused() {
    const auto part = focusedPart();
    return part ? this->part(part->first, part->second) : nullptr;
}

bool CardAccessibility::isFocused(Kind kind, std::size_t row) const {
    return _surface->isActive() && focusedPart() == Part{kind, row};
}

void CardAccessibility::focus(Kind kind, std::size_t row) {
    if (kind == Kind::Button)
        _input->setFocus(CardFocus::Button);
    const auto table = _input->table();
    if (kind == Kind::Row && table) {
        _input->setFocus(CardFocus::Rows);
        table->focusRowAtIndexPath(*pathOf(row));
    }
}

// What has changed

CardAccessibility::Told CardAccessibility::now() const {
    Told told;
    for (std::size_t row = 0; row < rowCount(); ++row)
        told.rows.push_back(nameOf(Kind::Row, row));
    if (_card->buttonArea().size.width > 0)
        told.button = _card->buttonTitle();
    told.focus = focusedPart();
    return told;
}

void CardAccessibility::update() {
    if (!audience().get().listens())
        return;
    const auto before = std::exchange(_told, now());
    tellRows(before, _told);
    tellButton(before, _told);
    if (_told.focus && _told.focus != before.focus && _surface->isActive())
        tell(*_told.focus, QAccessible::Focus);
}

void CardAccessibility::tell(Part part, QAccessible::Event event) {
    QAccessibleEvent told(this->part(part.first, part.second), event);
    audience().get().tell(told);
}

void CardAccessibility::tellRows(const Told& before, const Told& after) {
    const auto both = std::min(before.rows.size(), after.rows.size());
    for (std::size_t row = 0; row < both; ++row) {
        if (before.rows[row] != after.rows[row])
            tell({Kind::Row, row}, QAccessible::NameChanged);
    }
    for (std::size_t row = both; row < after.rows.size(); ++row)
        tell({Kind::Row, row}, QAccessible::ObjectCreated);
    for (std::size_t row = before.rows.size(); row > both; --row) {
        tell({Kind::Row, row - 1}, QAccessible::ObjectDestroyed);
        forget({Kind::Row, row - 1});
    }
}

void CardAccessibility::tellButton(const Told& before, const Told& after) {
    const Part button{Kind::Button, 0};
    if (before.button && after.button && before.button != after.button)
        tell(button, QAccessible::NameChanged);
    else if (!before.button && after.button)
        tell(button, QAccessible::ObjectCreated);
    else if (before.button && !after.button) {
        tell(button, QAccessible::ObjectDestroyed);
        forget(button);
    }
}

void CardAccessibility::setActive(bool active) {
    if (!audience().get().listens())
        return;
    QAccessible::State state;
    state.active = true;
    QAccessibleStateChangeEvent told(root(), state);
    audience().get().tell(told);
    if (!active)
        return;
    _told.focus = focusedPart();
    if (_told.focus)
        return tell(*_told.focus, QAccessible::Focus);
    QAccessibleEvent focus(root(), QAccessible::Focus);
    audience().get().tell(focus);
}

} // namespace orvo
