#include "handoff/OrvoActivity.h"

#include "handoff/EncodedMessage.h"
#include "platform/foundation/Exceptions.h"
#include "platform/geoservices/TransitLineItemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::Bytes;
using testing::encoded;

template <class Set>
Bytes activityWith(Set&& set) {
    OrvoActivity activity;
    set(activity);
    return encoded(activity);
}

template <class T>
std::shared_ptr<T> opaque(Bytes bytes) {
    auto message = std::make_shared<T>();
    message->setBytes(std::move(bytes));
    return message;
}

std::shared_ptr<TransitStorageLineItem> lineItem(std::uint64_t muid) {
    return TransitStorageLineItem::initWithLineItem(
        TransitLineItemRecord::initWithFields_service({.muid = muid, .name = "U1"}, {}));
}

std::shared_ptr<OrvoActivity> fullActivity() {
    auto activity = std::make_shared<OrvoActivity>();
    activity->setLineItem(lineItem(5));
    activity->setSelectedTransitLineName("U1");
    activity->setSelectedTransitFeatureID(13);
    activity->setSearchCategoryStorage(opaque<SearchCategoryStorage>({12}));
    activity->setPresentedMapItem(opaque<MapItemStorage>({11}));
    activity->setIsDroppedPinPresented(true);
    activity->setIsDroppedPinSelected(false);
    activity->setDroppedPin(opaque<DroppedPin>({8}));
    activity->setDirectionsPlan(std::make_shared<DirectionsPlan>());
    activity->directionsPlan()->setIsPlayingTrace(true);
    activity->setIsPresentingSelectedPlace(true);
    activity->setSelectedPlaceIndex(0);
    activity->addSearchPlaces(opaque<MapItemStorage>({1}));
    activity->addSearchPlaces(opaque<MapItemStorage>({2}));
    activity->setSearchString("food");
    activity->setCollectionsMode(2);
    activity->setDisplayOptions(std::make_shared<URLOptions>());
    activity->displayOptions()->setMapType(3);
    return activity;
}

TEST(OrvoActivity, EachFieldHasItsNumberAndWireType) {
    EXPECT_EQ(activityWith([](auto& a) { a.setDisplayOptions(std::make_shared<URLOptions>()); }),
              (Bytes{0x0a, 0}));
    EXPECT_EQ(activityWith([](auto& a) { a.setCollectionsMode(1); }), (Bytes{0x10, 1}));
    EXPECT_EQ(activityWith([](auto& a) { a.setSearchString("é"); }), (Bytes{0x1a, 2, 0xc3, 0xa9}));
    EXPECT_EQ(activityWith([](auto& a) { a.addSearchPlaces(opaque<MapItemStorage>({7})); }),
              (Bytes{0x22, 1, 7}));
    EXPECT_EQ(activityWith([](auto& a) { a.setSelectedPlaceIndex(0); }), (Bytes{0x28, 0}));
    EXPECT_EQ(activityWith([](auto& a) { a.setIsPresentingSelectedPlace(true); }),
              (Bytes{0x30, 1}));
    EXPECT_EQ(
        activityWith([](auto& a) { a.setDirectionsPlan(std::make_shared<DirectionsPlan>()); }),
        (Bytes{0x3a, 0}));
    EXPECT_EQ(activityWith([](auto& a) { a.setDroppedPin(opaque<DroppedPin>({7})); }),
              (Bytes{0x42, 1, 7}));
    EXPECT_EQ(activityWith([](auto& a) { a.setIsDroppedPinSelected(true); }), (Bytes{0x48, 1}));
    EXPECT_EQ(activityWith([](auto& a) { a.setIsDroppedPinPresented(false); }), (Bytes{0x50, 0}));
    EXPECT_EQ(activityWith([](auto& a) { a.setPresentedMapItem(opaque<MapItemStorage>({7})); }),
              (Bytes{0x5a, 1, 7}));
    EXPECT_EQ(activityWith(
                  [](auto& a) { a.setSearchCategoryStorage(opaque<SearchCategoryStorage>({7})); }),
              (Bytes{0x62, 1, 7}));
    EXPECT_EQ(activityWith([](auto& a) { a.setSelectedTransitFeatureID(300); }),
              (Bytes{0x68, 0xac, 0x02}));
    EXPECT_EQ(activityWith([](auto& a) { a.setSelectedTransitLineName(""); }), (Bytes{0x72, 0}));
    EXPECT_EQ(
        activityWith([](auto& a) { a.setLineItem(std::make_shared<TransitStorageLineItem>()); }),
        (Bytes{0x7a, 0}));
}

