#include "print/WaybarPrinter.h"

#include "print/PrintWorld.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo {
namespace {

using testing::incident;
using testing::line;
using testing::widgetOf;

class WaybarPrinterTest : public ::testing::Test {
protected:
    static std::string text(const PrintedWidget& widget) { return WaybarPrinter().text(widget); }

    testing::PrintWorld world;
};

TEST_F(WaybarPrinterTest, IsOneObjectInOneLine) {
    EXPECT_EQ(text(widgetOf({line(1, "U1", {incident(11, "Delays", "Late")}, "00843D"),
                             line(2, "U2", {incident(12, "Works", "")}),
                             line(3, "U3", {}),
                             line(4, "U4", {})})),
              R"({"text": "2 advisories", "alt": "advisories", "tooltip": ")"
              R"(<span background=\"#00843D\" foreground=\"#FFFFFF\"> U1 </span> <b>Delays</b>\n)"
              R"(Late\n[U2] <b>Works</b>\n<b>Good service</b>\n2 lines", )"
              R"("class": "advisories", "percentage": 50})"
              "\n");
}

TEST_F(WaybarPrinterTest, EveryStateHasItsClass) {
    EXPECT_NE(text(widgetOf({})).find(R"("class": "no-favorites", "percentage": 0})"),
              std::string::npos);
    EXPECT_NE(text(widgetOf({line(1, "U1", {})})).find(R"("class": "good", "percentage": 100})"),
              std::string::npos);
    EXPECT_NE(text(testing::widgetOfResult(testing::failure(), 0))
                  .find(R"("class": "unavailable", "percentage": 0})"),
              std::string::npos);
}

TEST_F(WaybarPrinterTest, ASingleAdvisoryIsTheText) {
    const auto printed = text(widgetOf({line(1, "U1", {incident(11, "Delays", "Late")})}));
    EXPECT_EQ(printed.rfind(R"({"text": "Delays", "alt": "advisories", "tooltip": "[U1] <b>)", 0),
              0U)
        << printed;
}

TEST_F(WaybarPrinterTest, NothingInAFeedAddsMarkup) {
    const auto printed =
        text(widgetOf({line(1, "<b>&", {incident(11, "A < B & \"C\" 'D'", "<span>")}, "00843D")}));
    EXPECT_NE(printed.find(R"("text": "A &lt; B &amp; &quot;C&quot; &apos;D&apos;")"),
              std::string::npos)
        << printed;
    EXPECT_NE(printed.find(R"(> &lt;b&gt;&amp; </span> <b>A &lt; B)"), std::string::npos)
        << printed;
    EXPECT_NE(printed.find(R"(\n&lt;span&gt;")"), std::string::npos) << printed;
}

TEST_F(WaybarPrinterTest, ControlCharactersAreBlanks) {
    const auto printed = text(widgetOf({line(1,
                                             "U\x1b"
                                             "1",
                                             {incident(11, "a\x07\nb")})}));
    EXPECT_NE(printed.find(R"("text": "a b")"), std::string::npos) << printed;
    EXPECT_NE(printed.find("[U 1]"), std::string::npos) << printed;
    EXPECT_EQ(std::ranges::count(printed, '\n'), 1);
}

} // namespace
} // namespace orvo
