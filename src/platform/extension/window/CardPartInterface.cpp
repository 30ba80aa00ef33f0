#include "platform/extension/window/private/CardPartInterface.h"

#include <algorithm>

namespace orvo {

namespace {

int indexIn(const std::vector<QAccessibleInterface*>& children, const QAccessibleInterface* child) {
    const auto found = std::ranges::find(children, child);
    return found == children.end() ? -1 : static_cast<int>(found - children.begin());
}

QString toolkitText(const std::string& text) {
    return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

} // namespace

// The window

CardRootInterface::CardRootInterface(CardSurface& surface, CardAccessibility& accessibility)
    : QAccessibleObject(&surface)
    , _accessibility(&accessibility) {}

QAccessibleInterface* CardRootInterface::make(CardSurface& surface,
                                              CardAccessibility& accessibility) {
    auto* const made = new CardRootInterface(surface, accessibility);
    QAccessible::registerAccessibleInterface(made);
    return made;
}

QAccessibleInterface* CardRootInterface::of(CardSurface& surface) {
    return QAccessible::queryAccessibleInterface(&surface);
}

QAccessibleInterface* CardRootInterface::parent() const {
    return QAccessible::queryAccessibleInterface(qApp);
}

QAccessibleInterface* CardRootInterface::child(int index) const {
    const auto children = _accessibility->childrenOfRoot();
    return index >= 0 && static_cast<std::size_t>(index) < children.size()
               ? children[static_cast<std::size_t>(index)]
               : nullptr;
}

int CardRootInterface::childCount() const {
    return static_cast<int>(_accessibility->childrenOfRoot().size());
}

int CardRootInterface::indexOfChild(const QAccessibleInterface* child) const {
    return indexIn(_accessibility->childrenOfRoot(), child);
}

QAccessibleInterface* CardRootInterface::focusChild() const {
    return _accessibility->focused();
}

QAccessible::State CardRootInterface::state() const {
    const auto& surface = _accessibility->surface();
    QAccessible::State state;
    state.active = surface.isActive();
    state.focusable = true;
    state.movable = true;
    state.invisible = !surface.isVisible();
    return state;
}

QString CardRootInterface::text(QAccessible::Text kind) const {
    return kind == QAccessible::Name ? _accessibility->surface().title() : QString();
}

QRect CardRootInterface::rect() const {
    return _accessibility->surface().geometry();
}

// Its parts

QAccessibleInterface* CardPartInterface::parent() const {
    return _kind == Kind::Row ? _accessibility->part(Kind::List) : _accessibility->root();
}

QAccessibleInterface* CardPartInterface::child(int index) const {
    return index >= 0 && index < childCount()
               ? _accessibility->part(Kind::Row, static_cast<std::size_t>(index))
               : nullptr;
}

QAccessibleInterface* CardPartInterface::childAt(int x, int y) const {
    for (int index = 0; index < childCount(); ++index) {
        if (auto* const each = child(index); each->rect().contains(x, y))
            return each;
    }
    return nullptr;
}

int CardPartInterface::childCount() const {
    return _kind == Kind::List ? static_cast<int>(_accessibility->rowCount()) : 0;
}

int CardPartInterface::indexOfChild(const QAccessibleInterface* child) const {
    const auto* const part = dynamic_cast<const CardPartInterface*>(child);
    return _kind == Kind::List && part && part->_kind == Kind::Row ? static_cast<int>(part->_row)
                                                                   : -1;
}

QAccessibleInterface* CardPartInterface::focusChild() const {
    auto* const focused = _accessibility->focused();
    return focused == this || indexOfChild(focused) >= 0 ? focused : nullptr;
}

QAccessible::Role CardPartInterface::role() const {
    switch (_kind) {
    case Kind::Title:
        return QAccessible::StaticText;
    case Kind::Button:
        return QAccessible::Button;
    case Kind::List:
        return QAccessible::List;
    case Kind::Row:
        break;
    }
    return QAccessible::ListItem;
}

QAccessible::State CardPartInterface::state() const {
    QAccessible::State state;
    state.invisible = !_accessibility->surface().isVisible();
    state.focusable = _kind == Kind::Button || _kind == Kind::Row;
    state.focused = _accessibility->isFocused(_kind, _row);
    if (_kind == Kind::Row) {
        const auto list = _accessibility->rectOf(Kind::List, 0);
        state.offscreen = !list.intersects(rect());
    }
    return state;
}

QString CardPartInterface::text(QAccessible::Text kind) const {
    return kind == QAccessible::Name ? toolkitText(_accessibility->nameOf(_kind, _row)) : QString();
}

void* CardPartInterface::interface_cast(QAccessible::InterfaceType type) {
    const bool acts = _kind == Kind::Button || _kind == Kind::Row;
    return type == QAccessible::ActionInterface && acts
               ? static_cast<QAccessibleActionInterface*>(this)
               : nullptr;
}

QStringList CardPartInterface::actionNames() const {
    QStringList names;
    if (_accessibility->canPress(_kind, _row))
        names << pressAction();
    names << setFocusAction();
    return names;
}

void CardPartInterface::doAction(const QString& name) {
    if (name == pressAction())
        _accessibility->press(_kind, _row);
    else if (name == setFocusAction())
        _accessibility->focus(_kind, _row);
}

} // namespace orvo
