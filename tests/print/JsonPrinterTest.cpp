#include "print/JsonPrinter.h"

#include "handoff/OWUserActivityData.h"
#include "platform/foundation/NSData.h"
#include "print/PrintWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Layout = JsonWriter::Layout;
using Payloads = JsonPrinter::Payloads;
using testing::incident;
using testing::line;
using testing::widgetOf;

class JsonPrinterTest : public ::testing::Test {
protected:
    static std::string oneLine(const PrintedWidget& widget, Payloads payloads = Payloads::LeftOut) {
        return JsonPrinter(Layout::OneLine, payloads).text(widget);
    }
    /// The `userInfo` of an activity with those bytes.
    static std::string userInfo(std::string_view bytes) {
        PrintedWidget widget;
        widget.summary.opens = PrintedTarget{.url = std::nullopt,
                                             .activityType = "a.b",
                                             .userInfo = NSDictionary::dictionaryWithTextKeys(
                                                 {{"k", NSData::dataWithString(bytes)}})};
        const auto text = oneLine(widget, Payloads::WithUserInfo);
        const auto start = text.find("\"userInfo\": ") + 12;
        return text.substr(start, text.find('}', start) + 1 - start);
    }

    testing::PrintWorld world;
};

TEST_F(JsonPrinterTest, WritesOneObjectARowWithEveryMember) {
    EXPECT_EQ(oneLine(widgetOf({line(1, "U1", {incident(11, "A \"b\"", "")}, "00843D"),
                                line(18446744073709551615U, "U2", {incident(12)}),
                                line(3, "U3", {})})),
              R"({"summary": {"kind": "summary", "primaryText": "2 advisories", )"
              R"("secondaryText": null, "artwork": {"shields": ["U1", "U2"], "alpha": 1}, )"
              R"("artworkHidden": false, )"
              R"("opens": {"activityType": "com.zentu.Orvo.Transit.IncidentList", )"
              R"("incidentMuids": ["11", "12"]}}, "expanded": [)"
              R"({"kind": "item", "primaryText": "A \"b\"", "secondaryText": "", )"
              R"("artwork": {"shields": ["U1"], "alpha": 1}, "artworkHidden": false, )"
              R"("opens": {"activityType": "com.zentu.Orvo.Transit.Incident", "lineMuid": "1"}}, )"
              R"({"kind": "item", "primaryText": "Title", "secondaryText": "Summary", )"
              R"("artwork": {"shields": ["U2"], "alpha": 1}, "artworkHidden": false, )"
              R"("opens": {"activityType": "com.zentu.Orvo.Transit.Incident", )"
              R"("lineMuid": "18446744073709551615"}}, )"
              R"({"kind": "item", "primaryText": "Good service", "secondaryText": "1 line", )"
              R"("artwork": {"image": "good-alt-v2", "alpha": 0.3}, "artworkHidden": false, )"
              R"("opens": {"url": "orvo://?favorites=2&t=r&session=S1"}}]})"
              "\n");
}

TEST_F(JsonPrinterTest, AnErrorRowHasNullsAndNoExpandedRows) {
    const auto text = oneLine(testing::widgetOfResult(testing::failure(), 0));
    EXPECT_NE(text.find(R"("artwork": null, "artworkHidden": true, "opens": null})"),
              std::string::npos)
        << text;
    EXPECT_NE(text.find(R"("expanded": []})"), std::string::npos);
}

TEST_F(JsonPrinterTest, TheGenericImagesAlphaKeepsEveryDigit) {
    PrintedWidget widget;
    widget.summary.artwork = PrintedArtwork{.image = "WidgetGenericTransit", .alpha = 0.3F};
    EXPECT_NE(oneLine(widget).find(R"("alpha": 0.30000001192092896)"), std::string::npos);
}

TEST_F(JsonPrinterTest, PayloadsAreLeftOutUnlessAskedFor) {
    const auto widget = widgetOf({line(1, "U1", {incident(11)})});
    EXPECT_EQ(oneLine(widget).find("userInfo"), std::string::npos);
    const auto text = oneLine(widget, Payloads::WithUserInfo);
    EXPECT_NE(text.find(R"("userInfo": {"bs": "Qlpo)"), std::string::npos) << text;
    EXPECT_NE(text.find(R"("com.zentu.Orvo.sharedSession": "S1"})"), std::string::npos);
}

TEST_F(JsonPrinterTest, DataIsPaddedBase64) {
    EXPECT_EQ(userInfo(""), R"({"k": ""})");
    EXPECT_EQ(userInfo("f"), R"({"k": "Zg=="})");
    EXPECT_EQ(userInfo("fo"), R"({"k": "Zm8="})");
    EXPECT_EQ(userInfo("foobar"), R"({"k": "Zm9vYmFy"})");
    EXPECT_EQ(userInfo("\xFB\xFF\xFE"), R"({"k": "+//+"})");
}

TEST_F(JsonPrinterTest, ControlCharactersAndPercentSignsAreEscapedOrLeftAlone) {
    const auto text = oneLine(widgetOf({line(1, "U\x1b", {incident(11, "100 %@")})}));
    EXPECT_NE(text.find(R"(["U\u001b"])"), std::string::npos) << text;
    EXPECT_NE(text.find("\"100 %@\""), std::string::npos);
}

} // namespace
} // namespace orvo