TEST(OrvoActivity, PresenceBitsGoByWidthThenByName) {
    EXPECT_EQ(OrvoActivity::SelectedPlaceIndexBit, 1U);
    EXPECT_EQ(OrvoActivity::SelectedTransitFeatureIDBit, 2U);
    EXPECT_EQ(OrvoActivity::CollectionsModeBit, 4U);
    EXPECT_EQ(OrvoActivity::IsDroppedPinPresentedBit, 8U);
    EXPECT_EQ(OrvoActivity::IsDroppedPinSelectedBit, 16U);
    EXPECT_EQ(OrvoActivity::IsPresentingSelectedPlaceBit, 32U);
}

TEST(OrvoActivity, SettingAScalarMakesItPresentAndClearingKeepsItsValue) {
    OrvoActivity activity;
    EXPECT_FALSE(activity.hasSelectedPlaceIndex());
    activity.setSelectedPlaceIndex(9);
    EXPECT_TRUE(activity.hasSelectedPlaceIndex());
    activity.setHasSelectedPlaceIndex(false);
    EXPECT_FALSE(activity.hasSelectedPlaceIndex());
    activity.setHasSelectedPlaceIndex(true);
    EXPECT_EQ(activity.selectedPlaceIndex(), 9U);
}

TEST(OrvoActivity, EveryScalarHasAPresenceOfItsOwn) {
    const auto expect = [](const char* name, auto get, auto set, auto has, auto setHas) {
        SCOPED_TRACE(name);
        OrvoActivity activity;
        EXPECT_FALSE((activity.*has)());
        (activity.*set)(1);
        EXPECT_TRUE((activity.*has)());
        const auto dictionary = activity.dictionaryRepresentation();
        EXPECT_EQ(dictionary->count(), 1U);
        EXPECT_TRUE(dictionary->objectForKey(name));
        (activity.*setHas)(false);
        EXPECT_FALSE((activity.*has)());
        EXPECT_TRUE(encoded(activity).empty());
        (activity.*setHas)(true);
        EXPECT_TRUE((activity.*get)() == 1) << "the value stays";
        EXPECT_EQ(activity.dictionaryRepresentation()->count(), 1U);
    };
    expect("collectionsMode",
           &OrvoActivity::collectionsMode,
           &OrvoActivity::setCollectionsMode,
           &OrvoActivity::hasCollectionsMode,
           &OrvoActivity::setHasCollectionsMode);
    expect("selectedPlaceIndex",
           &OrvoActivity::selectedPlaceIndex,
           &OrvoActivity::setSelectedPlaceIndex,
           &OrvoActivity::hasSelectedPlaceIndex,
           &OrvoActivity::setHasSelectedPlaceIndex);
    expect("isPresentingSelectedPlace",
           &OrvoActivity::isPresentingSelectedPlace,
           &OrvoActivity::setIsPresentingSelectedPlace,
           &OrvoActivity::hasIsPresentingSelectedPlace,
           &OrvoActivity::setHasIsPresentingSelectedPlace);
    expect("isDroppedPinSelected",
           &OrvoActivity::isDroppedPinSelected,
           &OrvoActivity::setIsDroppedPinSelected,
           &OrvoActivity::hasIsDroppedPinSelected,
           &OrvoActivity::setHasIsDroppedPinSelected);
    expect("isDroppedPinPresented",
           &OrvoActivity::isDroppedPinPresented,
           &OrvoActivity::setIsDroppedPinPresented,
           &OrvoActivity::hasIsDroppedPinPresented,
           &OrvoActivity::setHasIsDroppedPinPresented);
    expect("selectedTransitFeatureID",
           &OrvoActivity::selectedTransitFeatureID,
           &OrvoActivity::setSelectedTransitFeatureID,
           &OrvoActivity::hasSelectedTransitFeatureID,
           &OrvoActivity::setHasSelectedTransitFeatureID);
}

