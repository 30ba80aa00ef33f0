#include "widget/OWTransitIncidentViewControllerState.h"

#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using State = OWTransitIncidentViewControllerState;

std::shared_ptr<TransitLineItem> lineItem(std::uint64_t muid, const char* name) {
    return TransitLineItemRecord::initWithFields_service(
        {.muid = muid, .name = name},
        {.incidents = NSArray::arrayOf(
             {TransitIncidentRecord::initWithFields({.muid = muid + 100, .title = "Closed"})})});
}

std::shared_ptr<Result> twoLines() {
    return Result::resultWithValue(NSArray::arrayOf({lineItem(1, "One"), lineItem(2, "Two")}));
}

std::shared_ptr<NSError> someError() {
    return NSError::errorWithMessage("LookupDomain", 5, "no lookup today");
}

std::shared_ptr<NSArray> valueOf(const Result& result) {
    std::shared_ptr<NSArray> array;
    result.withValue_orError(
        [&](const auto& value) { array = std::dynamic_pointer_cast<NSArray>(value); },
        [](const auto&) {});
    return array;
}

std::shared_ptr<NSError> errorOf(const Result& result) {
    std::shared_ptr<NSError> found;
    result.withValue_orError([](const auto&) {}, [&](const auto& error) { found = error; });
    return found;
}

std::shared_ptr<NSData> archived(const std::shared_ptr<NSObject>& root) {
    auto data = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(root, true);
    EXPECT_TRUE(data);
    return data;
}

/// Archives under a class name that is not its own, whatever it is told to.
class Imitation final : public virtual NSSecureCoding {
public:
    Imitation(std::string name, std::function<void(NSCoder&)> encode)
        : _name(std::move(name))
        , _encode(std::move(encode)) {}
    void encodeWithCoder(NSCoder& coder) const override { _encode(coder); }
    std::vector<std::string> classesForCoder() const override { return {_name, "NSObject"}; }

private:
    std::string _name;
    std::function<void(NSCoder&)> _encode;
};

std::shared_ptr<NSData> archivedState(std::function<void(NSCoder&)> encode) {
    return archived(
        std::make_shared<Imitation>("OWTransitIncidentViewControllerState", std::move(encode)));
}

/// The keys of the record in an archive of it, as they stand there.
std::vector<std::string> keysOfRecord(const NSData& data) {
    const auto list = std::dynamic_pointer_cast<NSDictionary>(PropertyList::read(data.bytes()));
    const auto objects = std::dynamic_pointer_cast<NSArray>(list->objectForKey("$objects"));
    const auto record = std::dynamic_pointer_cast<NSDictionary>(objects->objectAtIndex(1));
    std::vector<std::string> keys;
    for (const char* key : {"lineItemResultSuccess",
                            "lineItemResultError",
                            "lineItemsResultSuccess",
                            "lineItemsResultError",
                            "expanded"})
        if (record->objectForKey(key))
            keys.emplace_back(key);
    return keys;
}

class OWTransitIncidentViewControllerStateTest : public ::testing::Test {
protected:
    std::shared_ptr<State> load(const std::shared_ptr<NSData>& data) {
        error = nullptr;
        return State::unarchiveFromData_error(data, &error);
    }
    std::shared_ptr<State> roundTrip(const std::shared_ptr<Result>& result, bool expanded) {
        return load(archived(State::initWithLineItemsResult_expanded(result, expanded)));
    }

    std::shared_ptr<NSError> error;

private:
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override _classes =
        CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
            CodingClassTable{CodingClass::of<State>("OWTransitIncidentViewControllerState"),
                             CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                             CodingClass::of<TransitStorageIncident>("TransitStorageIncident")}));
};

TEST_F(OWTransitIncidentViewControllerStateTest, KeepsWhatItIsGiven) {
    const auto result = twoLines();
    const auto state = State::initWithLineItemsResult_expanded(result, true);
    EXPECT_EQ(state->lineItemsResult(), result);
    EXPECT_TRUE(state->expanded());
    EXPECT_TRUE(state->supportsSecureCoding());
}

TEST_F(OWTransitIncidentViewControllerStateTest, ASuccessWithTwoLinesComesBackAsTwoStorageItems) {
    const auto data = archived(State::initWithLineItemsResult_expanded(twoLines(), true));
    EXPECT_EQ(keysOfRecord(*data), (std::vector<std::string>{"lineItemResultSuccess", "expanded"}));
    const auto state = load(data);
    ASSERT_TRUE(state);
    EXPECT_FALSE(error);
    EXPECT_TRUE(state->expanded());
    ASSERT_TRUE(state->lineItemsResult()->isSuccess());
    const auto items = typed<TransitStorageLineItem>(valueOf(*state->lineItemsResult()));
    ASSERT_EQ(items.size(), 2U);
    EXPECT_EQ(items[0]->name(), "One");
    EXPECT_EQ(items[1]->muid(), 2U);
    EXPECT_EQ(typed<TransitIncident>(items[1]->incidents())[0]->title(), "Closed");
}

