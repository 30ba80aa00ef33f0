#include "platform/uikit/text/TextLayout.h"

#include "support/FixedTextMeasurer.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Texts = std::vector<std::string>;

/// Characters are 5 points wide and lines 10 high.
class TextLayoutTest : public ::testing::Test {
protected:
    static TextLayout::Request request(const std::string& text) {
        return {.text = text, .runs = {{0, text.size(), {.pointSize = 10}}}};
    }
    static TextLines
    linesOf(const std::string& text, double width, std::size_t maximum = TextLayout::AnyNumber) {
        return TextLayout(request(text)).lines(width, maximum);
    }
    static Texts textsOf(const TextLines& lines) {
        Texts texts;
        for (const auto& line : lines.lines)
            texts.push_back(line.text);
        return texts;
    }
    static Texts
    wrap(const std::string& text, double width, std::size_t maximum = TextLayout::AnyNumber) {
        return textsOf(linesOf(text, width, maximum));
    }

private:
    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override _measurer =
        TextMeasurer::shared().overrideWith(std::make_shared<testing::FixedTextMeasurer>());
};

TEST_F(TextLayoutTest, TextThatFitsIsOneLine) {
    const auto lines = linesOf("Green Line", 50);
    ASSERT_EQ(lines.lines.size(), 1U);
    EXPECT_EQ(lines.lines[0].text, "Green Line");
    EXPECT_DOUBLE_EQ(lines.lines[0].width, 50);
    EXPECT_FALSE(lines.truncated());
    EXPECT_DOUBLE_EQ(lines.height(), 10);
    EXPECT_DOUBLE_EQ(lines.baselineOf(0), 8);
}

TEST_F(TextLayoutTest, WrapsBetweenWordsAndLeavesTheSpaceOut) {
    EXPECT_EQ(wrap("one two three", 35), (Texts{"one two", "three"}));
    EXPECT_EQ(wrap("one two three", 34), (Texts{"one", "two", "three"}));
}

TEST_F(TextLayoutTest, WidthOfALineLeavesOutTheSpaceAtItsEnd) {
    EXPECT_DOUBLE_EQ(linesOf("one  two", 20).lines[0].width, 15);
}

TEST_F(TextLayoutTest, ParagraphsBeginNewLinesAndEmptyOnesTakeRoom) {
    EXPECT_EQ(wrap("a\n\nb c", 100), (Texts{"a", "", "b c"}));
    EXPECT_DOUBLE_EQ(linesOf("a\n\nb", 100).height(), 30);
    EXPECT_EQ(wrap("a\r\nb", 100), (Texts{"a", "b"}));
    EXPECT_EQ(wrap("a\u2029b", 100), (Texts{"a", "b"}));
}

TEST_F(TextLayoutTest, LineBreakAtTheEndAddsNoLine) {
    EXPECT_EQ(wrap("a\n", 100), (Texts{"a"}));
}

TEST_F(TextLayoutTest, EmptyTextHasNoLines) {
    EXPECT_TRUE(wrap("", 100).empty());
    EXPECT_DOUBLE_EQ(linesOf("", 100).height(), 0);
}

TEST_F(TextLayoutTest, WordWiderThanTheLineIsPartedBetweenCharacters) {
    EXPECT_EQ(wrap("abcdefgh ij", 20), (Texts{"abcd", "efgh", "ij"}));
}

TEST_F(TextLayoutTest, LineKeepsAtLeastOneCharacterHoweverNarrow) {
    EXPECT_EQ(wrap("ab", 1), (Texts{"a", "b"}));
    EXPECT_EQ(wrap("ab", 0), (Texts{"a", "b"}));
}

TEST_F(TextLayoutTest, CombiningMarksStayWithTheirLetter) {
    // e and a combining acute accent, twice
    EXPECT_EQ(wrap("e\u0301e\u0301", 5), (Texts{"e\u0301", "e\u0301"}));
    EXPECT_DOUBLE_EQ(linesOf("e\u0301", 100).lines[0].width, 5);
}

TEST_F(TextLayoutTest, EmojiOfSeveralPartsIsOneCharacter) {
    const std::string family = "\U0001F468\u200D\U0001F469\u200D\U0001F467";
    EXPECT_EQ(wrap(family + family, 5), (Texts{family, family}));
    const std::string flag = "\U0001F1E9\U0001F1EA";
    EXPECT_EQ(wrap(flag + flag, 5), (Texts{flag, flag}));
}

TEST_F(TextLayoutTest, LanguagesWithoutSpacesBreakBetweenCharactersOrWords) {
    EXPECT_EQ(wrap("東京駅", 10), (Texts{"東京", "駅"}));
    // "Thai language", two words
    EXPECT_EQ(wrap("ภาษาไทย", 25), (Texts{"ภาษา", "ไทย"}));
}

TEST_F(TextLayoutTest, NoBreakSpaceKeepsWordsTogether) {
    EXPECT_EQ(wrap("Line\u00A0A is", 30), (Texts{"Line\u00A0A", "is"}));
}

TEST_F(TextLayoutTest, HyphenAndSlashMayEndALine) {
    EXPECT_EQ(wrap("Forest-Hills", 35), (Texts{"Forest-", "Hills"}));
}

