#include "platform/foundation/NSDictionary.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSObject> number(std::int64_t value) {
    return NSNumber::numberWithInteger(value);
}

TEST(NSDictionary, FindsValuesByTheContentOfTheirKeys) {
    const auto dictionary =
        NSDictionary::dictionaryWithTextKeys({{"a", number(1)}, {"b", number(2)}});
    EXPECT_EQ(dictionary->count(), 2U);
    EXPECT_TRUE(equal(dictionary->objectForKey(*NSString::string("b")), number(2)));
    EXPECT_TRUE(equal(dictionary->objectForKey("a"), number(1)));
    EXPECT_EQ(dictionary->objectForKey("c"), nullptr);
    EXPECT_EQ(NSDictionary::dictionary()->objectForKey("a"), nullptr);
}

TEST(NSDictionary, TakesKeysOfAnyClass) {
    const auto dictionary = NSDictionary::dictionaryWithEntries(
        {{number(1), NSString::string("number")}, {NSString::string("1"), number(7)}});
    EXPECT_EQ(stringValue(dictionary->objectForKey(*NSNumber::numberWithDouble(1)).get()),
              "number");
    EXPECT_TRUE(equal(dictionary->objectForKey("1"), number(7)));
}

TEST(NSDictionary, KeepsTheFirstPlaceAndTheLastValueOfAKeyGivenTwice) {
    const auto dictionary = NSDictionary::dictionaryWithTextKeys(
        {{"a", number(1)}, {"b", number(2)}, {"a", number(3)}});
    EXPECT_EQ(dictionary->description(), "{a = 3; b = 2}");
}

TEST(NSDictionary, RaisesForNil) {
    EXPECT_THROW((void)NSDictionary::dictionaryWithEntries({{nullptr, number(1)}}),
                 NSInvalidArgumentException);
    EXPECT_THROW((void)NSDictionary::dictionaryWithTextKeys({{"a", nullptr}}),
                 NSInvalidArgumentException);
}

TEST(NSDictionary, IsEqualWhateverTheOrderAndHashesAlike) {
    const auto a = NSDictionary::dictionaryWithTextKeys({{"a", number(1)}, {"b", number(2)}});
    const auto b = NSDictionary::dictionaryWithTextKeys({{"b", number(2)}, {"a", number(1)}});
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
}

TEST(NSDictionary, DiffersByKeyValueAndCount) {
    const auto dictionary =
        NSDictionary::dictionaryWithTextKeys({{"a", number(1)}, {"b", number(2)}});
    for (const auto& other :
         {NSDictionary::dictionaryWithTextKeys({{"a", number(1)}, {"c", number(2)}}),
          NSDictionary::dictionaryWithTextKeys({{"a", number(1)}, {"b", number(3)}}),
          NSDictionary::dictionaryWithTextKeys({{"a", number(1)}}),
          NSDictionary::dictionary()}) {
        EXPECT_FALSE(dictionary->isEqual(other.get())) << other->description();
        EXPECT_FALSE(other->isEqual(dictionary.get())) << other->description();
    }
    EXPECT_FALSE(dictionary->isEqual(nullptr));
    EXPECT_FALSE(dictionary->isEqual(NSString::string("a").get()));
}

TEST(NSDictionary, EnumeratesItsKeysInTheOrderGiven) {
    std::string seen;
    NSDictionary::dictionaryWithTextKeys({{"c", number(1)}, {"a", number(2)}, {"b", number(3)}})
        ->enumerate([&](const auto& key) {
            seen += key->description();
            return seen.size() < 2;
        });
    EXPECT_EQ(seen, "ca");
}

TEST(NSDictionary, IsItsOwnCopy) {
    const auto dictionary = NSDictionary::dictionaryWithTextKeys({{"a", number(1)}});
    EXPECT_EQ(dictionary->copy(), dictionary);
}

} // namespace
} // namespace orvo
