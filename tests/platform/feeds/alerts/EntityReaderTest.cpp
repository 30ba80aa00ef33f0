#include "platform/feeds/alerts/EntityReader.h"

#include "AlertMaker.h"
#include "platform/feeds/alerts/SelectorShapes.h"

#include <gtest/gtest.h>

#include <memory_resource>

namespace orvo::testing {

namespace {

/// An entity read, with the bytes that the answer views.
struct Reading {
    std::string bytes;
    AlertStatistics statistics;
    EntityReader reader;
    AlertReading reading;

    explicit Reading(const Wire& entity, const SelectorShapes* passedOver = nullptr)
        : bytes(entity.str())
        , reader(statistics, passedOver)
        , reading(reader.read(bytes)) {}
    Reading(const Reading&) = delete;
    Reading& operator=(const Reading&) = delete;
    ~Reading() = default;

    [[nodiscard]] const Alert& alert() const { return reading.alert.value(); }
    [[nodiscard]] std::uint64_t count(AlertCount reason) const { return statistics.count(reason); }
};

AlertMaker with(const Wire& more) {
    AlertMaker maker;
    maker.more = more;
    return maker;
}

AlertMaker withSelector(const Wire& selector) {
    AlertMaker maker;
    maker.selectors = {selector, route("R2")};
    return maker;
}

std::string routesOf(const AlertSelectors& selectors) {
    std::string text;
    for (const AlertSelector& selector : selectors)
        text += (text.empty() ? "" : " ") + std::string(selector.routeId);
    return text;
}

/// Of a form that can be recognised.
Wire ofAgency(std::string_view line) {
    return Wire().bytes(1, "A1").bytes(2, line);
}

/// Counts what is taken from it and not given back.
class CountingResource final : public std::pmr::memory_resource {
public:
    [[nodiscard]] std::size_t live() const noexcept { return _live; }

private:
    void* do_allocate(std::size_t bytes, std::size_t alignment) override {
        _live += bytes;
        return std::pmr::new_delete_resource()->allocate(bytes, alignment);
    }
    void do_deallocate(void* block, std::size_t bytes, std::size_t alignment) override {
        _live -= bytes;
        std::pmr::new_delete_resource()->deallocate(block, bytes, alignment);
    }
    [[nodiscard]] bool do_is_equal(const memory_resource& other) const noexcept override {
        return this == &other;
    }

    std::size_t _live = 0;
};

const std::string BadText = "caf\xE9";

} // namespace

TEST(EntityReader, ReadsEveryField) {
    AlertMaker maker;
    maker.id = "a7";
    maker.activePeriods = {period(1, 2)};
    maker.communicationPeriods = {period(3, 0)};
    maker.impactPeriods = {period(0, 4)};
    maker.selectors = {Wire().bytes(1, "A").bytes(2, "R").number(3, 0).bytes(5, "S"),
                       Wire().bytes(4, Wire().bytes(1, "T").bytes(2, "08:00").bytes(5, "TR"))};
    maker.cause = 4;
    maker.effect = 1;
    maker.severity = 3;
    maker.spokenHeader = {{"spoken", ""}};
    maker.link = {{"https://example.invalid", "fr"}};
    const Reading read(maker.entity());
    const Alert& alert = read.alert();
    EXPECT_EQ(alert.id, "a7");
    EXPECT_EQ(alert.activePeriods.at(0).start, 1U);
    EXPECT_EQ(alert.activePeriods.at(0).end, 2U);
    EXPECT_EQ(alert.communicationPeriods.at(0).end, std::nullopt);
    EXPECT_EQ(alert.impactPeriods.at(0).start, std::nullopt);
    EXPECT_EQ(alert.selectors.at(0).agencyId, "A");
    EXPECT_EQ(alert.selectors.at(0).routeId, "R");
    EXPECT_EQ(alert.selectors.at(0).routeType, 0);
    EXPECT_EQ(alert.selectors.at(0).stopId, "S");
    EXPECT_EQ(alert.selectors.at(1).tripId, "T");
    EXPECT_TRUE(alert.selectors.at(1).namesDeparture);
    EXPECT_EQ(alert.selectors.at(1).tripRouteId, "TR");
    EXPECT_EQ(alert.selectors.at(1).routeType, std::nullopt);
    EXPECT_EQ(alert.cause, 4);
    EXPECT_EQ(alert.effect, 1);
    EXPECT_EQ(alert.severity, 3);
    EXPECT_EQ(alert.header.at(0).text, "Trams turn early");
    EXPECT_EQ(alert.header.at(0).language, "en");
    EXPECT_EQ(alert.spokenHeader.at(0).language, "");
    EXPECT_EQ(alert.link.at(0).text, "https://example.invalid");
    EXPECT_FALSE(read.reading.mayConcernAnyLine);
    EXPECT_EQ(read.statistics.unreadable(), 0U);
}

TEST(EntityReader, DefaultsAreThoseOfTheFormat) {
    AlertMaker maker;
    maker.effect = 0;
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().cause, 1);
    EXPECT_EQ(read.alert().effect, 8);
    EXPECT_EQ(read.alert().severity, 1);
}