TEST_F(TextLayoutTest, LastLineOfTooFewEndsInAnEllipsis) {
    const auto lines = linesOf("one two three four", 35, 2);
    EXPECT_EQ(textsOf(lines), (Texts{"one two", "three\u2026"}));
    EXPECT_TRUE(lines.lines[1].truncated);
    EXPECT_FALSE(lines.lines[0].truncated);
    EXPECT_DOUBLE_EQ(lines.lines[1].width, 30);
}

TEST_F(TextLayoutTest, EllipsisFollowsTheLastCharacterThatFitsNotTheLastWord) {
    EXPECT_EQ(wrap("one two three", 45, 1), (Texts{"one two\u2026"}));
    EXPECT_EQ(wrap("one two three", 50, 1), (Texts{"one two t\u2026"}));
    EXPECT_EQ(wrap("one two three", 65, 1), (Texts{"one two three"}));
}

TEST_F(TextLayoutTest, EllipsisStandsWhereParagraphsAreLeftOut) {
    EXPECT_EQ(wrap("one\ntwo", 100, 1), (Texts{"one\u2026"}));
}

TEST_F(TextLayoutTest, EllipsisNeverPartsACharacter) {
    const std::string accented = "e\u0301";
    EXPECT_EQ(wrap(accented + accented + accented, 10, 1), (Texts{accented + "\u2026"}));
}

TEST_F(TextLayoutTest, EllipsisStandsAloneWhereNothingFits) {
    EXPECT_EQ(wrap("word", 4, 1), (Texts{"\u2026"}));
}

TEST_F(TextLayoutTest, CuttingAnEndlessTextLooksOnlyAtWhatFits) {
    const auto counting = std::make_shared<testing::FixedTextMeasurer>();
    const auto scope = TextMeasurer::shared().overrideWith(counting);
    const TextLayout layout(request(std::string(20000, 'x')));
    const auto before = counting->measured;
    EXPECT_EQ(layout.lines(50, 1).lines.front().text, "xxxxxxxxx\u2026");
    EXPECT_LT(counting->measured - before, 5U);
}

TEST_F(TextLayoutTest, DirectionIsThatOfTheFirstLetterElseTheGivenOne) {
    EXPECT_TRUE(linesOf("12 שלום bus", 100).lines[0].rightToLeft);
    EXPECT_FALSE(linesOf("bus שלום", 100).lines[0].rightToLeft);
    auto digits = request("12");
    EXPECT_FALSE(TextLayout(digits).lines(100).lines[0].rightToLeft);
    digits.rightToLeft = true;
    EXPECT_TRUE(TextLayout(digits).lines(100).lines[0].rightToLeft);
}

TEST_F(TextLayoutTest, EveryParagraphHasItsOwnDirection) {
    const auto lines = linesOf("bus\nשלום", 100);
    EXPECT_FALSE(lines.lines[0].rightToLeft);
    EXPECT_TRUE(lines.lines[1].rightToLeft);
}

TEST_F(TextLayoutTest, LineSpacingStandsBetweenLinesOnly) {
    auto spaced = request("one two");
    spaced.lineSpacing = 3;
    const auto lines = TextLayout(spaced).lines(15);
    EXPECT_DOUBLE_EQ(lines.height(), 23);
    EXPECT_DOUBLE_EQ(lines.baselineOf(1), 21);
}

TEST_F(TextLayoutTest, LineIsAsHighAsItsLargestFace) {
    TextLayout::Request mixed{.text = "one two",
                              .runs = {{0, 4, {.pointSize = 10}}, {4, 7, {.pointSize = 20}}}};
    const auto together = TextLayout(mixed).lines(100);
    EXPECT_DOUBLE_EQ(together.height(), 20);
    EXPECT_DOUBLE_EQ(together.width(), 50);
    const auto apart = TextLayout(mixed).lines(30);
    ASSERT_EQ(apart.lines.size(), 2U);
    EXPECT_DOUBLE_EQ(apart.lines[0].metrics.lineHeight(), 10);
    EXPECT_EQ(apart.lines[1].runs, (std::vector<TextRun>{{0, 3, {.pointSize = 20}}}));
}

TEST_F(TextLayoutTest, BreaksAnywhereWhenAskedTo) {
    auto anywhere = request("ab cd");
    anywhere.breaksAnywhere = true;
    EXPECT_EQ(textsOf(TextLayout(anywhere).lines(20)), (Texts{"ab c", "d"}));
}

TEST_F(TextLayoutTest, DamagedBytesAreCharactersOfTheirOwn) {
    EXPECT_DOUBLE_EQ(linesOf("a\xFF"
                             "b",
                             100)
                         .lines[0]
                         .width,
                     15);
}

TEST_F(TextLayoutTest, BreakingAtAnotherWidthMeasuresNothing) {
    const auto counting = std::make_shared<testing::FixedTextMeasurer>();
    const auto scope = TextMeasurer::shared().overrideWith(counting);
    const TextLayout layout(request("one two three"));
    const auto before = counting->measured;
    std::ignore = layout.lines(35);
    std::ignore = layout.lines(15);
    EXPECT_EQ(before, 1U);
    EXPECT_EQ(counting->measured, before);
}

} // namespace
} // namespace orvo
