#include "platform/feeds/alerts/LanguagePreference.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

using Texts = AlertTexts;

/// Texts that say what their tags are.
Texts tagged(const std::vector<std::string_view>& tags) {
    Texts texts;
    for (const std::string_view tag : tags)
        texts.push_back({tag.empty() ? "untagged" : tag, tag});
    return texts;
}

std::string best(std::string_view person,
                 const std::vector<std::string_view>& tags,
                 std::string_view agency = "") {
    const Texts texts = tagged(tags);
    const auto preference = LanguagePreference::forPerson(person, agency);
    const AlertText* const text = preference.best(texts);
    return text ? std::string(text->text) : "none";
}

std::string bestForAgency(std::string_view agency, const std::vector<std::string_view>& tags) {
    const Texts texts = tagged(tags);
    return std::string(LanguagePreference::forAgency(agency).best(texts)->text);
}

std::string pair(std::string_view person,
                 const std::vector<std::string_view>& headers,
                 const std::vector<std::string_view>& descriptions) {
    const Texts header = tagged(headers);
    const Texts description = tagged(descriptions);
    const auto chosen = LanguagePreference::forPerson(person, "").bestPair(header, description);
    return std::string(chosen.header ? chosen.header->text : "none") + "/" +
           std::string(chosen.description ? chosen.description->text : "none");
}

} // namespace

TEST(LanguagePreference, TakesTheExactTagFirst) {
    EXPECT_EQ(best("fr-CA", {"en", "fr", "fr-CA"}), "fr-CA");
    EXPECT_EQ(best("fr", {"en", "fr-CA", "fr"}), "fr");
}

TEST(LanguagePreference, CaseDoesNotCountAndUnderscoresAreHyphens) {
    EXPECT_EQ(best("pt-BR", {"pt", "PT_br"}), "PT_br");
    EXPECT_EQ(best("PT_BR", {"pt", "pt-br"}), "pt-br");
}

TEST(LanguagePreference, ThenTheSameLanguageAndScript) {
    EXPECT_EQ(best("zh-TW", {"zh-Hans", "zh-Hant-HK"}), "zh-Hant-HK");
    EXPECT_EQ(best("zh-CN", {"zh-Hant-HK", "zh-Hans"}), "zh-Hans");
    EXPECT_EQ(best("sr-Latn", {"sr", "sr-Latn-RS"}), "sr-Latn-RS");
}

TEST(LanguagePreference, ThenTheSameLanguage) {
    EXPECT_EQ(best("zh-TW", {"en", "zh-Hans"}, "en"), "zh-Hans");
    EXPECT_EQ(best("fr-CH", {"en", "fr-CA"}, "en"), "fr-CA");
}

TEST(LanguagePreference, OldAndWiderCodesAreTheSameLanguage) {
    EXPECT_EQ(best("nb", {"en", "no"}), "no");
    EXPECT_EQ(best("no", {"en", "nb"}), "nb");
    EXPECT_EQ(best("nb", {"no", "nb", "nn"}), "nb");
    EXPECT_EQ(best("he", {"en", "iw"}), "iw");
}

TEST(LanguagePreference, ThenTheAgencysThenUntaggedThenEnglishThenTheFirst) {
    EXPECT_EQ(best("de", {"fr", "en", "", "nl"}, "nl"), "nl");
    EXPECT_EQ(best("de", {"fr", "en", "nl-BE", ""}, "nl"), "nl-BE");
    EXPECT_EQ(best("de", {"fr", "en", ""}, "nl"), "untagged");
    EXPECT_EQ(best("de", {"fr", "en"}, "nl"), "en");
    EXPECT_EQ(best("de", {"fr", "it"}, "nl"), "fr");
    EXPECT_EQ(best("de", {}), "none");
}

TEST(LanguagePreference, OfEquallyGoodOnesTheFirst) {
    EXPECT_EQ(best("fr", {"fr-BE", "fr-CA"}), "fr-BE");
}

TEST(LanguagePreference, HTMLVariantsAreTakenOnlyWhereThereIsNoOther) {
    EXPECT_EQ(best("en", {"en-html", "fr"}), "fr");
    EXPECT_EQ(best("en", {"en/html", "en"}), "en");
    EXPECT_EQ(best("en", {"en_HTML", "html"}), "en_HTML");
}

TEST(LanguagePreference, WithoutAPersonsLanguageTheAgencysCounts) {
    EXPECT_EQ(best("", {"en", "fr"}, "fr"), "fr");
    EXPECT_EQ(best("", {"en", ""}), "untagged");
}

TEST(LanguagePreference, ForTheAgencyThereIsOnlyItsLanguageAndTheFirst) {
    EXPECT_EQ(bestForAgency("fr", {"en", "", "fr-FR"}), "fr-FR");
    EXPECT_EQ(bestForAgency("de", {"fr", "en", ""}), "fr");
    EXPECT_EQ(bestForAgency("", {"fr", "en"}), "fr");
    EXPECT_EQ(bestForAgency("", {"fr-html", "en"}), "en");
}

TEST(LanguagePreference, HeaderAndDescriptionAreInOneLanguage) {
    EXPECT_EQ(pair("fr", {"en", "fr"}, {"en", "fr"}), "fr/fr");
    EXPECT_EQ(pair("fr", {"en", "fr"}, {"en"}), "en/en");
    EXPECT_EQ(pair("fr", {"en"}, {"en", "fr"}), "en/en");
    EXPECT_EQ(pair("fr", {"en", "fr-CA"}, {"en", "fr"}), "fr-CA/fr");
}

TEST(LanguagePreference, WhereNoLanguageHasBothEachIsChosenForItself) {
    EXPECT_EQ(pair("fr", {"en", "fr"}, {"nl"}), "fr/nl");
    EXPECT_EQ(pair("fr", {"en", "fr"}, {}), "fr/none");
    EXPECT_EQ(pair("fr", {}, {"en", "fr"}), "none/fr");
}

TEST(LanguagePreference, UntaggedTextsAreAPair) {
    EXPECT_EQ(pair("fr", {"en", ""}, {""}), "untagged/untagged");
}

TEST(LanguagePreference, TagsAreComparedAsTheyAreNormalised) {
    const std::vector<std::string> tags = {
        "", " ", "en", "EN", " en ", "en-US", "en_us", "en/US", "e n", "en-html", "de"};
    for (const std::string& one : tags)
        for (const std::string& other : tags)
            EXPECT_EQ(LanguagePreference::isSameTag(one, other),
                      LanguagePreference::normalisedTag(one) ==
                          LanguagePreference::normalisedTag(other))
                << one << " and " << other;
}

} // namespace orvo::testing