TEST(EntityReader, DeletedEntitiesAreSkippedWhereverTheySaySo) {
    const Reading before(Wire().number(2, 1).raw(AlertMaker().entity().str()));
    const Reading after(AlertMaker().entity().number(2, 1));
    EXPECT_FALSE(before.reading.alert);
    EXPECT_FALSE(after.reading.alert);
    EXPECT_FALSE(after.reading.mayConcernAnyLine);
    EXPECT_EQ(after.count(AlertCount::DeletedEntities), 1U);
    EXPECT_TRUE(Reading(AlertMaker().entity().number(2, 0)).reading.alert);
}

TEST(EntityReader, AnyNumberButZeroMeansDeleted) {
    for (const std::uint64_t number : {2ULL, 256ULL, 1ULL << 32U, 1ULL << 63U, ~0ULL})
        EXPECT_FALSE(Reading(AlertMaker().entity().number(2, number)).reading.alert) << number;
}

TEST(EntityReader, TripUpdatesAndVehiclesAreNoAlerts) {
    const Reading trip(Wire().bytes(1, "t").bytes(3, "whatever this is"));
    const Reading vehicle(Wire().bytes(1, "v").bytes(4, ""));
    EXPECT_FALSE(trip.reading.alert);
    EXPECT_FALSE(trip.reading.mayConcernAnyLine);
    EXPECT_EQ(trip.count(AlertCount::OtherEntities), 1U);
    EXPECT_FALSE(vehicle.reading.alert);
}

TEST(EntityReader, ABadIdCostsOnlyTheId) {
    AlertMaker maker;
    maker.id = BadText;
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().id, "");
    EXPECT_EQ(read.count(AlertCount::UnreadableIds), 1U);
    EXPECT_EQ(read.alert().selectors.size(), 1U);
}

TEST(EntityReader, ABadPeriodIsCountedAndLeavesOpenWhenTheAlertHolds) {
    AlertMaker maker = with(Wire().number(1, 5));
    maker.activePeriods = {Wire().raw("\x08"), period(1, 2)};
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().activePeriods.size(), 3U);
    EXPECT_EQ(read.count(AlertCount::UnreadablePeriods), 2U);
    EXPECT_FALSE(read.reading.mayConcernAnyLine);
}

TEST(EntityReader, BadPeriodsInARowLeaveItOpenNoMoreThanOne) {
    AlertMaker maker;
    maker.activePeriods = {period(1, 2)};
    const Wire bad = Wire().number(1, 7);
    maker.more = Wire().bytes(1, bad).number(1, 3).number(1, 3).number(1, 3);
    const Reading read(maker.entity());
    ASSERT_EQ(read.alert().activePeriods.size(), 3U);
    EXPECT_EQ(read.alert().activePeriods[0].start, 1U);
    EXPECT_EQ(read.alert().activePeriods[1].start, 7U);
    EXPECT_EQ(read.alert().activePeriods[2].start, std::nullopt);
    EXPECT_EQ(read.alert().activePeriods[2].end, std::nullopt);
    EXPECT_EQ(read.count(AlertCount::UnreadablePeriods), 3U);
}

