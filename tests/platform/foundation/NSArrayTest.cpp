#include "platform/foundation/NSArray.h"

#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSArray> texts(const std::vector<std::string>& names) {
    NSArray::Elements elements;
    for (const auto& name : names)
        elements.push_back(NSString::string(name));
    return NSArray::arrayWithObjects(elements);
}

TEST(NSArray, KeepsItsElementsInOrder) {
    const auto a = NSString::string("a");
    const auto b = NSString::string("b");
    const auto array = NSArray::arrayOf({b, a, b});
    ASSERT_EQ(array->count(), 3U);
    EXPECT_EQ(array->objectAtIndex(0), b);
    EXPECT_EQ(array->objectAtIndex(1), a);
    EXPECT_EQ(array->objectAtIndex(2), b);
    EXPECT_EQ(NSArray::array()->count(), 0U);
}

TEST(NSArray, RaisesForNilAndPastItsEnd) {
    EXPECT_THROW((void)NSArray::arrayWithObjects({NSString::string("a"), nullptr}),
                 NSInvalidArgumentException);
    EXPECT_THROW((void)texts({"a"})->objectAtIndex(1), NSInvalidArgumentException);
    EXPECT_THROW((void)NSArray::array()->objectAtIndex(0), NSInvalidArgumentException);
}

TEST(NSArray, IsEqualElementByElementAndHashesAlike) {
    const auto a = texts({"x", "y"});
    const auto b = texts({"x", "y"});
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_EQ(NSArray::array()->hash(), NSArray::arrayWithObjects({})->hash());
}

TEST(NSArray, DiffersByOrderLengthContentAndKind) {
    const auto array = texts({"x", "y"});
    for (const std::shared_ptr<NSObject>& other : std::vector<std::shared_ptr<NSObject>>{
             texts({"y", "x"}),
             texts({"x"}),
             texts({"x", "y", "y"}),
             texts({"x", "z"}),
             NSOrderedSet::orderedSetWithObjects(array->elements())}) {
        EXPECT_FALSE(array->isEqual(other.get())) << other->description();
        EXPECT_FALSE(other->isEqual(array.get())) << other->description();
    }
    EXPECT_FALSE(array->isEqual(nullptr));
}

TEST(NSArray, EnumeratesUntilToldToStop) {
    std::string seen;
    texts({"a", "b", "c"})->enumerate([&](const auto& element) {
        seen += element->description();
        return seen.size() < 2;
    });
    EXPECT_EQ(seen, "ab");
}

TEST(NSArray, DescribesItsElements) {
    EXPECT_EQ(texts({"a", "b"})->description(), "(a, b)");
    EXPECT_EQ(NSArray::array()->description(), "()");
}

TEST(NSArray, IsItsOwnCopy) {
    const auto array = texts({"a"});
    EXPECT_EQ(array->copy(), array);
}

TEST(NSArray, IsReadAsElementsOfOneClass) {
    const auto strings = typed<NSString>(texts({"a", "b"}));
    ASSERT_EQ(strings.size(), 2U);
    EXPECT_EQ(strings[1]->utf8(), "b");
    EXPECT_TRUE(typed<NSString>(std::shared_ptr<NSArray>()).empty());
}

TEST(NSArray, RaisesWhereAnElementIsOfAnotherClass) {
    const auto mixed =
        NSArray::arrayWithObjects({NSString::string("a"), NSNumber::numberWithInteger(1)});
    EXPECT_THROW((void)typed<NSString>(mixed), NSInvalidArgumentException);
    EXPECT_EQ(typed<NSObject>(mixed).size(), 2U);
}

} // namespace
} // namespace orvo
