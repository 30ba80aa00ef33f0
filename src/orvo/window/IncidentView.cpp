#include "orvo/window/private/IncidentView.h"

#include "orvo/window/WindowTexts.h"
#include "orvo/window/private/ShieldRow.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSTimer.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QScrollBar>
#include <QUrl>
#include <QVBoxLayout>

#include <algorithm>

namespace orvo {

namespace {

constexpr int Margin = 24;
constexpr int WidestColumn = 640; // about seventy letters, at the usual size
constexpr int UsualWidth = 480;
constexpr int LeastHeight = 200;
constexpr int MostHeight = 680;
constexpr double UsualEm = 14;
constexpr double HeadingFactor = 1.6;
constexpr double TitleFactor = 1.15;
constexpr double SmallFactor = 0.92;
constexpr int HeadingShield = 7;
constexpr int MarkSide = 18;
constexpr int MarkGap = 10;

QString qt(const std::string& text) {
    return QString::fromStdString(text);
}

double em() {
    return QFontInfo(WindowLooks::font(1)).pixelSize();
}

QVBoxLayout* column(int spacing) {
    auto* const layout = new QVBoxLayout;
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(spacing);
    return layout;
}

} // namespace

IncidentView::IncidentView(LinkOpener opener)
    : _opener(std::move(opener)) {
    setWidgetResizable(true);
    setFrameShape(QFrame::NoFrame);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
}

IncidentView::~IncidentView() {
    stopFollowingTime();
}

void IncidentView::show(const IncidentPage& page, const WindowLooks& looks) {
    _looks = looks;
    _periods.clear();
    auto* const content = new QWidget;
    auto* const rows = column(0);
    rows->setContentsMargins(Margin, Margin - 4, Margin, Margin);
    rows->addWidget(heading(page));
    rows->addSpacing(page.line ? 18 : 14);
    if (page.incidents.empty() && page.line) {
        rows->addWidget(separator());
        rows->addSpacing(16);
        rows->addWidget(goodService());
    }
    for (const auto& one : page.incidents) {
        rows->addWidget(separator());
        rows->addSpacing(16);
        rows->addWidget(incident(one));
        rows->addSpacing(20);
    }
    rows->addStretch(1);

    auto* const text = new QWidget;
    text->setLayout(rows);
    text->setMaximumWidth(static_cast<int>(WidestColumn * em() / UsualEm));
    auto* const middle = new QHBoxLayout(content);
    middle->setContentsMargins(0, 0, 0, 0);
    middle->addWidget(text);
    setWidget(content); // which takes the earlier one's place
    setWindowTitle(qt(page.heading()));
    verticalScrollBar()->setValue(0);
    followTime();
}

QSize IncidentView::sizeHint() const {
    const int width = static_cast<int>(UsualWidth * std::max(1.0, em() / UsualEm));
    const int height = widget() ? widget()->layout()->heightForWidth(width) : 0;
    return {width, std::clamp(height, LeastHeight, MostHeight)};
}

void IncidentView::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Escape || event->matches(QKeySequence::Close))
        window()->close();
    else
        QScrollArea::keyPressEvent(event);
}

void IncidentView::showEvent(QShowEvent* event) {
    QScrollArea::showEvent(event);
    followTime();
}

void IncidentView::hideEvent(QHideEvent* event) {
    stopFollowingTime();
    QScrollArea::hideEvent(event);
}

void IncidentView::followTime() {
    stopFollowingTime();
    const double now = NSDate::date()->timeIntervalSince1970();
    std::optional<double> next;
    for (const auto& [label, incident] : _periods) {
        label->setText(qt(incident.period(now)));
        const auto change = incident.nextPeriodChange(now);
        if (change && (!next || *change < *next))
            next = change;
    }
    if (next && isVisible())
        _nextWords = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
            *next - now, false, [this](const auto&) { followTime(); });
}

void IncidentView::stopFollowingTime() {
    if (const auto timer = std::exchange(_nextWords, nullptr))
        timer->invalidate();
}

QWidget* IncidentView::heading(const IncidentPage& page) const {
    const auto large = WindowLooks::font(HeadingFactor, QFont::Bold);
    auto* const row = new QWidget;
    auto* const layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(12);
    if (!page.line) {
        layout->addWidget(label(page.heading(), large, _looks.text), 1);
        return row;
    }
    const auto shield = _looks.shield(*page.line, HeadingShield, devicePixelRatioF());
    if (!shield.isNull()) {
        auto* const picture = new QLabel;
        picture->setPixmap(shield);
        picture->setAccessibleName(qt(page.line->name));
        layout->addWidget(picture, 0, Qt::AlignTop);
    }
    auto* const texts = column(2);
    texts->addWidget(label(page.line->title, large, _looks.text));
    if (!page.line->detail.empty())
        texts->addWidget(label(page.line->detail, WindowLooks::font(1), _looks.secondary));
    layout->addLayout(texts, 1);
    return row;
}