TEST(EntityReader, ABadTextCostsOnlyThatTranslation) {
    AlertMaker maker;
    maker.header = {{BadText, "fr"}, {"good", "en"}};
    const Reading read(maker.entity());
    ASSERT_EQ(read.alert().header.size(), 1U);
    EXPECT_EQ(read.alert().header[0].text, "good");
    EXPECT_EQ(read.count(AlertCount::UnreadableTexts), 1U);
}

TEST(EntityReader, ABadLanguageCostsOnlyTheTag) {
    AlertMaker maker;
    maker.header = {{"good", BadText}};
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().header.at(0).language, "");
    EXPECT_EQ(read.count(AlertCount::UnreadableTexts), 1U);
}

TEST(EntityReader, BlankTextsAreNone) {
    AlertMaker maker;
    maker.header = {{"", "fr"}, {" \n", "de"}, {"good", "en"}};
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().header.size(), 1U);
    EXPECT_EQ(read.count(AlertCount::UnreadableTexts), 0U);
}

TEST(EntityReader, UnlistedAndBadNumbersLeaveTheDefault) {
    AlertMaker maker = with(Wire().bytes(6, "x").number(14, 99));
    maker.effect = 12;
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().cause, 1);
    EXPECT_EQ(read.alert().effect, 8);
    EXPECT_EQ(read.alert().severity, 1);
    EXPECT_EQ(read.count(AlertCount::UnreadableNumbers), 3U);
}

TEST(EntityReader, ListedNumbersEndWithTheLastOfTheFormat) {
    AlertMaker last = with(Wire().number(6, 12).number(14, 4));
    last.effect = 11;
    const Reading listed(last.entity());
    EXPECT_EQ(listed.alert().cause, 12);
    EXPECT_EQ(listed.alert().effect, 11);
    EXPECT_EQ(listed.alert().severity, 4);
    EXPECT_EQ(listed.count(AlertCount::UnreadableNumbers), 0U);
    AlertMaker next = with(Wire().number(6, 13).number(14, 5));
    next.effect = 12;
    const Reading unlisted(next.entity());
    EXPECT_EQ(unlisted.alert().cause, 1);
    EXPECT_EQ(unlisted.alert().effect, 8);
    EXPECT_EQ(unlisted.alert().severity, 1);
    EXPECT_EQ(unlisted.count(AlertCount::UnreadableNumbers), 3U);
}

TEST(EntityReader, AnUnreadableSelectorLeavesTheOthersAndMayConcernAnyLine) {
    const std::vector<Wire> bad = {
        Wire().bytes(2, BadText),
        Wire().bytes(1, "A1").bytes(5, BadText),
        Wire().number(2, 7),
        Wire().bytes(3, "bus"),
        Wire().number(4, 7),
        Wire().bytes(4, Wire().number(5, 7)),
        Wire().bytes(2, "R1").raw("\x2A\x05S"),
        Wire().raw("\xFF\xFF"),
    };
    for (const Wire& selector : bad) {
        const Reading read(withSelector(selector).entity());
        ASSERT_EQ(read.alert().selectors.size(), 1U);
        EXPECT_EQ(read.alert().selectors[0].routeId, "R2");
        EXPECT_TRUE(read.reading.mayConcernAnyLine);
        EXPECT_EQ(read.count(AlertCount::UnreadableSelectors), 1U);
    }
}

TEST(EntityReader, ASelectorOfTheWrongWireTypeMayConcernAnyLine) {
    const Reading read(with(Wire().number(5, 1)).entity());
    EXPECT_TRUE(read.reading.mayConcernAnyLine);
    EXPECT_EQ(read.alert().selectors.size(), 1U);
}

