#pragma once

#include "platform/extension/window/private/CardSurface.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <QAccessible>

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class CardPartInterface;

/// Tells assistive tools what is on a card: its name, the button, and the rows as a list, each with
/// what is spoken for it and, where a press does something, the action. Costs nothing while no such
/// tool runs.
class CardAccessibility final {
public:
    /// Which part an interface stands for; rows are counted from 0.
    enum class Kind { Title, Button, List, Row };

    /// Who is told of changes, while they listen.
    struct Audience {
        std::function<bool()> listens;
        std::function<void(QAccessibleEvent& event)> tell;
    };
    /// Default: the desktop's assistive tools, by way of the toolkit.
    static EnvironmentSlot<Audience>& audience();

    CardAccessibility(CardSurface& surface,
                      std::shared_ptr<WidgetCard> card,
                      std::shared_ptr<WidgetHost> host,
                      CardInput& input);
    CardAccessibility(const CardAccessibility&) = delete;
    CardAccessibility& operator=(const CardAccessibility&) = delete;
    ~CardAccessibility();

    /// The window itself.
    [[nodiscard]] QAccessibleInterface* root();
    /// Tells of what has changed since the last time.
    void update();
    /// The window is the one that is typed into, or no more.
    void setActive(bool active);

    // For the interfaces
    [[nodiscard]] CardSurface& surface() const noexcept { return *_surface; }
    [[nodiscard]] std::vector<QAccessibleInterface*> childrenOfRoot();
    [[nodiscard]] QAccessibleInterface* part(Kind kind, std::size_t row = 0);
    [[nodiscard]] std::size_t rowCount() const;
    /// What is spoken; empty for a row that is out of sight.
    [[nodiscard]] std::string nameOf(Kind kind, std::size_t row) const;
    [[nodiscard]] QRect rectOf(Kind kind, std::size_t row) const;
    [[nodiscard]] bool isFocused(Kind kind, std::size_t row) const;
    [[nodiscard]] bool canPress(Kind kind, std::size_t row) const;
    void press(Kind kind, std::size_t row);
    void focus(Kind kind, std::size_t row);
    [[nodiscard]] QAccessibleInterface* focused();

private:
    using Part = std::pair<Kind, std::size_t>;
    /// What tools have been told.
    struct Told {
        std::vector<std::string> rows;
        std::optional<std::string> button;
        std::optional<Part> focus;
    };

    [[nodiscard]] Told now() const;
    [[nodiscard]] std::optional<Part> focusedPart() const;
    void tell(Part part, QAccessible::Event event);
    void forget(Part part);
    void tellRows(const Told& before, const Told& after);
    void tellButton(const Told& before, const Told& after);

    CardSurface* _surface;
    std::shared_ptr<WidgetCard> _card;
    std::shared_ptr<WidgetHost> _host;
    CardInput* _input;
    std::map<Part, QAccessible::Id> _parts;
    Told _told;
};

} // namespace orvo
