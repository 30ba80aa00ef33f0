#include "platform/feeds/alerts/TextCleaner.h"

#include "platform/foundation/Text.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

std::string clean(const std::string& text) {
    return TextCleaner::clean(text);
}

std::string repeated(const std::string& text, std::size_t count) {
    std::string result;
    for (std::size_t i = 0; i < count; ++i)
        result += text;
    return result;
}

} // namespace

TEST(TextCleaner, LeavesPlainTextAsItIs) {
    for (const std::string text : {"", "a", "No trams.", "Line 5 & up", "3 < 4, 5 > 2", "Gare été"})
        EXPECT_EQ(clean(text), text);
}

TEST(TextCleaner, StripsTags) {
    EXPECT_EQ(clean("<b>No</b> <i class=\"x\">trams</i>"), "No trams");
    EXPECT_EQ(clean("<!-- hidden -->Shown"), "Shown");
    EXPECT_EQ(clean("<script>alert(1)</script>Shown<style>b{}</style>"), "Shown");
}

TEST(TextCleaner, TagsThatEndLinesLeaveLineBreaks) {
    EXPECT_EQ(clean("a<br>b<BR/>c"), "a\nb\nc");
    EXPECT_EQ(clean("<p>a</p><p>b</p>"), "a\n\nb");
    EXPECT_EQ(clean("<ul><li>a</li><li>b</li></ul>"), "a\n\nb");
    EXPECT_EQ(clean("<td>a</td><td>b</td>"), "a b");
}

TEST(TextCleaner, DecodesEntities) {
    EXPECT_EQ(clean("D&eacute;g&acirc;ts &#233;&#xE9; &amp; &apos;"), "Dégâts éé & '");
}

TEST(TextCleaner, DecodesWhatWasEscapedTwice) {
    EXPECT_EQ(clean("D&amp;eacute;g&amp;acirc;ts"), "Dégâts");
    EXPECT_EQ(clean("a.&lt;br /&gt;&lt;br /&gt; b"), "a.\n\nb");
    EXPECT_EQ(clean("a&amp;lt;br&amp;gt;b"), "a\nb");
}

TEST(TextCleaner, KeepsLineBreaksOfAllKinds) {
    EXPECT_EQ(clean("a\r\nb\rc\nd\u2028e\u0085f"), "a\nb\nc\nd\ne\nf");
    EXPECT_EQ(clean("a\u2029b"), "a\n\nb");
}

TEST(TextCleaner, LeavesAtMostOneEmptyLineAndNoneAtTheEnds) {
    EXPECT_EQ(clean("\n\n a \n \n\n\n b \n\n"), "a\n\nb");
}

TEST(TextCleaner, RunsOfBlanksBecomeOne) {
    EXPECT_EQ(clean("  a \t  b\u3000c  "), "a b c");
    EXPECT_EQ(clean("12345678  12345678"), "12345678 12345678");
    EXPECT_EQ(clean("1234567  12345678"), "1234567 12345678");
}

TEST(TextCleaner, ASingleNoBreakSpaceStays) {
    EXPECT_EQ(clean("Alerte\u00A0: tram"), "Alerte\u00A0: tram");
    EXPECT_EQ(clean("\u00A0a\u00A0 \u00A0b\u00A0"), "a b");
    EXPECT_EQ(clean("a&nbsp;b"), "a\u00A0b");
}

TEST(TextCleaner, DropsControlAndDirectionOverrideCharacters) {
    EXPECT_EQ(clean("a\x01\x1F\x7F\u0080\u009F"
                    "b"),
              "ab");
    EXPECT_EQ(clean("a\u202Eb\u202C\u2066c\u2069\uFEFFd"), "abcd");
    EXPECT_EQ(clean("a&#8238;b&#1;c"), "ab&#1;c");
    EXPECT_EQ(clean("\u200Fשלום\u200E"), "\u200Fשלום\u200E");
}

TEST(TextCleaner, AControlCharacterIsSeenWhereverItStands) {
    for (std::size_t length = 1; length < 50; ++length) {
        for (std::size_t at = 0; at <= length; ++at) {
            std::string text(length, 'a');
            text.insert(at, 1, '\x01');
            EXPECT_EQ(clean(text), std::string(length, 'a')) << length << ' ' << at;
        }
    }
}

