#pragma once

#include "platform/extension/window/private/CardAccessibility.h"

#include <QAccessibleInterface>
#include <QAccessibleObject>

namespace orvo {

/// The window of a card.
class CardRootInterface final : public QAccessibleObject {
public:
    CardRootInterface(CardSurface& surface, CardAccessibility& accessibility);

    [[nodiscard]] static QAccessibleInterface* of(CardSurface& surface);
    /// The toolkit keeps it as long as the window.
    static QAccessibleInterface* make(CardSurface& surface, CardAccessibility& accessibility);

    [[nodiscard]] QAccessibleInterface* parent() const override;
    [[nodiscard]] QAccessibleInterface* child(int index) const override;
    [[nodiscard]] int childCount() const override;
    [[nodiscard]] int indexOfChild(const QAccessibleInterface* child) const override;
    [[nodiscard]] QAccessibleInterface* focusChild() const override;
    [[nodiscard]] QAccessible::Role role() const override { return QAccessible::Window; }
    [[nodiscard]] QAccessible::State state() const override;
    [[nodiscard]] QString text(QAccessible::Text kind) const override;
    [[nodiscard]] QRect rect() const override;
    [[nodiscard]] QWindow* window() const override { return &_accessibility->surface(); }

private:
    CardAccessibility* _accessibility;
};

/// A part of a card.
class CardPartInterface final : public QAccessibleInterface, public QAccessibleActionInterface {
public:
    using Kind = CardAccessibility::Kind;

    CardPartInterface(CardAccessibility& accessibility, Kind kind, std::size_t row)
        : _accessibility(&accessibility)
        , _kind(kind)
        , _row(row) {}

    [[nodiscard]] bool isValid() const override { return true; }
    [[nodiscard]] QObject* object() const override { return nullptr; }
    [[nodiscard]] QWindow* window() const override { return &_accessibility->surface(); }
    [[nodiscard]] QAccessibleInterface* parent() const override;
    [[nodiscard]] QAccessibleInterface* child(int index) const override;
    [[nodiscard]] QAccessibleInterface* childAt(int x, int y) const override;
    [[nodiscard]] int childCount() const override;
    [[nodiscard]] int indexOfChild(const QAccessibleInterface* child) const override;
    [[nodiscard]] QAccessibleInterface* focusChild() const override;
    [[nodiscard]] QAccessible::Role role() const override;
    [[nodiscard]] QAccessible::State state() const override;
    [[nodiscard]] QString text(QAccessible::Text kind) const override;
    void setText(QAccessible::Text, const QString&) override {}
    [[nodiscard]] QRect rect() const override { return _accessibility->rectOf(_kind, _row); }
    [[nodiscard]] void* interface_cast(QAccessible::InterfaceType type) override;

    [[nodiscard]] QStringList actionNames() const override;
    void doAction(const QString& name) override;
    [[nodiscard]] QStringList keyBindingsForAction(const QString&) const override { return {}; }

private:
    CardAccessibility* _accessibility;
    Kind _kind;
    std::size_t _row;
};

} // namespace orvo