TEST(OrvoActivity, ObjectsArePresentWhenNotNil) {
    OrvoActivity activity;
    EXPECT_FALSE(activity.hasLineItem());
    EXPECT_FALSE(activity.hasSearchString());
    activity.setLineItem(lineItem(1));
    activity.setSearchString("");
    EXPECT_TRUE(activity.hasLineItem());
    EXPECT_TRUE(activity.hasSearchString());
    activity.setLineItem(nullptr);
    EXPECT_FALSE(activity.hasLineItem());
}

TEST(OrvoActivity, SearchPlacesAreAList) {
    OrvoActivity activity;
    EXPECT_EQ(activity.searchPlacesCount(), 0U);
    const auto place = opaque<MapItemStorage>({1});
    activity.addSearchPlaces(place);
    EXPECT_EQ(activity.searchPlacesCount(), 1U);
    EXPECT_EQ(activity.searchPlacesAtIndex(0), place);
    EXPECT_EQ(OrvoActivity::searchPlacesType(), "MapItemStorage");
    EXPECT_THROW((void)activity.searchPlacesAtIndex(1), NSInvalidArgumentException);
    EXPECT_THROW(activity.addSearchPlaces(nullptr), NSInvalidArgumentException);
    activity.clearSearchPlaces();
    EXPECT_EQ(activity.searchPlacesCount(), 0U);
}

TEST(OrvoActivity, CollectionsModesHaveTheirNames) {
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(0), "None");
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(1), "Bookmarks");
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(2), "Recents");
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(3), "Contacts");
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(7), "(unknown: 7)");
    EXPECT_EQ(OrvoActivity::collectionsModeAsString(-1), "(unknown: -1)");
    EXPECT_EQ(OrvoActivity::StringAsCollectionsMode("Contacts"), 3);
    EXPECT_EQ(OrvoActivity::StringAsCollectionsMode("Favorites"), 0);
}

TEST(OrvoActivity, LineItemAndDisplayOptionsSerialiseToTwoFieldsFieldOneFirst) {
    OrvoActivity activity;
    activity.setLineItem(lineItem(1));
    activity.setDisplayOptions(std::make_shared<URLOptions>());
    activity.displayOptions()->setMapType(3);
    const auto bytes = encoded(activity);
    ASSERT_GT(bytes.size(), 5U);
    EXPECT_EQ(Bytes(bytes.begin(), bytes.begin() + 5), (Bytes{0x0a, 2, 0x08, 3, 0x7a}));
    ProtoReader reader(bytes);
    std::vector<ProtoTag> tags;
    while (!reader.isAtEnd()) {
        tags.push_back(reader.readTag());
        reader.skip(tags.back());
    }
    EXPECT_EQ(tags,
              (std::vector<ProtoTag>{{1, ProtoWireType::LengthDelimited},
                                     {15, ProtoWireType::LengthDelimited}}));
}

TEST(OrvoActivity, PlacesAreAFieldEachInTheirOrder) {
    EXPECT_EQ(activityWith([](auto& a) {
                  a.addSearchPlaces(opaque<MapItemStorage>({7}));
                  a.addSearchPlaces(opaque<MapItemStorage>({}));
                  a.addSearchPlaces(opaque<MapItemStorage>({5}));
              }),
              (Bytes{0x22, 1, 7, 0x22, 0, 0x22, 1, 5}));
}

TEST(OrvoActivity, NegativeEnumerationIsTenBytes) {
    EXPECT_EQ(activityWith([](auto& a) { a.setCollectionsMode(-1); }),
              (Bytes{0x10, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0x01}));
    const auto again = protoMessageWithBytes<OrvoActivity>(
        activityWith([](auto& a) { a.setCollectionsMode(-1); }));
    ASSERT_TRUE(again);
    EXPECT_EQ(again->collectionsMode(), -1);
}