TEST(TextCleaner, IsTheSameWhenDoneAgain) {
    for (const std::string text : {"<p>a</p>  b", "\u00A0 x \n\n\n y", "a\u2029\tb", "plain"})
        EXPECT_EQ(clean(clean(text)), clean(text));
}

TEST(TextCleaner, OnOneLineLeavesNoLineBreaks) {
    std::string room;
    EXPECT_EQ(TextCleaner::onOneLine("a\n\nb\nc d", room), "a b c d");
}

TEST(TextCleaner, TheFirstParagraphEndsAtTheFirstEmptyLine) {
    EXPECT_EQ(TextCleaner::firstParagraph("a\nb\n\nc"), "a\nb");
    EXPECT_EQ(TextCleaner::firstParagraph("a"), "a");
    EXPECT_EQ(TextCleaner::firstParagraph(""), "");
}

TEST(TextCleaner, CapsAtTheGivenNumberOfCharacters) {
    EXPECT_EQ(TextCleaner::capped(std::string(200, 'a'), 200), std::string(200, 'a'));
    EXPECT_EQ(TextCleaner::capped(std::string(201, 'a'), 200), std::string(200, 'a'));
    EXPECT_EQ(TextCleaner::capped(repeated("é", 200), 200), repeated("é", 200));
    EXPECT_EQ(TextCleaner::capped(repeated("é", 201), 200), repeated("é", 200));
}

TEST(TextCleaner, CutsOnlyAtWholeCharacters) {
    const std::string family = "👨‍👩‍👧";
    EXPECT_EQ(TextCleaner::capped("ab" + family, 4), "ab");
    EXPECT_EQ(TextCleaner::capped("ab" + family, 7), "ab" + family);
    EXPECT_EQ(TextCleaner::capped("abe\u0301x", 3), "ab");
    for (std::size_t most = 0; most < 12; ++most)
        EXPECT_TRUE(
            Text::isValidUTF8(TextCleaner::capped("aé漢👨‍👩‍👧e\u0301z", most)));
}

TEST(TextCleaner, ACharacterWithoutEndIsCutAndNotLeftOut) {
    const std::string tower = "e" + repeated("\u0301", 300);
    EXPECT_EQ(TextCleaner::capped(tower, 200), "e" + repeated("\u0301", 199));
    EXPECT_EQ(TextCleaner::capped("ab" + tower, 200), "ab");
    EXPECT_EQ(TextCleaner::capped(tower, 0), "");
}

TEST(TextCleaner, ATextInWhichNothingCanBeSeenIsEmpty) {
    EXPECT_EQ(clean("\u200B"), "");
    EXPECT_EQ(clean("\u00AD \u2060\u200D\n\uFE0F"), "");
    EXPECT_EQ(TextCleaner::cleanLine("<b>\u200B</b>"), "");
    EXPECT_EQ(clean("a\u200Bb"), "a\u200Bb"); // where a long word may break
}

TEST(TextCleaner, WhatLiesBeyondAMebibyteIsNotLookedAt) {
    const std::string most(TextCleaner::LongestPublished, 'a');
    EXPECT_EQ(clean(most + "b"), most);
    EXPECT_EQ(TextCleaner::cleanLine(most + "b"), most);
    const std::string longer = most.substr(1) + "é"; // the cut would be in the middle of it
    EXPECT_EQ(clean(longer), most.substr(1));
    EXPECT_EQ(clean("<b>" + most + "</b>"), most.substr(3));
}

TEST(TextCleaner, NoBlankStandsAtTheCut) {
    EXPECT_EQ(TextCleaner::capped("one two three", 4), "one");
}

TEST(TextCleaner, LongTextsFullOfMarkupTakeLinearTime) {
    // Each of these once made a search begin anew at every character.
    for (const std::string part : {"<a", "<!--", "&", "<script>", "&amp", "\u00A0x"})
        EXPECT_LE(clean(repeated(part, 200'000)).size(), 200'000 * part.size());
}

} // namespace orvo::testing
