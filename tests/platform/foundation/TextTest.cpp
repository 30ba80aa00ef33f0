#include "platform/foundation/Text.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdlib>

namespace orvo::TextTests {
namespace {

using Strings = std::vector<std::string>;

class TextTest : public ::testing::Test {
protected:
    void speak(const char* tag) {
        _locale.reset();
        _locale.emplace(Text::locale().overrideWith(tag));
    }
    static Strings words(std::string_view text) {
        Strings found;
        for (const auto& word : Text::words(text))
            found.push_back(word.text);
        return found;
    }
    static std::string range(std::string_view text, std::string_view needle) {
        const auto found = Text::localizedStandardRange(text, needle);
        return found ? "{" + std::to_string(found->location) + "," + std::to_string(found->length) +
                           "}"
                     : "nothing";
    }

private:
    std::optional<EnvironmentSlot<std::string>::Override> _locale =
        Text::locale().overrideWith("en");
};

TEST_F(TextTest, WordsAreWhatStandsBetweenBlanksAndPunctuation) {
    EXPECT_EQ(words("New York, 7th Av. (Line 2/3)"),
              (Strings{"New", "York", "7th", "Av", "Line", "2", "3"}));
    EXPECT_EQ(words("don't stop"), (Strings{"don't", "stop"}));
}

TEST_F(TextTest, TextWithoutWordsHasNone) {
    EXPECT_EQ(words(""), Strings{});
    EXPECT_EQ(words(" \t\n"), Strings{});
    EXPECT_EQ(words("… – (!) → €"), Strings{});
}

TEST_F(TextTest, WordsHaveRangesInUTF16Units) {
    const auto found = Text::words("🚇 Zürich 🚋 東京");
    ASSERT_EQ(found.size(), 2U);
    EXPECT_EQ(found[0].text, "Zürich");
    EXPECT_EQ(found[0].range, (NSRange{3, 6}));
    EXPECT_EQ(found[1].text, "東京");
    EXPECT_EQ(found[1].range, (NSRange{13, 2}));
}

TEST_F(TextTest, ChineseAndJapaneseWordsAreFoundByDictionary) {
    speak("ja");
    EXPECT_EQ(words("東京都交通局"), (Strings{"東京", "都", "交通局"}));
    EXPECT_EQ(words("山手線の電車"), (Strings{"山手線", "の", "電車"}));
    speak("zh");
    EXPECT_EQ(words("北京地铁十号线"), (Strings{"北京", "地铁", "十", "号", "线"}));
}

TEST_F(TextTest, ThaiWordsAreFoundByDictionary) {
    speak("th");
    EXPECT_EQ(words("รถไฟฟ้าสายสีเขียว"), (Strings{"รถไฟฟ้า", "สาย", "สี", "เขียว"}));
}

TEST_F(TextTest, ArabicWordsStandBetweenBlanks) {
    speak("ar");
    EXPECT_EQ(words("محطة المترو، الخط ٢"), (Strings{"محطة", "المترو", "الخط", "٢"}));
}

TEST_F(TextTest, CaseAndAccentsDoNotCountInASearch) {
    EXPECT_EQ(range("Línea 5", "linea"), "{0,5}");
    EXPECT_EQ(range("linea 5", "LÍNEA"), "{0,5}");
    EXPECT_EQ(range("Central Park", "park"), "{8,4}");
    EXPECT_EQ(range("Central Park", "park "), "nothing");
    EXPECT_EQ(range("Ｌｉｎｅ", "line"), "{0,4}"); // full width
}

TEST_F(TextTest, TheFirstPlaceIsFound) {
    EXPECT_EQ(range("Bananas", "an"), "{1,2}");
    EXPECT_EQ(range("York New York", "york"), "{0,4}");
}

TEST_F(TextTest, AComposedCharacterAndItsPartsAreTheSame) {
    EXPECT_EQ(range("Zu\u0308rich", "zürich"), "{0,7}");
    EXPECT_EQ(range("Zürich", "zu\u0308rich"), "{0,6}");
}

TEST_F(TextTest, GermanSearchTakesSharpSForTwo) {
    speak("de");
    EXPECT_EQ(range("Hauptstraße 3", "STRASSE"), "{5,6}");
    EXPECT_EQ(range("Hauptstrasse", "straße"), "{5,7}");
    EXPECT_EQ(range("Köln", "koln"), "{0,4}");
}

TEST_F(TextTest, WhatIsALetterOfItsOwnDependsOnTheLanguage) {
    EXPECT_EQ(range("Øresund", "ore"), "{0,3}");
    speak("da");
    EXPECT_EQ(range("Øresund", "ore"), "nothing");
    EXPECT_EQ(range("Øresund", "ØRE"), "{0,3}");
    EXPECT_EQ(range("Aarhus", "århus"), "{0,6}"); // there one letter in two spellings
}

TEST_F(TextTest, ArabicVowelSignsDoNotCount) {
    speak("ar");
    EXPECT_EQ(range("مَدْرَسَة", "مدرسة"), "{0,9}");
}

TEST_F(TextTest, ThaiAndChineseAreSearched) {
    speak("th");
    EXPECT_EQ(range("รถไฟฟ้าสายสีเขียว", "สาย"), "{7,3}");
    speak("zh");
    EXPECT_EQ(range("北京地铁十号线", "地铁"), "{2,2}");
}

TEST_F(TextTest, NothingToSearchForIsNowhere) {
    EXPECT_EQ(range("Line", ""), "nothing");
    EXPECT_EQ(range("", "line"), "nothing");
    EXPECT_EQ(range("", ""), "nothing");
    EXPECT_EQ(range("Line", "\u0301"), "nothing"); // an accent alone
    EXPECT_EQ(range("Line", "\u200D"), "nothing"); // ignored at every strength
}

TEST_F(TextTest, AnUnknownLanguageSearchesByTheCommonRules) {
    speak("not a language");
    EXPECT_EQ(range("Línea", "linea"), "{0,5}");
    EXPECT_EQ(words("Line 7"), (Strings{"Line", "7"}));
}

TEST_F(TextTest, BadBytesAreNoReasonToStop) {
    EXPECT_EQ(range("\xFF\xFELine", "line"), "{2,4}");
    EXPECT_EQ(words("\xC3Line"), Strings{"Line"});
}

TEST(Text, LengthsAreInUTF16Units) {
    EXPECT_EQ(Text::utf16Length(""), 0U);
    EXPECT_EQ(Text::utf16Length("Linie"), 5U);
    EXPECT_EQ(Text::utf16Length("Zürich"), 6U);
    EXPECT_EQ(Text::utf16Length("東京"), 2U);
    EXPECT_EQ(Text::utf16Length("🚇"), 2U);
    for (const char* text : {"a\xFF", "\xE6\x9D", "\xED\xA0\x80", "\xF0\x9F\x9A"})
        EXPECT_EQ(Text::utf16Length(text), Text::utf16(text).size());
}

TEST(Text, BothEncodingsHoldTheSameText) {
    const std::string text = "Zü東🚇\u007F\u0080\u07FF\u0800\uFFFF\U00010000\U0010FFFF";
    EXPECT_EQ(Text::utf16("Zü東🚇"), u"Zü東🚇");
    EXPECT_EQ(Text::utf8(Text::utf16(text)), text);
}

TEST(Text, WhatIsNoTextIsReplaced) {
    EXPECT_EQ(Text::utf16("a\xFFz"), u"a\uFFFDz");
    EXPECT_EQ(Text::utf8(std::u16string(1, char16_t{0xD83D})), "\uFFFD");
    EXPECT_EQ(Text::utf8(std::u16string{char16_t{0xDC00}, u'x'}), "\uFFFDx");
    EXPECT_EQ(Text::utf8(std::u16string{char16_t{0xD83D}, char16_t{0xD83D}, char16_t{0xDE87}}),
              "\uFFFD🚇");
}

TEST(Text, ValidityIsThatOfEveryByte) {
    EXPECT_TRUE(Text::isValidUTF8(""));
    EXPECT_TRUE(Text::isValidUTF8("Zü東🚇"));
    EXPECT_TRUE(Text::isValidUTF8(std::string_view("\0", 1)));
    for (const char* bad : {"\x80", "\xC0\x80", "\xED\xA0\x80", "\xF4\x90\x80\x80", "\xFF"})
        EXPECT_FALSE(Text::isValidUTF8(bad));
    const std::string whole = "東🚇";
    for (const std::size_t cut : {1U, 2U, 4U, 5U, 6U})
        EXPECT_FALSE(Text::isValidUTF8(std::string_view(whole).substr(0, cut))) << cut;
}

/// Sets variables of the process for a scope; nil unsets one.
class Variables {
public:
    Variables(const char* all, const char* messages, const char* lang)
        : _earlier{read("LC_ALL"), read("LC_MESSAGES"), read("LANG")} {
        put({text(all), text(messages), text(lang)});
    }
    Variables(const Variables&) = delete;
    Variables& operator=(const Variables&) = delete;
    ~Variables() { put(_earlier); }

private:
    using Text = std::optional<std::string>;