TEST(OrvoActivity, ReadsBackEveryFieldThatItWrites) {
    const auto activity = fullActivity();
    const auto again = protoMessageWithBytes<OrvoActivity>(encoded(*activity));
    ASSERT_TRUE(again);
    EXPECT_TRUE(equal(activity, again));
    EXPECT_TRUE(equal(again, activity));
    EXPECT_EQ(activity->hash(), again->hash());
    EXPECT_EQ(encoded(*again), encoded(*activity));
    EXPECT_EQ(again->lineItem()->name(), "U1");
    EXPECT_TRUE(again->directionsPlan()->isPlayingTrace());
}

TEST(OrvoActivity, EmptyInputReadsAsAnEmptyMessage) {
    const auto activity = protoMessageWithBytes<OrvoActivity>({});
    ASSERT_TRUE(activity);
    EXPECT_TRUE(encoded(*activity).empty());
}

TEST(OrvoActivity, CutAtEveryByteFailsOrEndsBetweenFields) {
    const auto bytes = encoded(*fullActivity());
    std::size_t whole = 0;
    for (std::size_t length = 0; length < bytes.size(); ++length) {
        const auto block = std::make_unique<std::uint8_t[]>(length);
        std::copy_n(bytes.begin(), length, block.get());
        OrvoActivity activity;
        ProtoReader reader({block.get(), length});
        if (activity.readFrom(reader))
            ++whole;
    }
    EXPECT_EQ(whole, 16U); // nothing at all, and after each of the first 15 of 16 fields
}

TEST(OrvoActivity, FieldsSixteenAndZeroAreSkippedAndReadingGoesOn) {
    const auto activity = protoMessageWithBytes<OrvoActivity>(Bytes{
        0x80, 0x01, 1, 0x00, 1,    0x85, 0x01, 0,    0,    0,    0, 0x81, 0x01, 0,    0, 0,  0, 0,
        0,    0,    0, 0x82, 0x01, 1,    'x',  0x83, 0x01, 0x08, 1, 0x84, 0x01, 0x1a, 1, 'a'});
    ASSERT_TRUE(activity);
    EXPECT_EQ(activity->searchString(), "a");
    EXPECT_EQ(encoded(*activity), (Bytes{0x1a, 1, 'a'}));
}

TEST(OrvoActivity, EndGroupEndsTheMessageWithTheRestUnread) {
    const auto activity =
        protoMessageWithBytes<OrvoActivity>(Bytes{0x1a, 1, 'a', 0x0c, 0x1a, 1, 'b', 0xff});
    ASSERT_TRUE(activity);
    EXPECT_EQ(activity->searchString(), "a");
}

TEST(OrvoActivity, KnownFieldOfAnotherWireTypeIsSkipped) {
    const auto activity =
        protoMessageWithBytes<OrvoActivity>(Bytes{0x18, 5, 0x2a, 1, 'x', 0x10, 1});
    ASSERT_TRUE(activity);
    EXPECT_FALSE(activity->hasSearchString());
    EXPECT_FALSE(activity->hasSelectedPlaceIndex());
    EXPECT_EQ(activity->collectionsMode(), 1);
}

TEST(OrvoActivity, SecondSubMessageReplacesTheFirst) {
    Bytes bytes = activityWith([](auto& a) {
        a.setDirectionsPlan(std::make_shared<DirectionsPlan>());
        a.directionsPlan()->setOriginString("here");
    });
    const auto second = activityWith([](auto& a) {
        a.setDirectionsPlan(std::make_shared<DirectionsPlan>());
        a.directionsPlan()->setDestinationString("there");
    });
    bytes.insert(bytes.end(), second.begin(), second.end());
    const auto activity = protoMessageWithBytes<OrvoActivity>(bytes);
    ASSERT_TRUE(activity);
    EXPECT_FALSE(activity->directionsPlan()->hasOriginString());
    EXPECT_EQ(activity->directionsPlan()->destinationString(), "there");
}

