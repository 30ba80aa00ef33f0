#include "platform/feeds/alerts/IncidentWords.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(IncidentWords, HasAnEffectAndACauseForEveryNumber) {
    for (const char* const language : {"en", "de"}) {
        const IncidentWords words(language);
        for (std::int32_t effect = 1; effect <= 11; ++effect)
            EXPECT_FALSE(words.effect(static_cast<IncidentEffect>(effect)).empty());
        for (std::int32_t cause = 3; cause <= 12; ++cause)
            EXPECT_NE(words.effect_cause(IncidentEffect::Detour, static_cast<IncidentCause>(cause)),
                      words.effect(IncidentEffect::Detour));
    }
}

TEST(IncidentWords, CauseAndEffectAreOnePhrase) {
    EXPECT_EQ(
        IncidentWords("en").effect_cause(IncidentEffect::StopMoved, IncidentCause::Construction),
        "Stop moved due to construction work");
    EXPECT_EQ(IncidentWords("de").effect_cause(IncidentEffect::Detour, IncidentCause::Strike),
              "Umleitung wegen eines Streiks");
}

TEST(IncidentWords, WithoutAKnownCauseThereIsOnlyTheEffect) {
    const IncidentWords words("en");
    EXPECT_EQ(words.effect_cause(IncidentEffect::Detour, IncidentCause::UnknownCause), "Detour");
    EXPECT_EQ(words.effect_cause(IncidentEffect::Detour, IncidentCause::OtherCause), "Detour");
    EXPECT_EQ(words.effect_cause(IncidentEffect::Detour, static_cast<IncidentCause>(99)), "Detour");
    EXPECT_EQ(words.effect(static_cast<IncidentEffect>(99)), "Service notice");
}

TEST(IncidentWords, LanguagesWithoutATableAreEnglish) {
    EXPECT_EQ(IncidentWords("fr").statusUnknown(), "Status unknown");
    EXPECT_EQ(IncidentWords("").statusUnknown(), "Status unknown");
    EXPECT_EQ(IncidentWords("DE_at").statusUnknown(), "Status unbekannt");
}

TEST(IncidentWords, TellsAnAgeInItsLargestUnit) {
    const IncidentWords words("en");
    const auto ago = [&](double age) {
        return words.lastKnown("", age);
    };
    EXPECT_EQ(ago(0), "Last known less than a minute ago");
    EXPECT_EQ(ago(59), "Last known less than a minute ago");
    EXPECT_EQ(ago(60), "Last known 1 minute ago");
    EXPECT_EQ(ago(3599), "Last known 59 minutes ago");
    EXPECT_EQ(ago(3600), "Last known 1 hour ago");
    EXPECT_EQ(ago(86399), "Last known 23 hours ago");
    EXPECT_EQ(ago(86400 * 400), "Last known 400 days ago");
}

TEST(IncidentWords, NamesTheSystemBeforeTheAge) {
    EXPECT_EQ(IncidentWords("en").lastKnown("Metro", 2100), "Metro, last known 35 minutes ago");
    EXPECT_EQ(IncidentWords("en").lastKnown("Metro", std::nullopt), "Metro, nothing known yet");
    EXPECT_EQ(IncidentWords("en").lastKnown("", std::nullopt), "Nothing known yet");
    EXPECT_EQ(IncidentWords("en").lastKnown("{} Ltd", 60), "{} Ltd, last known 1 minute ago");
}

} // namespace orvo::testing
