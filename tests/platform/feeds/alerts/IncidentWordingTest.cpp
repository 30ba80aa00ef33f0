#include "platform/feeds/alerts/IncidentWording.h"

#include "TestLines.h"
#include "platform/feeds/alerts/TextCleaner.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

/// An incident that concerns the line R1, "1 Harbour".
struct Example {
    AlertTexts header = {{"Trams turn early", "en"}};
    AlertTexts description = {{"No trams beyond the bridge.", "en"}};
    AlertTexts spokenHeader;
    AlertTexts link;
    IncidentCause cause = IncidentCause::UnknownCause;
    std::string person = "en";

    IncidentTexts texts() const {
        const auto index = smallIndex();
        const LineTable table(index);
        AlertStatistics statistics;
        SelectorResolver resolver(table, statistics);
        ConcernedLines lines(resolver);
        Alert alert;
        alert.selectors.resize(1);
        alert.selectors[0].routeId = "R1";
        Incident incident;
        incident.effect = static_cast<std::int32_t>(IncidentEffect::Detour);
        incident.members = {{&alert, 0}};
        incident.header = header;
        incident.description = description;
        incident.spokenHeader = spokenHeader;
        incident.link = link;
        lines.find(incident);
        return IncidentWording(person, "en").textsOf(incident, lines, cause);
    }
};

std::string summaryOf(std::string_view description, std::string_view header) {
    std::string room;
    return std::string(IncidentWording::summaryOf(description, header, room));
}

} // namespace

TEST(IncidentWording, TheHeaderIsTheTitleAndTheDescriptionTheSummary) {
    const IncidentTexts texts = Example().texts();
    EXPECT_EQ(texts.title, "Trams turn early");
    EXPECT_EQ(texts.summary, "No trams beyond the bridge.");
    EXPECT_TRUE(texts.isSummaryWhole);
    EXPECT_EQ(texts.fullDescription, std::nullopt);
    EXPECT_EQ(texts.spokenTitle, std::nullopt);
    EXPECT_EQ(texts.link, std::nullopt);
}

TEST(IncidentWording, ABlankTitleIsTheEffectInWords) {
    Example example;
    for (const AlertTexts& header : {AlertTexts{}, {{"<p> </p>", "en"}}, {{"&nbsp;", "en"}}}) {
        example.header = header;
        EXPECT_EQ(example.texts().title, "Detour");
    }
}

TEST(IncidentWording, ATitleThatIsOnlyTheLinesNameIsTheEffectInWords) {
    Example example;
    for (const char* const name : {"1", "Harbour", "1 Harbour", "HARBOUR (1)"}) {
        example.header = {{name, "en"}};
        EXPECT_EQ(example.texts().title, "Detour") << name;
    }
    example.header = {{"1 Harbour closed", "en"}};
    EXPECT_EQ(example.texts().title, "1 Harbour closed");
    example.header = {{"2 Castle", "en"}};
    EXPECT_EQ(example.texts().title, "2 Castle");
}

TEST(IncidentWording, TheSummaryIsTheFirstParagraphOnOneLine) {
    Example example;
    example.description = {{"One\ntwo.\n\nThree.", "en"}};
    EXPECT_EQ(example.texts().summary, "One two.");
    EXPECT_EQ(example.texts().fullDescription, "One\ntwo.\n\nThree.");
    EXPECT_FALSE(example.texts().isSummaryWhole);
}

TEST(IncidentWording, ADescriptionThatRepeatsTheTitleIsNoSummary) {
    Example example;
    example.header = {};
    example.description = {{"Detour", "en"}}; // what the effect is called
    const IncidentTexts texts = example.texts();
    EXPECT_EQ(texts.title, "Detour");
    EXPECT_EQ(texts.summary, std::nullopt);
    EXPECT_FALSE(texts.isSummaryWhole);
    EXPECT_EQ(texts.fullDescription, "Detour");
}

TEST(IncidentWording, ARepeatedHeaderIsLeftOutOfTheSummary) {
    const auto summary = [](const char* description) {
        return summaryOf(description, "Line 5 delayed");
    };
    EXPECT_EQ(summary("Line 5 delayed\n\nA fire."), "A fire.");
    EXPECT_EQ(summary("Line 5 delayed\nA fire."), "A fire.");
    EXPECT_EQ(summary("Line 5 delayed. A fire."), "A fire.");
    EXPECT_EQ(summary("Line 5 delayed: a fire."), "a fire.");
    EXPECT_EQ(summary("Line 5 delayed – a fire."), "a fire.");
    EXPECT_EQ(summary("Line 5 delayed - a fire."), "a fire.");
    EXPECT_EQ(summary("Line 5 delayed"), "");
    EXPECT_EQ(summary("Line 5 delayed.\n\nLine 5 delayed.\n\nA fire."), "A fire.");
}

