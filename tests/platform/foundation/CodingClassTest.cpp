#include "platform/foundation/CodingClass.h"

#include "platform/foundation/KeyedArchiveSupport.h"

#include <gtest/gtest.h>

namespace orvo::CodingClassTests {
namespace {

TEST(CodingClass, IsKindOfItselfAndOfWhatItDerivesFrom) {
    const auto table = testing::boxClasses();
    const auto* crate = table->find("Crate");
    ASSERT_TRUE(crate);
    for (const char* name : {"Crate", "Box", "NSObject"})
        EXPECT_TRUE(crate->isKindOf(name)) << name;
    EXPECT_FALSE(table->find("Box")->isKindOf("Crate"));
}

TEST(CodingClassTable, AlwaysKnowsFoundationsClasses) {
    const CodingClassTable empty;
    for (const char* name : {"NSString",
                             "NSNumber",
                             "NSData",
                             "NSDate",
                             "NSArray",
                             "NSDictionary",
                             "NSSet",
                             "NSOrderedSet",
                             "NSURL",
                             "NSError"})
        EXPECT_TRUE(empty.find(name)) << name;
    EXPECT_FALSE(empty.find("Box"));
    EXPECT_FALSE(empty.find(""));
}

TEST(CodingClassTable, FoundationsClassesCannotBeReplaced) {
    const CodingClassTable table{CodingClass::of<testing::Box>("NSArray")};
    EXPECT_EQ(table.find("NSArray")->content, CodingClass::Content::AllowedWithTheObject);
}

TEST(CodingClassTable, TheProgramsOwnIsEmptyUnlessHandedIn) {
    EXPECT_FALSE(CodingClassTable::current().get()->find("Box"));
    const auto scope = CodingClassTable::current().overrideWith(testing::boxClasses());
    EXPECT_TRUE(CodingClassTable::current().get()->find("Box"));
}

} // namespace
} // namespace orvo::CodingClassTests
