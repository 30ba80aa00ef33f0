#include "orvo/window/private/IncidentView.h"

#include "orvo/window/WindowWorld.h"
#include "platform/foundation/RunLoop.h"

#include <QKeyEvent>
#include <QLabel>
#include <QScrollBar>
#include <QTextDocument>

namespace orvo {
namespace {

class IncidentViewTest : public testing::WindowTest {
protected:
    void SetUp() override { ASSERT_TRUE(testing::haveWindowApplication()); }

    void show(const IncidentPage& page) {
        view.show(page, WindowLooks::of({}));
        view.resize(view.sizeHint());
        view.QWidget::show();
        QCoreApplication::processEvents();
    }

    /// What the labels show, one a line, as a person reads it.
    std::string read() const {
        std::string text;
        for (const auto* label : view.findChildren<QLabel*>()) {
            if (label->text().isEmpty())
                continue;
            QTextDocument document;
            if (label->textFormat() == Qt::RichText)
                document.setHtml(label->text());
            else
                document.setPlainText(label->text());
            text += document.toPlainText().toStdString() + "\n";
        }
        return text;
    }

    void turnClock(double seconds) const {
        clock->advance(seconds);
        RunLoop::main().checkTimers();
    }

    std::string opened;
    IncidentView view{[this](const QString& url) {
        opened = url.toStdString();
    }};
};

TEST_F(IncidentViewTest, ShowsTheWholePage) {
    show(pageOfLine({testing::feedIncident(1, "Works")}));
    EXPECT_EQ(read(),
              "U1\n"
              "Metro\n"
              "Works\n"
              "Since Jun 15, 11:36 PM, until 1:06 AM\n"
              "Short.\n"
              "First paragraph.\n"
              "Second paragraph.\n"
              "More information t.example\n");
    EXPECT_EQ(view.windowTitle(), "U1 · Metro");
}

TEST_F(IncidentViewTest, ALineWithoutIncidentsRunsWell) {
    show(pageOfLine({}));
    EXPECT_EQ(read(), "U1\nMetro\nGood service\n");
}

TEST_F(IncidentViewTest, WhatIsShownNextTakesThePlaceOfThePage) {
    show(pageOfLine({testing::feedIncident(1, "Works")}));
    show(pageOfIncidents({}));
    EXPECT_EQ(read(), "0 incidents\n");
}

TEST_F(IncidentViewTest, TextsOfStrangersAreNoMarkup) {
    show(pageOfIncidents({TransitIncidentRecord::initWithFields(
        {.title = "<b>bold</b>", .fullDescription = "a <img src='file:///x'> & b"})}));
    const auto text = read();
    EXPECT_NE(text.find("<b>bold</b>\n"), std::string::npos) << text;
    EXPECT_NE(text.find("a <img src='file:///x'> & b\n"), std::string::npos) << text;
}

TEST_F(IncidentViewTest, AllTextsCanBeSelected) {
    show(pageOfLine({testing::feedIncident(1, "Works")}));
    for (const auto* label : view.findChildren<QLabel*>()) {
        if (!label->text().isEmpty()) {
            EXPECT_TRUE(label->textInteractionFlags().testFlag(Qt::TextSelectableByMouse))
                << label->text().toStdString();
        }
    }
}

TEST_F(IncidentViewTest, ALinkOfTheWebIsOpenedByTheDesktop) {
    show(pageOfLine({testing::feedIncident(1, "Works")}));
    for (auto* label : view.findChildren<QLabel*>()) {
        if (label->text().contains("href"))
            Q_EMIT label->linkActivated("https://t.example/i");
    }
    EXPECT_EQ(opened, "https://t.example/i");
}

TEST_F(IncidentViewTest, AnotherLinkIsShownAndNotFollowed) {
    show(pageOfIncidents({FeedTransitIncident::initWithFields_details(
        {.title = "Works"}, {.link = "file:///etc/passwd"})}));
    EXPECT_NE(read().find("file:///etc/passwd\n"), std::string::npos);
    for (const auto* label : view.findChildren<QLabel*>())
        EXPECT_FALSE(label->text().contains("href"));
}

TEST_F(IncidentViewTest, ALongPageIsReadFromItsTopAndScrolls) {
    std::vector<std::shared_ptr<TransitIncident>> incidents;
    for (std::uint64_t i = 1; i <= 40; ++i)
        incidents.push_back(testing::feedIncident(i, "Works"));
    show(pageOfIncidents(incidents));
    EXPECT_GT(view.verticalScrollBar()->maximum(), 0);
    EXPECT_EQ(view.verticalScrollBar()->value(), 0);
    EXPECT_LE(view.sizeHint().height(), 680);
}

TEST_F(IncidentViewTest, EscapeClosesTheWindow) {
    show(pageOfLine({}));
    QKeyEvent key(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
    QCoreApplication::sendEvent(&view, &key);
    EXPECT_FALSE(view.isVisible());
}

TEST_F(IncidentViewTest, WordsOfAPeriodFollowTheClockWhileTheyAreSeen) {
    show(pageOfIncidents({FeedTransitIncident::initWithFields_details(
        {.startDate = NSDate::dateWithTimeIntervalSince1970(Now + 60),
         .endDate = NSDate::dateWithTimeIntervalSince1970(Now + 36000),
         .title = "Works"},
        {.timeZone = "Europe/Berlin"})}));
    const auto says = [this](const char* words) {
        return read() == std::string("1 incident\nWorks\n") + words + "\n";
    };
    EXPECT_TRUE(says("5:07 PM – Jun 16, 3:06 AM")) << read();
    turnClock(61);
    EXPECT_TRUE(says("Since 5:07 PM, until Jun 16, 3:06 AM")) << read();
    turnClock(7 * 3600);
    EXPECT_TRUE(says("Since Jun 15, 5:07 PM, until 3:06 AM")) << read();
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U); // for the next midnight
}

TEST_F(IncidentViewTest, NobodyIsWokenForWordsThatAreNotSeen) {
    show(pageOfLine({testing::feedIncident(1, "Works")}));
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
    view.close();
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    turnClock(86400);
    view.QWidget::show();
    EXPECT_NE(read().find("Since Jun 15, 11:36 PM, until Jun 16, 1:06 AM\n"), std::string::npos)
        << read();
}

TEST_F(IncidentViewTest, APeriodWithoutATimeHasNoWordsThatChange) {
    show(pageOfIncidents({TransitIncidentRecord::initWithFields({.title = "Works"})}));
    EXPECT_NE(read().find("Until further notice\n"), std::string::npos);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
}

} // namespace
} // namespace orvo