TEST(IncidentWording, ASentenceThatOnlyBeginsLikeTheHeaderStaysWhole) {
    EXPECT_EQ(summaryOf("Delays on line 5.", "Delays"), "Delays on line 5.");
    EXPECT_EQ(summaryOf("Delayed.", "Delay"), "Delayed.");
    EXPECT_EQ(summaryOf("A fire.", ""), "A fire.");
    EXPECT_EQ(summaryOf("", "Delays"), "");
}

TEST(IncidentWording, WithoutADescriptionTheSummaryIsCauseAndEffectInWords) {
    Example example;
    example.description.clear();
    example.cause = IncidentCause::Strike;
    EXPECT_EQ(example.texts().summary, "Detour due to a strike");
    EXPECT_EQ(example.texts().fullDescription, std::nullopt);
    example.cause = IncidentCause::UnknownCause;
    EXPECT_EQ(example.texts().summary, "Detour");
}

TEST(IncidentWording, ASummaryThatWouldRepeatTheTitleIsNone) {
    Example example;
    example.header.clear();
    example.description.clear();
    EXPECT_EQ(example.texts().title, "Detour");
    EXPECT_EQ(example.texts().summary, std::nullopt);
}

TEST(IncidentWording, ComposedWordsAreInThePersonsLanguage) {
    Example example;
    example.person = "de";
    example.header.clear();
    EXPECT_EQ(example.texts().title, "Umleitung");
}

TEST(IncidentWording, HeaderAndDescriptionAreChosenAsAPair) {
    Example example;
    example.person = "fr";
    example.header = {{"Early", "en"}, {"Tôt", "fr"}};
    example.description = {{"Bridge", "en"}, {"Pont", "fr"}};
    EXPECT_EQ(example.texts().title, "Tôt");
    EXPECT_EQ(example.texts().summary, "Pont");
    example.description = {{"Bridge", "en"}};
    EXPECT_EQ(example.texts().title, "Early");
}

TEST(IncidentWording, TextsAreCapped) {
    Example example;
    const std::string title(500, 'a');
    const std::string text(30'000, 'b');
    example.header = {{title, "en"}};
    example.description = {{text, "en"}};
    EXPECT_EQ(example.texts().title.size(), TextCleaner::LongestTitle);
    EXPECT_EQ(example.texts().summary->size(), TextCleaner::LongestText);
    EXPECT_TRUE(example.texts().isSummaryWhole);
    const std::string paragraphs = "One.\n\n" + text;
    example.description = {{paragraphs, "en"}};
    EXPECT_EQ(example.texts().summary, "One.");
    EXPECT_EQ(example.texts().fullDescription->size(), TextCleaner::LongestText);
}

TEST(IncidentWording, TheSpokenTitleIsOfTheSameLanguageAndNotTheTitleAgain) {
    Example example;
    example.spokenHeader = {{"Les trams", "fr"}, {"Trams turn round early", "en"}};
    EXPECT_EQ(example.texts().spokenTitle, "Trams turn round early");
    example.spokenHeader = {{"Trams turn early", "en"}};
    EXPECT_EQ(example.texts().spokenTitle, std::nullopt);
    example.spokenHeader = {{"Les trams", "fr"}};
    EXPECT_EQ(example.texts().spokenTitle, std::nullopt);
    example.spokenHeader = {{"Trams turn round early", "en"}};
    example.header = {{"1 Harbour", "en"}};
    EXPECT_EQ(example.texts().spokenTitle, std::nullopt);
}

TEST(IncidentWording, LinksAreWebAddressesOnly) {
    const auto link = [](const char* text) {
        Example example;
        example.link = {{text, "en"}};
        return example.texts().link;
    };
    EXPECT_EQ(link("https://example.invalid/a?b=1&amp;c=2"), "https://example.invalid/a?b=1&c=2");
    EXPECT_EQ(link(" http://example.invalid "), "http://example.invalid");
    EXPECT_EQ(link("javascript:alert(1)"), std::nullopt);
    EXPECT_EQ(link("file:///etc/passwd"), std::nullopt);
    EXPECT_EQ(link("https://example.invalid/a b"), std::nullopt);
    EXPECT_EQ(link("www.example.invalid"), std::nullopt);
}

} // namespace orvo::testing
