#pragma once

#include "orvo/window/IncidentPage.h"
#include "orvo/window/private/WindowLooks.h"

#include <QScrollArea>

#include <functional>

class QBoxLayout;
class QLabel;

namespace orvo {

/// Shows a page in a window: its heading and, one below the other, its incidents, as long as they
/// are. All texts can be selected.
class IncidentView final : public QScrollArea {
public:
    /// Opens a web page.
    using LinkOpener = std::function<void(const QString& url)>;

    explicit IncidentView(LinkOpener opener);

    /// @param now seconds since 1970, for the words of the periods
    void show(const IncidentPage& page, double now, const WindowLooks& looks);

    /// So wide that lines are good to read, so high as the page needs, within reason.
    [[nodiscard]] QSize sizeHint() const override;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    [[nodiscard]] QWidget* heading(const IncidentPage& page) const;
    [[nodiscard]] QWidget* goodService() const;
    [[nodiscard]] QWidget* incident(const IncidentPage::Incident& incident, double now) const;
    void addTexts(QBoxLayout& layout, const IncidentPage::Incident& incident) const;
    /// A mark at the side, and what it is about.
    [[nodiscard]] QWidget*
    marked(const char* image, const QColor& color, double titleFactor, QLayout* texts) const;
    [[nodiscard]] QWidget* separator() const;
    /// A text that nobody can mistake for markup.
    [[nodiscard]] static QLabel*
    label(const std::string& text, const QFont& font, const QColor& color);
    [[nodiscard]] QLabel* linkLabel(const std::string& url) const;

    LinkOpener _opener;
    WindowLooks _looks;
};

} // namespace orvo