TEST(EntityReader, AGroupIsTheWrongTypeOfEveryKnownFieldOfASelector) {
    for (std::uint32_t field = 1; field <= 5; ++field) {
        const Reading read(withSelector(route("R1").group(field)).entity());
        EXPECT_EQ(read.alert().selectors.size(), 1U) << field;
        EXPECT_TRUE(read.reading.mayConcernAnyLine) << field;
        EXPECT_EQ(read.count(AlertCount::UnreadableSelectors), 1U) << field;
    }
    const Reading whole(with(Wire().group(5)).entity());
    EXPECT_TRUE(whole.reading.mayConcernAnyLine);
}

TEST(EntityReader, AGroupAsAnAlertMayConcernAnyLine) {
    const Reading read(Wire().bytes(1, "x").group(5));
    EXPECT_TRUE(read.reading.mayConcernAnyLine);
    EXPECT_EQ(read.count(AlertCount::UnreadableAlerts), 1U);
}

TEST(EntityReader, AGroupAsAnyOtherFieldIsCountedAndCostsOnlyThatField) {
    AlertMaker maker = with(Wire().group(6).group(7).group(14));
    maker.activePeriods = {period(1, 2).group(2)};
    maker.header = {{"good", "en"}};
    const Reading read(maker.entity().group(1).group(2));
    EXPECT_EQ(read.count(AlertCount::UnreadableNumbers), 4U);
    EXPECT_EQ(read.count(AlertCount::UnreadablePeriods), 1U);
    EXPECT_EQ(read.count(AlertCount::UnreadableIds), 1U);
    EXPECT_EQ(read.alert().effect, 4);
    EXPECT_FALSE(read.reading.mayConcernAnyLine);
    const Reading texts(with(Wire().group(10).bytes(11, Wire().group(1))).entity());
    EXPECT_EQ(texts.count(AlertCount::UnreadableTexts), 2U);
}

TEST(EntityReader, APeriodThatIsAGroupLeavesOpenWhenTheAlertHolds) {
    AlertMaker maker = with(Wire().group(1));
    maker.activePeriods = {period(1, 2)};
    const Reading read(maker.entity());
    ASSERT_EQ(read.alert().activePeriods.size(), 2U);
    EXPECT_EQ(read.alert().activePeriods[1].start, std::nullopt);
    EXPECT_EQ(read.alert().activePeriods[1].end, std::nullopt);
}

TEST(EntityReader, ATripWhoseFieldsAreOfTheWrongTypeMayMeanAnyLine) {
    for (const Wire& trip : {Wire().bytes(5, "R1").number(1, 7),
                             Wire().bytes(5, "R1").number(2, 8),
                             Wire().bytes(1, "T1").number(5, 7),
                             Wire().bytes(1, "T1").group(5)}) {
        const Reading read(withSelector(Wire().bytes(4, trip)).entity());
        EXPECT_EQ(read.alert().selectors.size(), 1U);
        EXPECT_TRUE(read.reading.mayConcernAnyLine);
    }
    const Reading date(withSelector(Wire().bytes(4, Wire().bytes(5, "R1").number(3, 7))).entity());
    EXPECT_EQ(date.alert().selectors.size(), 2U);
    EXPECT_FALSE(date.reading.mayConcernAnyLine);
}

TEST(EntityReader, ABadDirectionNarrowsNothing) {
    const Reading read(withSelector(route("R1").bytes(6, "in")).entity());
    EXPECT_EQ(read.alert().selectors.size(), 2U);
    EXPECT_FALSE(read.reading.mayConcernAnyLine);
}

TEST(EntityReader, EmptySelectorsAreCountedAndDropped) {
    for (const Wire& selector :
         {Wire(), Wire().bytes(2, "").bytes(5, ""), Wire().number(6, 1), Wire().bytes(4, "")}) {
        const Reading read(withSelector(selector).entity());
        EXPECT_EQ(read.alert().selectors.size(), 1U);
        EXPECT_EQ(read.count(AlertCount::EmptySelectors), 1U);
        EXPECT_FALSE(read.reading.mayConcernAnyLine);
    }
}