TEST_F(OWTransitIncidentViewControllerStateTest, AFailureComesBackWithAnEqualError) {
    const auto data = archived(
        State::initWithLineItemsResult_expanded(Result::resultWithError(someError()), false));
    EXPECT_EQ(keysOfRecord(*data), (std::vector<std::string>{"lineItemResultError", "expanded"}));
    const auto state = load(data);
    ASSERT_TRUE(state);
    EXPECT_FALSE(state->expanded());
    EXPECT_TRUE(equal(errorOf(*state->lineItemsResult()), someError()));
}

TEST_F(OWTransitIncidentViewControllerStateTest, AnEmptySuccessComesBackEmpty) {
    const auto state = roundTrip(Result::resultWithValue(NSArray::array()), false);
    ASSERT_TRUE(state);
    EXPECT_EQ(valueOf(*state->lineItemsResult())->count(), 0U);
}

TEST_F(OWTransitIncidentViewControllerStateTest, WhatWasLoadedCanBeSavedAgain) {
    const auto once = roundTrip(twoLines(), true);
    ASSERT_TRUE(once);
    const auto twice = roundTrip(once->lineItemsResult(), once->expanded());
    ASSERT_TRUE(twice);
    EXPECT_TRUE(equal(once->lineItemsResult(), twice->lineItemsResult()));
    EXPECT_TRUE(twice->expanded());
}

TEST_F(OWTransitIncidentViewControllerStateTest, AnArchiveUnderTheFormerClassNameLoads) {
    const auto state =
        load(archived(std::make_shared<Imitation>("OWTransitListItemData", [](NSCoder& coder) {
            coder.encodeObject_forKey(NSArray::array(), "lineItemResultSuccess");
            coder.encodeBool_forKey(true, "expanded");
        })));
    ASSERT_TRUE(state);
    EXPECT_FALSE(error);
    EXPECT_TRUE(state->expanded());
}

TEST_F(OWTransitIncidentViewControllerStateTest, OfBothKeysTheSuccessCounts) {
    const auto state = load(archivedState([](NSCoder& coder) {
        coder.encodeObject_forKey(NSArray::array(), "lineItemResultSuccess");
        coder.encodeObject_forKey(someError(), "lineItemResultError");
        coder.encodeBool_forKey(false, "expanded");
    }));
    ASSERT_TRUE(state);
    EXPECT_TRUE(state->lineItemsResult()->isSuccess());
}

TEST_F(OWTransitIncidentViewControllerStateTest, TheErrorDoesNotStandInForASuccessThatIsNoArray) {
    EXPECT_FALSE(load(archivedState([](NSCoder& coder) {
        coder.encodeObject_forKey(TransitStorageLineItem::initWithLineItem(lineItem(1, "One")),
                                  "lineItemResultSuccess");
        coder.encodeObject_forKey(someError(), "lineItemResultError");
        coder.encodeBool_forKey(false, "expanded");
    })));
    EXPECT_FALSE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, AnArrayWithAForeignClassIsADecodingError) {
    EXPECT_FALSE(load(archivedState([](NSCoder& coder) {
        coder.encodeObject_forKey(NSArray::arrayOf({NSString::string("line")}),
                                  "lineItemResultSuccess");
        coder.encodeBool_forKey(false, "expanded");
    })));
    EXPECT_TRUE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, AWrongClassUnderTheErrorKeyIsADecodingError) {
    EXPECT_FALSE(load(archivedState([](NSCoder& coder) {
        coder.encodeObject_forKey(NSString::string("error"), "lineItemResultError");
        coder.encodeBool_forKey(false, "expanded");
    })));
    EXPECT_TRUE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, WithNeitherKeyThereIsNoRecordAndNoError) {
    EXPECT_FALSE(
        load(archivedState([](NSCoder& coder) { coder.encodeBool_forKey(true, "expanded"); })));
    EXPECT_FALSE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, BytesThatAreNoArchiveGiveNilWithoutAnError) {
    EXPECT_FALSE(load(NSData::dataWithString("this is no archive at all")));
    EXPECT_FALSE(error);
    EXPECT_FALSE(load(NSData::dataWithString("")));
    EXPECT_FALSE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, AnArchiveOfAnotherClassIsNoRecord) {
    EXPECT_FALSE(load(archived(TransitStorageLineItem::initWithLineItem(lineItem(1, "One")))));
    EXPECT_TRUE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, ACorruptObjectInsideGivesAnErrorAndDoesNotRaise) {
    const auto data = archived(State::initWithLineItemsResult_expanded(twoLines(), true));
    std::vector<std::uint8_t> changed(data->bytes().begin(), data->bytes().end());
    const std::string name = "TransitStorageLineItem";
    const auto found = std::search(changed.begin(), changed.end(), name.begin(), name.end());
    ASSERT_NE(found, changed.end());
    *found = 'X'; // a class that nobody knows
    EXPECT_FALSE(load(NSData::dataWithVector(changed)));
    EXPECT_TRUE(error);
}

TEST_F(OWTransitIncidentViewControllerStateTest, TheErrorNeedNotBeAskedFor) {
    EXPECT_FALSE(State::unarchiveFromData_error(
        archived(TransitStorageLineItem::initWithLineItem(lineItem(1, "One"))), nullptr));
}

} // namespace
} // namespace orvo
