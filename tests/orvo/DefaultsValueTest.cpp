#include "orvo/DefaultsValue.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSObject> parsed(const char* text, const char* kind = "") {
    return DefaultsValue::parse(text, kind);
}

TEST(DefaultsValue, TheKnownKeysAreThoseOfMadeUpIncidents) {
    EXPECT_EQ(DefaultsValue::knownKeys(),
              (std::vector<std::string>{"Orvo.TransitWidget.internal.injectFakeIncidents",
                                        "Orvo.TransitWidget.internal.randomNumberIncidents"}));
}

TEST(DefaultsValue, TrueFalseYesAndNoAreTruthValues) {
    for (const char* text : {"true", "yes"})
        EXPECT_TRUE(equal(parsed(text), NSNumber::numberWithBool(true))) << text;
    for (const char* text : {"false", "no"})
        EXPECT_TRUE(equal(parsed(text), NSNumber::numberWithBool(false))) << text;
    EXPECT_EQ(DefaultsValue::text(*parsed("yes")), "true");
    EXPECT_EQ(DefaultsValue::text(*parsed("no")), "false");
}

TEST(DefaultsValue, NumbersAreNumbers) {
    EXPECT_TRUE(equal(parsed("12"), NSNumber::numberWithInteger(12)));
    EXPECT_TRUE(equal(parsed("-1.5"), NSNumber::numberWithDouble(-1.5)));
    EXPECT_EQ(DefaultsValue::text(*parsed("1")), "1"); // and no truth value
}

TEST(DefaultsValue, AllElseIsText) {
    for (const char* text : {"Yes", "TRUE", "two words", "12 ", "0x10", "inf", ""})
        EXPECT_TRUE(equal(parsed(text), NSString::string(text))) << text;
}

TEST(DefaultsValue, IsOfTheKindAskedForOrNone) {
    EXPECT_TRUE(equal(parsed("true", "string"), NSString::string("true")));
    EXPECT_TRUE(equal(parsed("12", "real"), NSNumber::numberWithDouble(12)));
    EXPECT_EQ(parsed("12", "bool"), nullptr);
    EXPECT_EQ(parsed("1.5", "integer"), nullptr);
    EXPECT_EQ(parsed("many", "real"), nullptr);
}

TEST(DefaultsValue, BytesAreToldByTheirNumber) {
    EXPECT_EQ(DefaultsValue::text(*NSData::dataWithString("abc")), "3 bytes");
}

} // namespace
} // namespace orvo
