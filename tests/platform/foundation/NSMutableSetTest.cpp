#include "platform/foundation/NSMutableSet.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSMutableSet> texts(const std::vector<std::string>& names) {
    const auto set = NSMutableSet::set();
    for (const auto& name : names)
        set->addObject(NSString::string(name));
    return set;
}

TEST(NSMutableSet, HoldsOneOfEquals) {
    const auto set = texts({"a", "b", "a"});
    EXPECT_EQ(set->count(), 2U);
    EXPECT_TRUE(set->containsObject(*NSString::string("a")));
    EXPECT_FALSE(set->containsObject(*NSString::string("c")));
}

TEST(NSMutableSet, RemovesWhatIsEqualAndNothingElse) {
    const auto set = texts({"a", "b"});
    set->removeObject(*NSString::string("c"));
    set->removeObject(*NSString::string("a"));
    EXPECT_EQ(set->description(), "{(b)}");
    set->addObject(NSString::string("a"));
    EXPECT_EQ(set->description(), "{(b, a)}");
}

TEST(NSMutableSet, RemovesAnElementThatItAloneKeepsAlive) {
    const auto set = NSMutableSet::set();
    auto text = NSString::string("a");
    const auto& bare = *text;
    set->addObject(std::exchange(text, nullptr));
    set->removeObject(bare);
    EXPECT_EQ(set->count(), 0U);
}

TEST(NSMutableSet, RaisesForNil) {
    EXPECT_THROW(NSMutableSet::set()->addObject(nullptr), NSInvalidArgumentException);
}

TEST(NSMutableSet, IsEqualWhateverTheOrderAndHashesAlike) {
    const auto a = texts({"x", "y"});
    const auto b = texts({"y", "x"});
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    for (const auto& other : {texts({"x"}), texts({"x", "y", "z"}), texts({"x", "z"})}) {
        EXPECT_FALSE(a->isEqual(other.get())) << other->description();
        EXPECT_FALSE(other->isEqual(a.get())) << other->description();
    }
    EXPECT_FALSE(a->isEqual(nullptr));
}

TEST(NSMutableSet, EnumeratesInOrderOfAddingUntilToldToStop) {
    std::string seen;
    texts({"c", "a", "b"})->enumerate([&](const auto& element) {
        seen += element->description();
        return seen.size() < 2;
    });
    EXPECT_EQ(seen, "ca");
}

TEST(NSMutableSet, IsCopiedAsItIsNow) {
    const auto set = texts({"b", "a"});
    const auto copy = set->copy();
    set->addObject(NSString::string("c"));
    EXPECT_TRUE(copy->isEqual(
        NSOrderedSet::orderedSetWithObjects({NSString::string("b"), NSString::string("a")}).get()));
}

} // namespace
} // namespace orvo