QWidget* IncidentView::goodService() const {
    auto* const texts = column(0);
    texts->addWidget(label(WindowTexts::text("GoodService"),
                           WindowLooks::font(TitleFactor, QFont::DemiBold),
                           _looks.good));
    return marked("good-v2", _looks.good, TitleFactor, texts);
}

QWidget* IncidentView::incident(const IncidentPage::Incident& incident) {
    const auto color = incident.isUnknown ? _looks.secondary : _looks.advisory;
    auto* const texts = column(0);
    texts->addWidget(
        label(incident.title, WindowLooks::font(TitleFactor, QFont::DemiBold), _looks.text));
    if (!incident.isUnknown) {
        auto* const period = label("", WindowLooks::font(SmallFactor), _looks.secondary);
        texts->addSpacing(3);
        texts->addWidget(period);
        _periods.emplace_back(period, incident);
    }
    if (!incident.lines.empty()) {
        const auto others =
            incident.otherLines > 0 ? WindowTexts::moreLines(incident.otherLines) : std::string();
        texts->addSpacing(10);
        texts->addWidget(new ShieldRow(incident.lines, qt(others), _looks));
    }
    addTexts(*texts, incident);
    return marked("advisories-v2", color, TitleFactor, texts);
}

void IncidentView::addTexts(QBoxLayout& layout, const IncidentPage::Incident& incident) const {
    int space = 10;
    for (const auto& paragraph : incident.paragraphs()) {
        layout.addSpacing(space);
        auto* const text = label("", WindowLooks::font(1), _looks.text);
        text->setTextFormat(Qt::RichText);
        text->setText("<p style='line-height:138%'>" + qt(paragraph).toHtmlEscaped() + "</p>");
        text->setAccessibleName(qt(paragraph));
        layout.addWidget(text);
        space = 8;
    }
    if (!incident.link)
        return;
    layout.addSpacing(12);
    layout.addWidget(incident.canOpenLink()
                         ? linkLabel(*incident.link)
                         : label(*incident.link, WindowLooks::font(SmallFactor), _looks.secondary));
}

QWidget* IncidentView::marked(const char* image,
                              const QColor& color,
                              double titleFactor,
                              QLayout* texts) const {
    auto* const row = new QWidget;
    auto* const layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(MarkGap);
    auto* const mark = new QLabel;
    mark->setPixmap(WindowLooks::fixedImage(image, MarkSide, color, devicePixelRatioF()));
    // In the middle of the title's first line.
    const int line = QFontMetrics(WindowLooks::font(titleFactor, QFont::DemiBold)).height();
    mark->setFixedHeight(std::max(line, MarkSide));
    mark->setAlignment(Qt::AlignCenter);
    layout->addWidget(mark, 0, Qt::AlignTop);
    layout->addLayout(texts, 1);
    return row;
}

QWidget* IncidentView::separator() const {
    auto* const line = new QWidget;
    line->setFixedHeight(1);
    QPalette palette;
    palette.setColor(QPalette::Window, _looks.separator);
    line->setPalette(palette);
    line->setAutoFillBackground(true);
    return line;
}

QLabel* IncidentView::label(const std::string& text, const QFont& font, const QColor& color) {
    auto* const label = new QLabel(qt(text));
    label->setTextFormat(Qt::PlainText);
    label->setFont(font);
    QPalette palette = label->palette();
    palette.setColor(QPalette::WindowText, color);
    label->setPalette(palette);
    label->setWordWrap(true);
    // At its mark, whatever language a stranger wrote it in.
    label->setAlignment(Qt::AlignAbsolute | Qt::AlignVCenter |
                        (QGuiApplication::isRightToLeft() ? Qt::AlignRight : Qt::AlignLeft));
    label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    return label;
}

QLabel* IncidentView::linkLabel(const std::string& url) const {
    const auto host = QUrl(qt(url)).host();
    const auto words = qt(WindowTexts::text("Link"));
    auto* const link = label("", WindowLooks::font(1), _looks.text);
    link->setTextFormat(Qt::RichText);
    link->setText(QString("<a href='%1' style='color:%2'>%3</a> <span style='color:%4'>%5</span>")
                      .arg(qt(url).toHtmlEscaped(),
                           _looks.link.name(),
                           words.toHtmlEscaped(),
                           _looks.secondary.name(),
                           host.toHtmlEscaped()));
    link->setTextInteractionFlags(Qt::TextBrowserInteraction);
    link->setToolTip(qt(url).toHtmlEscaped());
    link->setAccessibleName(words + ": " + host);
    QObject::connect(link, &QLabel::linkActivated, link, [opener = _opener](const QString& target) {
        opener(target);
    });
    return link;
}

} // namespace orvo
