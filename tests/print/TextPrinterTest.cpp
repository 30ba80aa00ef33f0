#include "print/TextPrinter.h"

#include "print/PrintWorld.h"

#include <gtest/gtest.h>

#include <sstream>

namespace orvo {
namespace {

using testing::incident;
using testing::line;
using testing::widgetOf;

class TextPrinterTest : public ::testing::Test {
protected:
    std::string text(const PrintedWidget& widget, Terminal::Settings settings = {}) {
        return TextPrinter(Terminal(output, output, std::move(settings))).text(widget);
    }

    testing::PrintWorld world;
    std::ostringstream output;
};

TEST_F(TextPrinterTest, ShowsTheCompactRowAndTheExpandedRows) {
    EXPECT_EQ(text(widgetOf({line(1, "U1", {incident(11, "Delays", "Late trains")}),
                             line(2, "M10", {incident(12, "Works", "")}),
                             line(3, "U3", {})})),
              "compact:\n"
              "0  2 advisories\n"
              "   [U1] [M10]\n"
              "   → com.zentu.Orvo.Transit.IncidentList: 2 incidents\n"
              "\n"
              "expanded:\n"
              "0  [U1]   Delays\n"
              "          Late trains\n"
              "          → com.zentu.Orvo.Transit.Incident: line 1\n"
              "1  [M10]  Works\n"
              "          → com.zentu.Orvo.Transit.Incident: line 2\n"
              "2  ✓      Good service\n"
              "          1 line\n"
              "          → orvo://?favorites=2&t=r&session=S1\n");
}

TEST_F(TextPrinterTest, WithoutExpandedRowsShowsTheCompactOneAlone) {
    EXPECT_EQ(text(widgetOf({})),
              "compact:\n"
              "0  No favorite lines\n"
              "   Add lines in Orvo to see their service here.\n"
              "   → orvo://?t=r\n");
}

TEST_F(TextPrinterTest, AnErrorRowOpensNothing) {
    const auto printed = text(testing::widgetOfResult(testing::failure(), 0));
    EXPECT_EQ(printed.rfind("compact:\n0  Service status unavailable\n", 0), 0U) << printed;
    EXPECT_EQ(printed.find("→"), std::string::npos);
}

TEST_F(TextPrinterTest, ColoursShieldsAndDimsWhatTheWidgetDims) {
    const auto printed = text(widgetOf({line(1, "U1", {incident(11)}, "00843D,FFEE00"),
                                        line(2, "U2", {incident(12)}),
                                        line(3, "U3", {})}),
                              {.usesStyles = true});
    EXPECT_NE(printed.find("\x1b[48;2;0;132;61;38;2;255;238;0m U1 \x1b[0m"), std::string::npos);
    EXPECT_NE(printed.find("\x1b[7m U2 \x1b[0m"), std::string::npos);
    EXPECT_NE(printed.find("\x1b[2m✓\x1b[0m"), std::string::npos);
    EXPECT_NE(printed.find("\x1b[1mTitle\x1b[0m"), std::string::npos);
}

TEST_F(TextPrinterTest, UsesNoStylesWhereNobodySeesThem) {
    EXPECT_EQ(text(widgetOf({line(1, "U1", {incident(11)}, "00843D")})).find('\x1b'),
              std::string::npos);
}

TEST_F(TextPrinterTest, FitsATerminalAndIsUncutInAPipe) {
    const auto widget = widgetOf({line(1, "U1", {incident(11, "Title", "one two three four")})});
    const auto narrow = text(widget, {.outputIsTerminal = true, .width = 20});
    EXPECT_NE(narrow.find("0  [U1]  Title\n         one two\n         three four\n"),
              std::string::npos)
        << narrow;
    EXPECT_NE(text(widget).find("one two three four\n"), std::string::npos);
}

TEST_F(TextPrinterTest, PercentSignsAreOnlyText) {
    const auto printed = text(widgetOf({line(1, "%s%n", {incident(11, "100 %@ {} %d", "%1$@")})}));
    EXPECT_NE(printed.find("0  [%s%n]  100 %@ {} %d\n           %1$@\n"), std::string::npos)
        << printed;
}

TEST_F(TextPrinterTest, NothingInAFeedCommandsTheTerminal) {
    const auto printed =
        text(widgetOf({line(1, "U\x1b[31m1", {incident(11, "a\x07\x1b]0;b\x07", "c\rd\x9b")})}),
             {.outputIsTerminal = true, .width = 80});
    for (const char c : {'\x1b', '\x07', '\r'})
        EXPECT_EQ(printed.find(c), std::string::npos) << printed;
}

TEST_F(TextPrinterTest, RightToLeftTextsStayAsTheyAre) {
    const auto printed =
        text(widgetOf({line(1, "خط ١", {incident(11, "تأخيرات", "قطارات متأخرة")})}));
    EXPECT_NE(printed.find("0  [خط ١]  تأخيرات\n"), std::string::npos) << printed;
    EXPECT_NE(printed.find("قطارات متأخرة\n"), std::string::npos);
}

TEST_F(TextPrinterTest, NumbersOfManyRowsAreAligned) {
    std::vector<std::shared_ptr<TransitLineItem>> lines;
    for (std::uint64_t muid = 1; muid <= 11; ++muid)
        lines.push_back(line(muid, "U", {incident(muid, "T" + std::to_string(muid), "")}));
    const auto printed = text(widgetOf(lines));
    EXPECT_NE(printed.find("\n 9  [U]  T10\n"), std::string::npos) << printed;
    EXPECT_NE(printed.find("\n10  [U]  T11\n"), std::string::npos);
}

} // namespace
} // namespace orvo
