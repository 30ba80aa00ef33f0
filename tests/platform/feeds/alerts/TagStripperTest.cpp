#include "platform/feeds/alerts/TagStripper.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(TagStripper, ALessThanSignThatBeginsNoTagStays) {
    for (const std::string text : {"a < b", "a <5 min> b", "<", "a<", "</", "<>", "< b>"})
        EXPECT_EQ(TagStripper::stripped(text), text);
}

TEST(TagStripper, ATagWithoutAnEndStays) {
    EXPECT_EQ(TagStripper::stripped("see <b and more"), "see <b and more");
    EXPECT_EQ(TagStripper::stripped("<b>x</b> <i"), "x <i");
}

TEST(TagStripper, DoctypesAndCommentsGo) {
    EXPECT_EQ(TagStripper::stripped("<!DOCTYPE html><?xml?>a<!-- <b> -->b"), "ab");
    EXPECT_EQ(TagStripper::stripped("<!-- no end"), "<!-- no end");
}

TEST(TagStripper, AScriptWithoutAnEndGoesToTheEnd) {
    EXPECT_EQ(TagStripper::stripped("a<script>b</scrip>c"), "a");
}

TEST(TagStripper, CutAtEveryByteItNeverReadsOn) {
    const std::string whole = "<p>a</p><!-- c --><script>x</script><br/>&lt;";
    for (std::size_t length = 0; length <= whole.size(); ++length) {
        const std::string part = whole.substr(0, length);
        EXPECT_LE(TagStripper::stripped(part).size(), length + 1);
    }
}

} // namespace orvo::testing