TEST(EntityReader, AnAlertThatBreaksOffKeepsWhatStoodBefore) {
    const Reading read(with(Wire().raw("\x52\x7F")).entity());
    EXPECT_EQ(read.alert().selectors.size(), 1U);
    EXPECT_EQ(read.alert().header.size(), 1U);
    EXPECT_TRUE(read.reading.mayConcernAnyLine);
    EXPECT_EQ(read.count(AlertCount::UnreadableAlerts), 1U);
}

TEST(EntityReader, AnEntityThatBreaksOffMayConcernAnyLine) {
    const Reading before(Wire().bytes(1, "x").raw("\x2A\x7F"));
    EXPECT_FALSE(before.reading.alert);
    EXPECT_TRUE(before.reading.mayConcernAnyLine);
    const Reading after(AlertMaker().entity().raw("\x2A"));
    EXPECT_TRUE(after.reading.alert);
    EXPECT_TRUE(after.reading.mayConcernAnyLine);
    EXPECT_EQ(after.count(AlertCount::UnreadableEntities), 1U);
}

TEST(EntityReader, CutAtEveryByteItAlwaysSaysThatSomethingIsMissing) {
    const std::string whole = AlertMaker().entity().str();
    const std::size_t afterId = 3;
    for (std::size_t length = 1; length < whole.size(); ++length) {
        const Reading read(Wire().raw(whole.substr(0, length)));
        EXPECT_EQ(read.reading.mayConcernAnyLine, length != afterId) << length;
    }
}

TEST(EntityReader, AnAlertGivenInTwoPartsIsOne) {
    AlertMaker second;
    second.selectors = {route("R2")};
    second.header.clear();
    const Reading read(AlertMaker().entity().bytes(5, second.alert()));
    EXPECT_EQ(read.alert().selectors.size(), 2U);
    EXPECT_EQ(read.alert().header.size(), 1U);
}

TEST(EntityReader, SelectorsOfNoInterestAreKeptAsTheyCame) {
    SelectorShapes shapes;
    shapes.want("R1");
    static_cast<void>(shapes.routeOf(ofAgency("R9").str()));
    AlertMaker maker;
    maker.activePeriods = {period(1, 2)};
    maker.selectors = {ofAgency("R7"), ofAgency("R1"), ofAgency("R8")};
    const Reading read(maker.entity(), &shapes);
    EXPECT_EQ(routesOf(read.alert().selectors), "R1");
    EXPECT_TRUE(read.alert().hasUnreadSelectors);
    AlertSelectors all;
    EntityReader::readSelectors(read.alert().selectorFields, all);
    EXPECT_EQ(routesOf(all), "R7 R1 R8");
    EXPECT_EQ(read.alert().activePeriods.size(), 1U);
    EXPECT_EQ(read.alert().header.size(), 1U);
}

TEST(EntityReader, OtherFieldsAmongSelectorsOfNoInterestAreRead) {
    SelectorShapes shapes;
    static_cast<void>(shapes.routeOf(ofAgency("R9").str()));
    AlertMaker maker;
    maker.more.bytes(5, ofAgency("R6")).bytes(5, ofAgency("R7"));
    maker.more.number(14, 4).bytes(5, ofAgency("R8")).bytes(5, Wire());
    const Reading read(maker.entity(), &shapes);
    EXPECT_TRUE(read.alert().hasUnreadSelectors);
    EXPECT_EQ(read.alert().severity, 4);
    AlertSelectors all;
    EntityReader::readSelectors(read.alert().selectorFields, all);
    EXPECT_EQ(routesOf(all), "R1 R6 R7 R8");
}

TEST(EntityReader, WithNothingPassedOverNoneIsUnread) {
    SelectorShapes shapes;
    const AlertMaker maker;
    const Reading read(maker.entity(), &shapes);
    EXPECT_FALSE(read.alert().hasUnreadSelectors);
    EXPECT_EQ(routesOf(read.alert().selectors), "R1");
}

