#include "platform/feeds/alerts/HeaderFingerprint.h"

#include "platform/feeds/alerts/IncidentContent.h"

#include <gtest/gtest.h>

#include <random>

namespace orvo::testing {

namespace {

std::string normalised(std::string_view text) {
    std::string room;
    return std::string(IncidentContent::normalised(text, room));
}

} // namespace

TEST(HeaderFingerprint, IsTheSameForTextsThatAreNormalisedAlike) {
    const std::string plain = "Line 17 delayed: use the bus at the harbour";
    for (const std::string text : {"  Line 17 delayed: use the bus at the harbour ",
                                   "<b>Line 17</b> delayed: use the bus at the harbour",
                                   "Line\n17  delayed: use the bus at the harbour",
                                   "Line&nbsp;17 delayed&#58; use the bus at the harbour",
                                   "\u202ALine 17\u202C delayed: use the bus at the harbour"}) {
        EXPECT_EQ(normalised(text), plain);
        EXPECT_EQ(headerFingerprint(text), headerFingerprint(plain)) << text;
    }
}

TEST(HeaderFingerprint, ABlankThatNothingVisibleFollowsDoesNotCount) {
    const std::string text = "Line 17 delayed"; // one character less than what counts
    EXPECT_EQ(headerFingerprint(text + " \x01"), headerFingerprint(text));
    EXPECT_EQ(headerFingerprint(text + " \n\n"), headerFingerprint(text));
    EXPECT_NE(headerFingerprint(text + " a"), headerFingerprint(text));
}

TEST(HeaderFingerprint, TellsTextsApartByTheirBeginning) {
    EXPECT_NE(headerFingerprint("Line 17 delayed: harbour"), headerFingerprint("Line 18 delayed"));
    EXPECT_NE(headerFingerprint("A"), headerFingerprint("B"));
    EXPECT_NE(headerFingerprint(""), headerFingerprint("A"));
}

TEST(HeaderFingerprint, OfRandomTextsIsThatOfTheirNormalisedForm) {
    const std::vector<std::string> parts = {
        "a",    "b",    "Line",  " ",        "  ",           "\n",
        "\t",   "é",    "漢",    "\u00A0",   "\u202E",       "<b>",
        "</b>", "<br>", "&amp;", "&eacute;", "&amp;eacute;", "<",
        "&",    "17",   ".",     "\u3000",   "12345678"};
    std::mt19937 random(1);
    for (int i = 0; i < 20'000; ++i) {
        std::string text;
        for (std::size_t length = random() % 14; length > 0; --length)
            text += parts[random() % parts.size()];
        // What is taken for a tag after decoding is text for a second time: such texts are left
        // out.
        const std::string once = normalised(text);
        if (normalised(once) != once)
            continue;
        EXPECT_EQ(headerFingerprint(text), headerFingerprint(once)) << text;
    }
}

TEST(HeaderFingerprint, NeedsNoValidText) {
    const std::string bytes = "caf\xE9 \xF0\x9F";
    for (std::size_t length = 0; length <= bytes.size(); ++length)
        EXPECT_EQ(headerFingerprint(bytes.substr(0, length)),
                  headerFingerprint(bytes.substr(0, length)));
}

} // namespace orvo::testing