TEST(OrvoActivity, FailedSubMessageFailsTheWholeRead) {
    EXPECT_FALSE(
        protoMessageWithBytes<OrvoActivity>(Bytes{0x3a, 2, 0x12, 5})); // text past the plan's end
    EXPECT_FALSE(
        protoMessageWithBytes<OrvoActivity>(Bytes{0x3a, 9, 0x12, 1, 'a'}));  // plan past the end
    EXPECT_FALSE(protoMessageWithBytes<OrvoActivity>(Bytes{0x0a, 1, 0x08})); // options cut off
    EXPECT_FALSE(protoMessageWithBytes<OrvoActivity>(Bytes{0x0e, 1}));       // wire type 6
}

TEST(OrvoActivity, OpaqueRecordsCarryTheirBytesThrough) {
    const Bytes bytes{0x22, 3, 0xff, 0x06, 0x00, 0x42, 2, 0x80, 0x80};
    const auto activity = protoMessageWithBytes<OrvoActivity>(bytes);
    ASSERT_TRUE(activity);
    EXPECT_EQ(encoded(*activity), bytes);
}

TEST(OrvoActivity, CopyToGivesPresentFieldsAndLeavesTheRest) {
    OrvoActivity source;
    source.setCollectionsMode(0);
    OrvoActivity target;
    target.setSearchString("kept");
    target.setCollectionsMode(3);
    target.addSearchPlaces(opaque<MapItemStorage>({1}));
    source.copyTo(target);
    EXPECT_EQ(target.collectionsMode(), 0);
    EXPECT_EQ(target.searchString(), "kept");
    EXPECT_EQ(target.searchPlacesCount(), 1U);
    source.addSearchPlaces(opaque<MapItemStorage>({2}));
    source.copyTo(target);
    ASSERT_EQ(target.searchPlacesCount(), 1U);
    EXPECT_EQ(target.searchPlacesAtIndex(0)->bytes(), Bytes{2});
}

TEST(OrvoActivity, CopyIsDeep) {
    const auto activity = fullActivity();
    const auto copy = std::dynamic_pointer_cast<OrvoActivity>(activity->copy());
    ASSERT_TRUE(copy);
    EXPECT_TRUE(equal(activity, copy));
    copy->directionsPlan()->setOriginString("changed");
    copy->searchPlacesAtIndex(0)->setBytes({9});
    copy->displayOptions()->setMapType(1);
    EXPECT_FALSE(activity->directionsPlan()->hasOriginString());
    EXPECT_EQ(activity->searchPlacesAtIndex(0)->bytes(), Bytes{1});
    EXPECT_EQ(activity->displayOptions()->mapType(), 3);
}

TEST(OrvoActivity, MergeTakesPresentFieldsMergesSubMessagesAndAppendsLists) {
    OrvoActivity activity;
    activity.setSearchString("old");
    activity.setCollectionsMode(1);
    activity.setDirectionsPlan(std::make_shared<DirectionsPlan>());
    activity.directionsPlan()->setOriginString("here");
    activity.addSearchPlaces(opaque<MapItemStorage>({1}));
    OrvoActivity other;
    other.setSearchString("new");
    other.setSelectedPlaceIndex(0);
    other.setDirectionsPlan(std::make_shared<DirectionsPlan>());
    other.directionsPlan()->setDestinationString("there");
    other.addSearchPlaces(opaque<MapItemStorage>({2}));
    other.setLineItem(lineItem(4));
    activity.mergeFrom(other);
    EXPECT_EQ(activity.searchString(), "new");
    EXPECT_EQ(activity.collectionsMode(), 1);
    EXPECT_TRUE(activity.hasSelectedPlaceIndex());
    EXPECT_EQ(activity.directionsPlan()->originString(), "here");
    EXPECT_EQ(activity.directionsPlan()->destinationString(), "there");
    EXPECT_EQ(activity.searchPlacesCount(), 2U);
    EXPECT_EQ(activity.lineItem()->muid(), 4U);
}

TEST(OrvoActivity, PresentZeroDiffersFromAbsent) {
    const auto present = std::make_shared<OrvoActivity>();
    present->setSelectedPlaceIndex(0);
    const auto absent = std::make_shared<OrvoActivity>();
    EXPECT_FALSE(equal(present, absent));
    EXPECT_FALSE(equal(absent, present));
    absent->setSelectedPlaceIndex(7);
    absent->setHasSelectedPlaceIndex(false);
    const auto untouched = std::make_shared<OrvoActivity>();
    EXPECT_TRUE(equal(absent, untouched)); // the value of an absent field does not count
}

