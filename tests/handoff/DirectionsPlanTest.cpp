#include "handoff/DirectionsPlan.h"

#include "handoff/EncodedMessage.h"

#include <gtest/gtest.h>

#include <cmath>

namespace orvo {
namespace {

using testing::Bytes;
using testing::encoded;

template <class Set>
Bytes planWith(Set&& set) {
    auto plan = std::make_shared<DirectionsPlan>();
    set(*plan);
    return encoded(*plan);
}

std::shared_ptr<DirectionsPlan> fullPlan() {
    auto plan = std::make_shared<DirectionsPlan>();
    plan->setIsPlayingTrace(true);
    plan->setExpiryTime(17);
    plan->setTransitSurchargeOption(16);
    plan->setTransitPrioritization(3);
    plan->setRoutesPerLaterPage(14);
    plan->setRoutesPerEarlierPage(13);
    plan->setLaterPagesLoaded(12);
    plan->setEarlierPagesLoaded(11);
    plan->setRoutesPerInitialPage(10);
    plan->setTransitPreferences(std::make_shared<DirectionsPlanTransitPreferences>());
    plan->transitPreferences()->setAvoidBusRoutes(true);
    plan->setDisplayMethod(2);
    plan->setCurrentRouteStep(7);
    plan->setCurrentRouteIndex(6);
    plan->setArrivalTime(5);
    plan->setDepartureTime(4);
    plan->setDestinationString("there");
    plan->setOriginString("here");
    plan->setRouteRequestStorage(std::make_shared<RouteRequestStorage>());
    plan->routeRequestStorage()->setBytes({0x08, 0x01});
    return plan;
}

TEST(DirectionsPlan, EachFieldHasItsNumberAndWireType) {
    EXPECT_EQ(planWith([](auto& p) {
                  p.setRouteRequestStorage(std::make_shared<RouteRequestStorage>());
              }),
              (Bytes{0x0a, 0}));
    EXPECT_EQ(planWith([](auto& p) { p.setOriginString("a"); }), (Bytes{0x12, 1, 'a'}));
    EXPECT_EQ(planWith([](auto& p) { p.setDestinationString(""); }), (Bytes{0x1a, 0}));
    EXPECT_EQ(planWith([](auto& p) { p.setDepartureTime(1); }),
              (Bytes{0x21, 0, 0, 0, 0, 0, 0, 0xf0, 0x3f}));
    EXPECT_EQ(planWith([](auto& p) { p.setArrivalTime(0); }),
              (Bytes{0x29, 0, 0, 0, 0, 0, 0, 0, 0}));
    EXPECT_EQ(planWith([](auto& p) { p.setCurrentRouteIndex(0); }), (Bytes{0x30, 0}));
    EXPECT_EQ(planWith([](auto& p) { p.setCurrentRouteStep(300); }), (Bytes{0x38, 0xac, 0x02}));
    EXPECT_EQ(planWith([](auto& p) { p.setDisplayMethod(1); }), (Bytes{0x40, 1}));
    EXPECT_EQ(planWith([](auto& p) {
                  p.setTransitPreferences(std::make_shared<DirectionsPlanTransitPreferences>());
              }),
              (Bytes{0x4a, 0}));
    EXPECT_EQ(planWith([](auto& p) { p.setRoutesPerInitialPage(1); }), (Bytes{0x50, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setEarlierPagesLoaded(1); }), (Bytes{0x58, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setLaterPagesLoaded(1); }), (Bytes{0x60, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setRoutesPerEarlierPage(1); }), (Bytes{0x68, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setRoutesPerLaterPage(1); }), (Bytes{0x70, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setTransitPrioritization(1); }), (Bytes{0x78, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setTransitSurchargeOption(1); }), (Bytes{0x80, 0x01, 1}));
    EXPECT_EQ(planWith([](auto& p) { p.setExpiryTime(0); }),
              (Bytes{0x89, 0x01, 0, 0, 0, 0, 0, 0, 0, 0}));
}

TEST(DirectionsPlan, OnlyIsPlayingTraceWritesField404) {
    EXPECT_EQ(planWith([](auto& p) { p.setIsPlayingTrace(true); }), (Bytes{0xa0, 0x19, 0x01}));
    EXPECT_EQ(planWith([](auto& p) { p.setIsPlayingTrace(false); }), (Bytes{0xa0, 0x19, 0x00}));
}

TEST(DirectionsPlan, WritesInAscendingNumberWhateverTheOrderOfSetting) {
    const auto bytes = encoded(*fullPlan());
    ProtoReader reader(bytes);
    std::vector<std::uint32_t> numbers;
    while (!reader.isAtEnd()) {
        const auto tag = reader.readTag();
        numbers.push_back(tag.fieldNumber);
        reader.skip(tag);
    }
    EXPECT_EQ(numbers,
              (std::vector<std::uint32_t>{
                  1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16, 17, 404}));
}

TEST(DirectionsPlan, PresenceBitsGoByWidthThenByName) {
    EXPECT_EQ(DirectionsPlan::ArrivalTimeBit, 1U);
    EXPECT_EQ(DirectionsPlan::CurrentRouteIndexBit, 2U);
    EXPECT_EQ(DirectionsPlan::CurrentRouteStepBit, 4U);
    EXPECT_EQ(DirectionsPlan::DepartureTimeBit, 8U);
    EXPECT_EQ(DirectionsPlan::ExpiryTimeBit, 16U);
    EXPECT_EQ(DirectionsPlan::DisplayMethodBit, 32U);
    EXPECT_EQ(DirectionsPlan::EarlierPagesLoadedBit, 64U);
    EXPECT_EQ(DirectionsPlan::LaterPagesLoadedBit, 128U);
    EXPECT_EQ(DirectionsPlan::RoutesPerEarlierPageBit, 256U);
    EXPECT_EQ(DirectionsPlan::RoutesPerInitialPageBit, 512U);
    EXPECT_EQ(DirectionsPlan::RoutesPerLaterPageBit, 1024U);
    EXPECT_EQ(DirectionsPlan::TransitPrioritizationBit, 2048U);
    EXPECT_EQ(DirectionsPlan::TransitSurchargeOptionBit, 4096U);
    EXPECT_EQ(DirectionsPlan::IsPlayingTraceBit, 8192U);
}

TEST(DirectionsPlan, DisplayMethodsHaveTheirNames) {
    EXPECT_EQ(DirectionsPlan::displayMethodAsString(0), "DirectionsSearch");
    EXPECT_EQ(DirectionsPlan::displayMethodAsString(1), "RoutePicking");
    EXPECT_EQ(DirectionsPlan::displayMethodAsString(2), "DirectionsStarted");
    EXPECT_EQ(DirectionsPlan::displayMethodAsString(3), "(unknown: 3)");
    EXPECT_EQ(DirectionsPlan::StringAsDisplayMethod("DirectionsStarted"), 2);
    EXPECT_EQ(DirectionsPlan::StringAsDisplayMethod("else"), 0);
}

TEST(DirectionsPlan, TransitPrioritizationsHaveTheirNames) {
    EXPECT_EQ(DirectionsPlan::transitPrioritizationAsString(0), "TRANSIT_PRIORITIZE_DEFAULT");
    EXPECT_EQ(DirectionsPlan::transitPrioritizationAsString(1),
              "TRANSIT_PRIORITIZE_BY_TRAVEL_TIME");
    EXPECT_EQ(DirectionsPlan::transitPrioritizationAsString(2),
              "TRANSIT_PRIORITIZE_BY_TRANSFER_COUNT");
    EXPECT_EQ(DirectionsPlan::transitPrioritizationAsString(3),
              "TRANSIT_PRIORITIZE_BY_WALKING_DISTANCE");
    EXPECT_EQ(DirectionsPlan::transitPrioritizationAsString(4), "(unknown: 4)");
    EXPECT_EQ(
        DirectionsPlan::StringAsTransitPrioritization("TRANSIT_PRIORITIZE_BY_WALKING_DISTANCE"), 3);
    EXPECT_EQ(DirectionsPlan::StringAsTransitPrioritization("DEFAULT"), 0);
}

TEST(DirectionsPlan, ReadsBackEveryFieldThatItWrites) {
    const auto plan = fullPlan();
    const auto again = protoMessageWithBytes<DirectionsPlan>(encoded(*plan));
    ASSERT_TRUE(again);
    EXPECT_TRUE(equal(plan, again));
    EXPECT_EQ(plan->hash(), again->hash());
    EXPECT_EQ(encoded(*again), encoded(*plan));
}

TEST(DirectionsPlan, CutAtEveryByteFailsOrEndsBetweenFields) {
    const auto bytes = encoded(*fullPlan());
    std::size_t whole = 0;
    for (std::size_t length = 0; length < bytes.size(); ++length) {
        const auto block = std::make_unique<std::uint8_t[]>(length);
        std::copy_n(bytes.begin(), length, block.get());
        DirectionsPlan plan;
        ProtoReader reader({block.get(), length});
        if (plan.readFrom(reader))
            ++whole;
    }
    EXPECT_EQ(whole, 18U); // nothing at all, and after each of the first 17 fields
}

TEST(DirectionsPlan, FieldsOutsideItsSchemaAreSkippedAndDropped) {
    // 18 varint, 403 varint, 405 fixed 32, and the known 404
    const Bytes bytes{0x90, 0x01, 1, 0x98, 0x19, 1, 0xad, 0x19, 0, 0, 0, 0, 0xa0, 0x19, 1};
    const auto plan = protoMessageWithBytes<DirectionsPlan>(bytes);
    ASSERT_TRUE(plan);
    EXPECT_TRUE(plan->isPlayingTrace());
    EXPECT_EQ(encoded(*plan), (Bytes{0xa0, 0x19, 1}));
}

TEST(DirectionsPlan, KnownFieldOfAnotherWireTypeIsSkipped) {
    const auto plan =
        protoMessageWithBytes<DirectionsPlan>(Bytes{0x20, 1, 0x12, 1, 'a'}); // field 4 as a varint
    ASSERT_TRUE(plan);
    EXPECT_FALSE(plan->hasDepartureTime());
    EXPECT_EQ(plan->originString(), "a");
}

TEST(DirectionsPlan, NegativeZeroKeepsItsBitsAndPresenceIsNotByValue) {
    auto plan = std::make_shared<DirectionsPlan>();
    plan->setDepartureTime(-0.0);
    plan->setArrivalTime(0.0);
    const auto again = protoMessageWithBytes<DirectionsPlan>(encoded(*plan));
    ASSERT_TRUE(again);
    EXPECT_TRUE(again->hasDepartureTime());
    EXPECT_TRUE(again->hasArrivalTime());
    EXPECT_TRUE(std::signbit(again->departureTime()));
    EXPECT_FALSE(std::signbit(again->arrivalTime()));
}

TEST(DirectionsPlan, SubMessagesMergeRecursively) {
    auto a = std::make_shared<DirectionsPlan>();
    a->setTransitPreferences(std::make_shared<DirectionsPlanTransitPreferences>());
    a->transitPreferences()->setAvoidBusRoutes(true);
    a->setRouteRequestStorage(std::make_shared<RouteRequestStorage>());
    a->routeRequestStorage()->setBytes({1});
    DirectionsPlan b;
    b.setTransitPreferences(std::make_shared<DirectionsPlanTransitPreferences>());
    b.transitPreferences()->setAvoidFerryRoutes(false);
    b.setRouteRequestStorage(std::make_shared<RouteRequestStorage>());
    b.routeRequestStorage()->setBytes({2});
    a->mergeFrom(b);
    EXPECT_TRUE(a->transitPreferences()->avoidBusRoutes());
    EXPECT_TRUE(a->transitPreferences()->hasAvoidFerryRoutes());
    EXPECT_EQ(a->routeRequestStorage()->bytes(), (Bytes{1, 2}));
    EXPECT_FALSE(b.transitPreferences()->hasAvoidBusRoutes());
}

/// Sets a scalar, takes its presence away and gives it back, and looks at it alone.
template <class Message, class Value>
void expectPresenceOfItsOwn(const char* name,
                            Value (Message::*get)() const,
                            void (Message::*set)(Value),
                            bool (Message::*has)() const,
                            void (Message::*setHas)(bool)) {
    SCOPED_TRACE(name);
    Message message;
    EXPECT_FALSE((message.*has)());
    (message.*set)(Value{1});
    EXPECT_TRUE((message.*has)());
    EXPECT_EQ((message.*get)(), Value{1});
    EXPECT_EQ(message.dictionaryRepresentation()->count(), 1U);
    EXPECT_TRUE(message.dictionaryRepresentation()->objectForKey(name));
    (message.*setHas)(false);
    EXPECT_FALSE((message.*has)());
    EXPECT_TRUE(encoded(message).empty());
    (message.*setHas)(true);
    EXPECT_EQ((message.*get)(), Value{1}) << "the value stays";
    EXPECT_EQ(message.dictionaryRepresentation()->count(), 1U);
}

TEST(DirectionsPlan, EveryScalarHasAPresenceOfItsOwn) {
    using Plan = DirectionsPlan;
    expectPresenceOfItsOwn<Plan>("departureTime",
                                 &Plan::departureTime,
                                 &Plan::setDepartureTime,
                                 &Plan::hasDepartureTime,
                                 &Plan::setHasDepartureTime);
    expectPresenceOfItsOwn<Plan>("arrivalTime",
                                 &Plan::arrivalTime,
                                 &Plan::setArrivalTime,
                                 &Plan::hasArrivalTime,
                                 &Plan::setHasArrivalTime);
    expectPresenceOfItsOwn<Plan>("currentRouteIndex",
                                 &Plan::currentRouteIndex,
                                 &Plan::setCurrentRouteIndex,
                                 &Plan::hasCurrentRouteIndex,
                                 &Plan::setHasCurrentRouteIndex);
    expectPresenceOfItsOwn<Plan>("currentRouteStep",
                                 &Plan::currentRouteStep,
                                 &Plan::setCurrentRouteStep,
                                 &Plan::hasCurrentRouteStep,
                                 &Plan::setHasCurrentRouteStep);
    expectPresenceOfItsOwn<Plan>("displayMethod",
                                 &Plan::displayMethod,
                                 &Plan::setDisplayMethod,
                                 &Plan::hasDisplayMethod,
                                 &Plan::setHasDisplayMethod);
    expectPresenceOfItsOwn<Plan>("routesPerInitialPage",
                                 &Plan::routesPerInitialPage,
                                 &Plan::setRoutesPerInitialPage,
                                 &Plan::hasRoutesPerInitialPage,
                                 &Plan::setHasRoutesPerInitialPage);
    expectPresenceOfItsOwn<Plan>("earlierPagesLoaded",
                                 &Plan::earlierPagesLoaded,
                                 &Plan::setEarlierPagesLoaded,
                                 &Plan::hasEarlierPagesLoaded,
                                 &Plan::setHasEarlierPagesLoaded);
    expectPresenceOfItsOwn<Plan>("laterPagesLoaded",
                                 &Plan::laterPagesLoaded,
                                 &Plan::setLaterPagesLoaded,
                                 &Plan::hasLaterPagesLoaded,
                                 &Plan::setHasLaterPagesLoaded);
    expectPresenceOfItsOwn<Plan>("routesPerEarlierPage",
                                 &Plan::routesPerEarlierPage,
                                 &Plan::setRoutesPerEarlierPage,
                                 &Plan::hasRoutesPerEarlierPage,
                                 &Plan::setHasRoutesPerEarlierPage);
    expectPresenceOfItsOwn<Plan>("routesPerLaterPage",
                                 &Plan::routesPerLaterPage,
                                 &Plan::setRoutesPerLaterPage,
                                 &Plan::hasRoutesPerLaterPage,
                                 &Plan::setHasRoutesPerLaterPage);
    expectPresenceOfItsOwn<Plan>("transitPrioritization",
                                 &Plan::transitPrioritization,
                                 &Plan::setTransitPrioritization,
                                 &Plan::hasTransitPrioritization,
                                 &Plan::setHasTransitPrioritization);
    expectPresenceOfItsOwn<Plan>("transitSurchargeOption",
                                 &Plan::transitSurchargeOption,
                                 &Plan::setTransitSurchargeOption,
                                 &Plan::hasTransitSurchargeOption,
                                 &Plan::setHasTransitSurchargeOption);
    expectPresenceOfItsOwn<Plan>("expiryTime",
                                 &Plan::expiryTime,
                                 &Plan::setExpiryTime,
                                 &Plan::hasExpiryTime,
                                 &Plan::setHasExpiryTime);
    expectPresenceOfItsOwn<Plan>("isPlayingTrace",
                                 &Plan::isPlayingTrace,
                                 &Plan::setIsPlayingTrace,
                                 &Plan::hasIsPlayingTrace,
                                 &Plan::setHasIsPlayingTrace);
    using Preferences = DirectionsPlanTransitPreferences;
    expectPresenceOfItsOwn<Preferences>("avoidBusRoutes",
                                        &Preferences::avoidBusRoutes,
                                        &Preferences::setAvoidBusRoutes,
                                        &Preferences::hasAvoidBusRoutes,
                                        &Preferences::setHasAvoidBusRoutes);
    expectPresenceOfItsOwn<Preferences>("avoidMetroLightRailRoutes",
                                        &Preferences::avoidMetroLightRailRoutes,
                                        &Preferences::setAvoidMetroLightRailRoutes,
                                        &Preferences::hasAvoidMetroLightRailRoutes,
                                        &Preferences::setHasAvoidMetroLightRailRoutes);
    expectPresenceOfItsOwn<Preferences>("avoidRailRoutes",
                                        &Preferences::avoidRailRoutes,
                                        &Preferences::setAvoidRailRoutes,
                                        &Preferences::hasAvoidRailRoutes,
                                        &Preferences::setHasAvoidRailRoutes);
    expectPresenceOfItsOwn<Preferences>("avoidFerryRoutes",
                                        &Preferences::avoidFerryRoutes,
                                        &Preferences::setAvoidFerryRoutes,
                                        &Preferences::hasAvoidFerryRoutes,
                                        &Preferences::setHasAvoidFerryRoutes);
}

TEST(DirectionsPlan, EveryFieldCountsInEquality) {
    const auto differing = [](auto&& change) {
        const auto plan = fullPlan();
        change(*plan);
        return !equal(fullPlan(), plan) && !equal(plan, fullPlan());
    };
    EXPECT_TRUE(differing([](auto& p) { p.routeRequestStorage()->setBytes({0x08, 0x02}); }));
    EXPECT_TRUE(differing([](auto& p) { p.setOriginString(std::nullopt); }));
    EXPECT_TRUE(differing([](auto& p) { p.setDestinationString("elsewhere"); }));
    EXPECT_TRUE(differing([](auto& p) { p.setDepartureTime(4.5); }));
    EXPECT_TRUE(differing([](auto& p) { p.setHasArrivalTime(false); }));
    EXPECT_TRUE(differing([](auto& p) { p.setCurrentRouteIndex(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setCurrentRouteStep(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setDisplayMethod(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.transitPreferences()->setAvoidBusRoutes(false); }));
    EXPECT_TRUE(differing([](auto& p) { p.transitPreferences()->setAvoidRailRoutes(false); }));
    EXPECT_TRUE(differing([](auto& p) { p.setRoutesPerInitialPage(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setEarlierPagesLoaded(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setLaterPagesLoaded(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setRoutesPerEarlierPage(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setRoutesPerLaterPage(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setTransitPrioritization(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setTransitSurchargeOption(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setExpiryTime(0); }));
    EXPECT_TRUE(differing([](auto& p) { p.setIsPlayingTrace(false); }));
    EXPECT_FALSE(differing([](auto&) {}));
}

TEST(DirectionsPlan, CopyIsDeepAndCopyToLeavesTheRest) {
    const auto plan = fullPlan();
    const auto copy = std::dynamic_pointer_cast<DirectionsPlan>(plan->copy());
    ASSERT_TRUE(copy);
    EXPECT_TRUE(equal(plan, copy));
    copy->transitPreferences()->setAvoidBusRoutes(false);
    copy->routeRequestStorage()->setBytes({});
    EXPECT_TRUE(plan->transitPreferences()->avoidBusRoutes());
    EXPECT_EQ(plan->routeRequestStorage()->bytes(), (Bytes{0x08, 0x01}));
    DirectionsPlan source;
    source.setExpiryTime(0);
    source.copyTo(*copy);
    EXPECT_EQ(copy->expiryTime(), 0);
    EXPECT_EQ(copy->originString(), "here");
    EXPECT_TRUE(copy->isPlayingTrace());
}

TEST(DirectionsPlan, DescriptionIsTheRootDescriptionAndTheDictionary) {
    DirectionsPlan plan;
    plan.setDisplayMethod(1);
    EXPECT_EQ(plan.description(), plan.rootDescription() + " {displayMethod = RoutePicking}");
}

TEST(DirectionsPlan, HashIsTheExclusiveOrOfItsFields) {
    DirectionsPlan plan;
    EXPECT_EQ(plan.hash(), 0U);
    plan.setDepartureTime(2.25);
    EXPECT_EQ(plan.hash(), 4611686023736259426ULL);
    plan.setExpiryTime(0.7);
    EXPECT_EQ(plan.hash(), 4611686023736259426ULL ^ 2654435761ULL);
    plan.setCurrentRouteIndex(3);
    EXPECT_EQ(plan.hash(), 4611686023736259426ULL ^ 2654435761ULL ^ (3U * 2654435761ULL));
    plan.setHasDepartureTime(false);
    plan.setHasExpiryTime(false);
    plan.setHasCurrentRouteIndex(false);
    EXPECT_EQ(plan.hash(), 0U);
}

TEST(DirectionsPlan, DictionaryNamesEveryPresentField) {
    EXPECT_EQ(DirectionsPlan().dictionaryRepresentation()->count(), 0U);
    const auto dictionary = fullPlan()->dictionaryRepresentation();
    EXPECT_EQ(dictionary->count(), 18U);
    EXPECT_TRUE(
        equal(dictionary->objectForKey("displayMethod"), NSString::string("DirectionsStarted")));
    EXPECT_TRUE(equal(dictionary->objectForKey("transitPrioritization"),
                      NSString::string("TRANSIT_PRIORITIZE_BY_WALKING_DISTANCE")));
    EXPECT_TRUE(equal(dictionary->objectForKey("expiryTime"), NSNumber::numberWithDouble(17)));
    EXPECT_TRUE(equal(dictionary->objectForKey("isPlayingTrace"), NSNumber::numberWithBool(true)));
    EXPECT_TRUE(equal(dictionary->objectForKey("transitPreferences"),
                      NSDictionary::dictionaryWithTextKeys(
                          {{"avoidBusRoutes", NSNumber::numberWithBool(true)}})));
}

TEST(DirectionsPlanTransitPreferences, OnlyAvoidFerryRoutesWritesOnlyFieldFour) {
    DirectionsPlanTransitPreferences preferences;
    preferences.setAvoidFerryRoutes(true);
    EXPECT_EQ(encoded(preferences), (Bytes{0x20, 1}));
    preferences.setAvoidFerryRoutes(false);
    EXPECT_EQ(encoded(preferences), (Bytes{0x20, 0}));
}

TEST(DirectionsPlanTransitPreferences, NumbersAreNotAlphabeticalButBitsAre) {
    DirectionsPlanTransitPreferences preferences;
    preferences.setAvoidBusRoutes(true);
    preferences.setAvoidMetroLightRailRoutes(true);
    preferences.setAvoidRailRoutes(true);
    EXPECT_EQ(encoded(preferences), (Bytes{0x08, 1, 0x10, 1, 0x18, 1}));
    EXPECT_EQ(DirectionsPlanTransitPreferences::AvoidBusRoutesBit, 1U);
    EXPECT_EQ(DirectionsPlanTransitPreferences::AvoidFerryRoutesBit, 2U);
    EXPECT_EQ(DirectionsPlanTransitPreferences::AvoidMetroLightRailRoutesBit, 4U);
    EXPECT_EQ(DirectionsPlanTransitPreferences::AvoidRailRoutesBit, 8U);
}

TEST(DirectionsPlanTransitPreferences, ReaderAcceptsOneToFour) {
    const auto preferences =
        protoMessageWithBytes<DirectionsPlanTransitPreferences>(Bytes{0x28, 1, 0x00, 1, 0x18, 2});
    ASSERT_TRUE(preferences);
    EXPECT_TRUE(preferences->avoidRailRoutes());
    EXPECT_EQ(encoded(*preferences), (Bytes{0x18, 1}));
}

} // namespace
} // namespace orvo
