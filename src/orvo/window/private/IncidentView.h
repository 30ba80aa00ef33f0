#pragma once

#include "orvo/window/IncidentPage.h"
#include "orvo/window/private/WindowLooks.h"

#include <QScrollArea>

#include <functional>
#include <memory>
#include <utility>
#include <vector>

class QBoxLayout;
class QLabel;

namespace orvo {

class NSTimer;

/// Shows a page in a window: its heading and, one below the other, its incidents, as long as they
/// are. All texts can be selected. While it is seen, the words of the periods follow the clock.
class IncidentView final : public QScrollArea {
public:
    /// Opens a web page.
    using LinkOpener = std::function<void(const QString& url)>;

    explicit IncidentView(LinkOpener opener);
    IncidentView(const IncidentView&) = delete;
    IncidentView& operator=(const IncidentView&) = delete;
    ~IncidentView() override;

    void show(const IncidentPage& page, const WindowLooks& looks);

    /// So wide that lines are good to read, so high as the page needs, within reason.
    [[nodiscard]] QSize sizeHint() const override;

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    [[nodiscard]] QWidget* heading(const IncidentPage& page) const;
    [[nodiscard]] QWidget* goodService() const;
    [[nodiscard]] QWidget* incident(const IncidentPage::Incident& incident);
    void addTexts(QBoxLayout& layout, const IncidentPage::Incident& incident) const;
    /// A mark at the side, and what it is about.
    [[nodiscard]] QWidget*
    marked(const char* image, const QColor& color, double titleFactor, QLayout* texts) const;
    [[nodiscard]] QWidget* separator() const;
    /// A text that nobody can mistake for markup.
    [[nodiscard]] static QLabel*
    label(const std::string& text, const QFont& font, const QColor& color);
    [[nodiscard]] QLabel* linkLabel(const std::string& url) const;

    /// Says the periods as they are now, and again when their words next change.
    void followTime();
    void stopFollowingTime();

    LinkOpener _opener;
    WindowLooks _looks;
    /// Each label with the incident whose period it says.
    std::vector<std::pair<QLabel*, IncidentPage::Incident>> _periods;
    std::shared_ptr<NSTimer> _nextWords; ///< nil while nothing is going to change
};

} // namespace orvo
