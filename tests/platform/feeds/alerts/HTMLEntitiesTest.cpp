#include "platform/feeds/alerts/HTMLEntities.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(HTMLEntities, DecodesNamesAndNumbers) {
    EXPECT_EQ(HTMLEntities::decoded("&lt;&gt;&amp;&quot;&AElig;&zwnj;&euro;"), "<>&\"Æ\u200C€");
    EXPECT_EQ(HTMLEntities::decoded("&#65;&#x1F600;&#X41;&#10;"), "A😀A\n");
}

TEST(HTMLEntities, DecodesOnlyOnce) {
    EXPECT_EQ(HTMLEntities::decoded("&amp;eacute;"), "&eacute;");
}

TEST(HTMLEntities, NamesAreExact) {
    EXPECT_EQ(HTMLEntities::decoded("&Eacute;&eacute;&EACUTE;"), "Éé&EACUTE;");
}

TEST(HTMLEntities, WhatIsNoReferenceStays) {
    for (const std::string text : {"&",
                                   "&;",
                                   "&#;",
                                   "&#x;",
                                   "AT&T",
                                   "a&copy=1",
                                   "&nosuch;",
                                   "&#xD800;",
                                   "&#1114112;",
                                   "&#99999999999;",
                                   "&#0;",
                                   "&#7;",
                                   "&#12 3;",
                                   "&averyveryveryveryverylongnamethatisnone;"})
        EXPECT_EQ(HTMLEntities::decoded(text), text);
}

TEST(HTMLEntities, ReadsOldNumbersAsWindows1252) {
    EXPECT_EQ(HTMLEntities::decoded("&#146;&#128;&#x97;"), "’€—");
    EXPECT_EQ(HTMLEntities::decoded("&#129;"), "&#129;");
}

TEST(HTMLEntities, CutAtEveryByteItNeverReadsOn) {
    const std::string whole = "a&eacute;&#x1F600;b";
    for (std::size_t length = 0; length <= whole.size(); ++length)
        EXPECT_LE(HTMLEntities::decoded(whole.substr(0, length)).size(), length);
}

} // namespace orvo::testing
