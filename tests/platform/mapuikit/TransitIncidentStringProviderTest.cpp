#include "platform/mapuikit/TransitIncidentStringProvider.h"

#include "platform/geoservices/TransitIncidentRecord.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using Text = std::optional<std::string>;

std::shared_ptr<TransitIncident> incidentWith(Text title, Text summary) {
    TransitIncidentRecord::Fields fields;
    fields.title = std::move(title);
    fields.summary = std::move(summary);
    fields.fullDescription = "a full description";
    return TransitIncidentRecord::initWithFields(std::move(fields));
}

class IncidentStrings : public ::testing::Test {
protected:
    /// The text comes out the same as a title and as a summary.
    void expect(const std::string& given, const std::string& shown) const {
        EXPECT_EQ(_provider->cellTitleForIncident(incidentWith(given, "other")), shown);
        EXPECT_EQ(_provider->cellSecondaryTextForIncident(incidentWith("other", given)), shown);
    }
    Text title(const std::shared_ptr<TransitIncident>& incident) const {
        return _provider->cellTitleForIncident(incident);
    }
    Text secondary(const std::shared_ptr<TransitIncident>& incident) const {
        return _provider->cellSecondaryTextForIncident(incident);
    }

private:
    std::shared_ptr<TransitIncidentStringProvider> _provider =
        std::make_shared<TransitIncidentStringProvider>();
};

TEST_F(IncidentStrings, TitleAndSummaryAreTwoTexts) {
    const auto incident = incidentWith("No service", "A signal failed");
    EXPECT_EQ(title(incident), "No service");
    EXPECT_EQ(secondary(incident), "A signal failed");
}

TEST_F(IncidentStrings, ANilIncidentHasNone) {
    EXPECT_EQ(title(nullptr), std::nullopt);
    EXPECT_EQ(secondary(nullptr), std::nullopt);
}

TEST_F(IncidentStrings, AMissingTextIsNilAndNotReplacedByAnother) {
    EXPECT_EQ(title(incidentWith(std::nullopt, "summary")), std::nullopt);
    EXPECT_EQ(secondary(incidentWith("title", std::nullopt)), std::nullopt);
}

TEST_F(IncidentStrings, AnEmptyTextStaysAnEmptyTextAndOneOfBlanksBecomesOne) {
    expect("", "");
    expect(" \t\r\n\u2028\u2029 ", "");
}

TEST_F(IncidentStrings, EveryLineBreakBecomesOneBlank) {
    const std::vector<const char*> lineBreaks = {
        "\n", "\r", "\r\n", "\v", "\f", "\u2028", "\u2029"};
    for (const std::string lineBreak : lineBreaks) {
        SCOPED_TRACE(::testing::PrintToString(lineBreak));
        expect("No" + lineBreak + "service", "No service");
        expect("No" + lineBreak + lineBreak + "service" + lineBreak + "today", "No service today");
    }
}

TEST_F(IncidentStrings, TabsAndRepeatedBlanksBecomeOneBlank) {
    expect("No\tservice", "No service");
    expect("No   service", "No service");
    expect("No \t \r\n \u2028\u2029\n service", "No service");
}

TEST_F(IncidentStrings, LeadingAndTrailingBlanksGo) {
    for (const std::string blank : {" ", "\t", "\n", "\r\n", "\u2028", "\u2029", " \n "}) {
        SCOPED_TRACE(::testing::PrintToString(blank));
        expect(blank + "No service", "No service");
        expect("No service" + blank, "No service");
        expect(blank + "No service" + blank, "No service");
    }
}

TEST_F(IncidentStrings, ANoBreakSpaceStays) {
    expect("Line\u00A07 \u00A0", "Line\u00A07 \u00A0");
}

TEST_F(IncidentStrings, CharactersWhoseBytesBeginLikeASeparatorStayWhole) {
    expect("\u2020 \u2027\u202A\u00E9", "\u2020 \u2027\u202A\u00E9");
    expect("cut off\xE2\x80", "cut off\xE2\x80");
    expect("cut off\xE2", "cut off\xE2");
}

TEST(SharedIncidentStrings, AreOneProviderThatCanBeReplaced) {
    const auto standard = TransitIncidentStringProvider::sharedProvider();
    ASSERT_TRUE(standard);
    EXPECT_EQ(TransitIncidentStringProvider::sharedProvider(), standard);
    const auto other = std::make_shared<TransitIncidentStringProvider>();
    {
        const auto replaced = TransitIncidentStringProvider::provider().overrideWith(other);
        EXPECT_EQ(TransitIncidentStringProvider::sharedProvider(), other);
    }
    EXPECT_EQ(TransitIncidentStringProvider::sharedProvider(), standard);
}

} // namespace
} // namespace orvo
