#include "platform/foundation/NSOrderedSet.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSOrderedSet> texts(const std::vector<std::string>& names) {
    NSOrderedSet::Elements elements;
    for (const auto& name : names)
        elements.push_back(NSString::string(name));
    return NSOrderedSet::orderedSetWithObjects(elements);
}

TEST(NSOrderedSet, KeepsTheOrderAndTheFirstOfEquals) {
    const auto first = NSString::string("a");
    const auto second = NSString::string("a");
    const auto set = NSOrderedSet::orderedSetWithObjects({NSString::string("z"), first, second});
    ASSERT_EQ(set->count(), 2U);
    EXPECT_EQ(set->elements()[1], first);
    EXPECT_EQ(set->firstObject()->description(), "z");
}

TEST(NSOrderedSet, ContainsWhatIsEqualToAnElement) {
    const auto set = texts({"a", "b"});
    EXPECT_TRUE(set->containsObject(*NSString::string("b")));
    EXPECT_FALSE(set->containsObject(*NSString::string("c")));
    EXPECT_FALSE(NSOrderedSet::orderedSet()->containsObject(*NSString::string("a")));
}

TEST(NSOrderedSet, HasNoFirstObjectWhenEmpty) {
    EXPECT_EQ(NSOrderedSet::orderedSet()->firstObject(), nullptr);
}

TEST(NSOrderedSet, RaisesForNil) {
    EXPECT_THROW((void)NSOrderedSet::orderedSetWithObjects({nullptr}), NSInvalidArgumentException);
}

TEST(NSOrderedSet, IsEqualToTheSameElementsInTheSameOrderAlone) {
    const auto a = texts({"x", "y"});
    const auto b = texts({"x", "y", "x"});
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    for (const auto& other : {texts({"y", "x"}), texts({"x"}), texts({"x", "z"})}) {
        EXPECT_FALSE(a->isEqual(other.get())) << other->description();
        EXPECT_FALSE(other->isEqual(a.get())) << other->description();
    }
    EXPECT_FALSE(a->isEqual(nullptr));
}

TEST(NSOrderedSet, EnumeratesUntilToldToStop) {
    std::string seen;
    texts({"b", "a", "c"})->enumerate([&](const auto& element) {
        seen += element->description();
        return seen.size() < 2;
    });
    EXPECT_EQ(seen, "ba");
}

TEST(NSOrderedSet, DescribesItsElementsAndIsItsOwnCopy) {
    const auto set = texts({"b", "a"});
    EXPECT_EQ(set->description(), "{(b, a)}");
    EXPECT_EQ(NSOrderedSet::orderedSet()->description(), "{()}");
    EXPECT_EQ(set->copy(), set);
}

} // namespace
} // namespace orvo