TEST(OrvoActivity, EveryFieldCountsInEquality) {
    const auto differing = [](auto&& change) {
        const auto activity = fullActivity();
        change(*activity);
        return !equal(fullActivity(), activity) && !equal(activity, fullActivity());
    };
    EXPECT_TRUE(differing([](auto& a) { a.displayOptions()->setMapType(1); }));
    EXPECT_TRUE(differing([](auto& a) { a.setCollectionsMode(0); }));
    EXPECT_TRUE(differing([](auto& a) { a.setSearchString(std::nullopt); }));
    EXPECT_TRUE(differing([](auto& a) { a.clearSearchPlaces(); }));
    EXPECT_TRUE(differing([](auto& a) { a.setSelectedPlaceIndex(1); }));
    EXPECT_TRUE(differing([](auto& a) { a.setIsPresentingSelectedPlace(false); }));
    EXPECT_TRUE(differing([](auto& a) { a.directionsPlan()->setIsPlayingTrace(false); }));
    EXPECT_TRUE(differing([](auto& a) { a.setDroppedPin(nullptr); }));
    EXPECT_TRUE(differing([](auto& a) { a.setIsDroppedPinSelected(true); }));
    EXPECT_TRUE(differing([](auto& a) { a.setIsDroppedPinPresented(false); }));
    EXPECT_TRUE(differing([](auto& a) { a.presentedMapItem()->setBytes({}); }));
    EXPECT_TRUE(differing([](auto& a) { a.setSearchCategoryStorage(nullptr); }));
    EXPECT_TRUE(differing([](auto& a) { a.setSelectedTransitFeatureID(1); }));
    EXPECT_TRUE(differing([](auto& a) { a.setSelectedTransitLineName("U2"); }));
    EXPECT_TRUE(differing([](auto& a) { a.setLineItem(lineItem(6)); }));
    EXPECT_FALSE(differing([](auto&) {}));
}

TEST(OrvoActivity, HashMultipliesPresentNumbers) {
    OrvoActivity activity;
    EXPECT_EQ(activity.hash(), 0U);
    activity.setSelectedPlaceIndex(2);
    EXPECT_EQ(activity.hash(), 2U * 2654435761ULL);
    activity.setIsDroppedPinSelected(true);
    EXPECT_EQ(activity.hash(), (2U * 2654435761ULL) ^ 2654435761ULL);
    activity.setSearchString("a");
    EXPECT_EQ(activity.hash(),
              (2U * 2654435761ULL) ^ 2654435761ULL ^ NSString::string("a")->hash());
}

TEST(OrvoActivity, HashOfANegativeNumberIsItsProductModuloTwoToThe64th) {
    OrvoActivity activity;
    activity.setCollectionsMode(-1);
    EXPECT_EQ(activity.hash(), 0ULL - 2654435761ULL);
}

TEST(OrvoActivity, DictionaryNamesEveryPresentField) {
    const auto dictionary = fullActivity()->dictionaryRepresentation();
    EXPECT_EQ(dictionary->count(), 15U);
    EXPECT_TRUE(equal(dictionary->objectForKey("collectionsMode"), NSString::string("Recents")));
    EXPECT_TRUE(equal(dictionary->objectForKey("selectedPlaceIndex"),
                      NSNumber::numberWithUnsignedInteger(0)));
    EXPECT_TRUE(
        equal(dictionary->objectForKey("displayOptions"),
              NSDictionary::dictionaryWithTextKeys({{"mapType", NSNumber::numberWithInteger(3)}})));
    const auto places =
        std::dynamic_pointer_cast<NSArray>(dictionary->objectForKey("searchPlaces"));
    ASSERT_TRUE(places);
    EXPECT_EQ(typed<NSDictionary>(places).size(), 2U);
}

TEST(OrvoActivity, DescriptionIsTheRootDescriptionAndTheDictionary) {
    OrvoActivity activity;
    activity.setSearchString("food");
    EXPECT_EQ(activity.description(), activity.rootDescription() + " {searchString = food}");
}

} // namespace
} // namespace orvo