    static Text text(const char* value) { return value ? Text(value) : std::nullopt; }
    static Text read(const char* name) { return text(std::getenv(name)); }
    static void put(const std::array<Text, 3>& values) {
        const std::array<const char*, 3> names{"LC_ALL", "LC_MESSAGES", "LANG"};
        for (std::size_t i = 0; i < names.size(); ++i)
            if (values[i])
                setenv(names[i], values[i]->c_str(), 1);
            else
                unsetenv(names[i]);
    }

    std::array<Text, 3> _earlier;
};

TEST(Text, TheLanguageIsThatOfTheFirstVariableThatIsSet) {
    const auto language = [](const char* all, const char* messages, const char* lang) {
        const Variables variables(all, messages, lang);
        return Text::defaultLocale();
    };
    EXPECT_EQ(language("de_CH.UTF-8", "fr_FR", "it_IT"), "de-CH");
    EXPECT_EQ(language(nullptr, "fr_FR@euro", "it_IT"), "fr-FR");
    EXPECT_EQ(language("", nullptr, "ja"), "ja");
    EXPECT_EQ(language("C.UTF-8", "fr_FR", "it_IT"), "en");
    EXPECT_EQ(language(nullptr, nullptr, "POSIX"), "en");
    EXPECT_EQ(language(nullptr, nullptr, nullptr), "en");
}

TEST(Text, KnowsWhichLanguagesReadFromTheRight) {
    for (const char* tag : {"ar", "he-IL", "fa", "az-Arab"})
        EXPECT_TRUE(Text::isRightToLeft(tag)) << tag;
    for (const char* tag : {"en", "de-CH", "az-Latn", "", "?"})
        EXPECT_FALSE(Text::isRightToLeft(tag)) << tag;
}

} // namespace
} // namespace orvo::TextTests