TEST(EntityReader, AnAlertGivenInTwoPartsIsReadWhole) {
    SelectorShapes shapes;
    static_cast<void>(shapes.routeOf(ofAgency("R9").str()));
    AlertMaker maker;
    maker.activePeriods = {period(1, 2)};
    maker.selectors = {ofAgency("R7"), ofAgency("R8")};
    Wire entity = maker.entity();
    const Reading read(entity.bytes(5, Wire().bytes(5, ofAgency("R6")).bytes(5, ofAgency("R5"))),
                       &shapes);
    EXPECT_FALSE(read.alert().hasUnreadSelectors);
    EXPECT_EQ(routesOf(read.alert().selectors), "R7 R8 R6 R5");
}

TEST(EntityReader, SelectorsOfNoInterestCountForTheLimitAndNoneBehindItIsKept) {
    SelectorShapes shapes;
    static_cast<void>(shapes.routeOf(ofAgency("R9").str()));
    constexpr std::size_t Most = 1'000'000;
    const std::string one = Wire().bytes(5, ofAgency("R7")).str();
    std::string selectors;
    selectors.reserve((Most + 2) * one.size());
    for (std::size_t i = 0; i < Most + 2; ++i)
        selectors += one;
    AlertMaker maker;
    maker.selectors.clear();
    maker.more.raw(selectors);
    maker.header.clear();
    maker.description.clear();
    const Reading read(maker.entity(), &shapes);
    EXPECT_TRUE(read.reading.mayConcernAnyLine);
    EXPECT_EQ(read.alert().selectorFields.size(), Most * one.size());
    EXPECT_EQ(read.count(AlertCount::UnreadableSelectors), 2U);
}

TEST(EntityReader, ExtensionsAreSteppedOver) {
    const Reading read(with(Wire()
                                .bytes(1104,
                                       "\x0A\x01"
                                       "0")
                                .key(1500, 3)
                                .key(1500, 4))
                           .entity());
    EXPECT_EQ(read.statistics.unreadable(), 0U);
    EXPECT_FALSE(read.reading.mayConcernAnyLine);
}

TEST(EntityReader, WhatWasReadBeforeTakesNoRoom) {
    CountingResource counting;
    std::pmr::memory_resource* const before = std::pmr::set_default_resource(&counting);
    {
        AlertMaker maker;
        maker.activePeriods.assign(2000, period(1, 2));
        const std::string bytes = maker.entity().str();
        AlertStatistics statistics;
        EntityReader reader(statistics);
        std::size_t one = 0;
        for (int i = 0; i < 100; ++i) {
            EXPECT_EQ(reader.read(bytes).alert.value().activePeriods.size(), 2000U);
            if (i == 0)
                one = counting.live();
        }
        EXPECT_GT(one, 0U);
        EXPECT_LE(counting.live(), one);
    }
    std::pmr::set_default_resource(before);
    EXPECT_EQ(counting.live(), 0U);
}

TEST(EntityReader, ACopyOfAnAlertStaysWhenTheNextIsRead) {
    AlertMaker maker;
    maker.activePeriods = {period(1, 2), period(3, 4)};
    const std::string one = maker.entity().str();
    maker.activePeriods = {period(5, 6)};
    const std::string other = maker.entity().str();
    AlertStatistics statistics;
    EntityReader reader(statistics);
    const AlertReading first = reader.read(one);
    const Alert kept(*first.alert, AlertRoom());
    (void)reader.read(other);
    ASSERT_EQ(kept.activePeriods.size(), 2U);
    EXPECT_EQ(kept.activePeriods[1].start, 3U);
    EXPECT_EQ(kept.id, "1");
    EXPECT_EQ(kept.effect, 4);
    EXPECT_EQ(kept.selectors.size(), maker.selectors.size());
    EXPECT_EQ(kept.header.size(), maker.header.size());
}

TEST(EntityReader, TranslationsHaveALimit) {
    AlertMaker maker;
    maker.header.assign(300, {"text", "en"});
    const Reading read(maker.entity());
    EXPECT_EQ(read.alert().header.size(), 200U);
    EXPECT_EQ(read.count(AlertCount::UnreadableTexts), 100U);
}

} // namespace orvo::testing
