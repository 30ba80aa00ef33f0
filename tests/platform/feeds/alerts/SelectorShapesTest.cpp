#include "platform/feeds/alerts/SelectorShapes.h"

#include "AlertMaker.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo::testing {

namespace {

Wire usual(const std::string& agency, const std::string& route, const std::string& stop) {
    Wire wire;
    wire.bytes(1, agency).bytes(2, route).number(3, 3);
    if (!stop.empty())
        wire.bytes(5, stop);
    return wire;
}

std::string routeOf(const Wire& selector) {
    SelectorShapes shapes;
    return std::string(shapes.routeOf(selector.str()));
}

/// How many of the selectors are passed over, after those of `seen`.
std::size_t skimmed(const std::vector<Wire>& selectors,
                    const std::vector<Wire>& seen,
                    const std::vector<std::string>& wanted = {"R1234"},
                    std::size_t mayPass = 100) {
    SelectorShapes shapes;
    for (const std::string& route : wanted)
        shapes.want(route);
    for (const Wire& selector : seen)
        static_cast<void>(shapes.routeOf(selector.str()));
    Wire alert;
    std::vector<std::size_t> ends = {0};
    for (const Wire& selector : selectors)
        ends.push_back(alert.bytes(5, selector).str().size());
    const std::vector<char> block(alert.str().begin(), alert.str().end());
    std::size_t left = mayPass;
    const char* const stopped = shapes.skim(block.data(), block.data() + block.size(), left);
    const auto found =
        std::find(ends.begin(), ends.end(), static_cast<std::size_t>(stopped - block.data()));
    EXPECT_NE(found, ends.end()) << "stopped inside a selector";
    const auto passed = static_cast<std::size_t>(found - ends.begin());
    EXPECT_EQ(left, mayPass - passed);
    return passed;
}

} // namespace

TEST(SelectorShapes, FindsTheRouteOfUsualSelectors) {
    EXPECT_EQ(routeOf(usual("A1", "R1234", "S1")), "R1234");
    EXPECT_EQ(routeOf(usual("A1", "R4321", "S9")), "R4321");
    EXPECT_EQ(routeOf(route("R1")), "R1");
    EXPECT_EQ(routeOf(route("a-rather-long-route")), "a-rather-long-route");
    EXPECT_EQ(routeOf(route(std::string(100, 'r'))), std::string(100, 'r'));
}

TEST(SelectorShapes, LeavesAllOthersAlone) {
    const std::size_t length = usual("A1", "R1234", "S1").str().size();
    for (const Wire& selector : {Wire(),
                                 Wire().bytes(1, "A1"),
                                 Wire().bytes(2, ""),
                                 usual("A1",
                                       "R1\xFF"
                                       "34",
                                       "S1"),
                                 usual("A1",
                                       "R1234",
                                       "\xFF"
                                       "1"),
                                 usual("A1", "R1234", "").raw("\x2A\x05S"),
                                 usual("A1", "R1234", "S1").bytes(4, ""),
                                 Wire().bytes(2, "R1").bytes(2, "R2").bytes(1, "12345678"),
                                 Wire().raw(std::string(length, '\x12')),
                                 Wire().raw(std::string(length, '\xFF'))})
        EXPECT_EQ(routeOf(selector), "");
}

TEST(SelectorShapes, PassesOverUnwantedRoutesOfAKnownForm) {
    const Wire seen = usual("A1", "R9999", "S1");
    EXPECT_EQ(skimmed({usual("A1", "R5678", "S2"), usual("B2", "X0000", "S9"), seen}, {seen}), 3U);
    EXPECT_EQ(skimmed({usual("A1", "R5678", "S2")}, {}), 0U);
}

TEST(SelectorShapes, StopsAtAWantedRoute) {
    const Wire seen = usual("A1", "R9999", "S1");
    EXPECT_EQ(skimmed({seen, usual("A1", "R1234", "S2"), seen}, {seen}), 1U);
    EXPECT_EQ(skimmed({usual("A1", "R12", "S1")}, {usual("A1", "R99", "S1")}, {"R12"}), 0U);
    EXPECT_EQ(skimmed({usual("A1", "12345678", "")}, {usual("A1", "99999999", "")}, {"12345678"}),
              0U);
}

TEST(SelectorShapes, StopsAtRoutesThatAreLongOrHaveBlanks) {
    EXPECT_EQ(skimmed({usual("A1", "123456789", "")}, {usual("A1", "999999999", "")}), 0U);
    EXPECT_EQ(skimmed({usual("A1", " 1234", "S1")}, {usual("A1", "R9999", "S1")}), 0U);
    EXPECT_EQ(skimmed({usual("A1", "1234 ", "S1")}, {usual("A1", "R9999", "S1")}), 0U);
}

TEST(SelectorShapes, OfOneLengthButAnotherFormIsNotPassedOver) {
    const Wire seen = usual("A1", "R9999", "S1");
    for (const Wire& other : {usual("A12", "R999", "S1"),
                              usual("A1", "R99", "S123"),
                              Wire().bytes(2, "R1").bytes(1, "A9999").number(3, 3).bytes(5, "S1"),
                              Wire().bytes(1, "A1").bytes(5, "R9999").number(3, 3).bytes(2, "S1"),
                              Wire().bytes(1, "A1").bytes(2, "R9999").bytes(3, "").bytes(5, "S1"),
                              usual("A1", "R999\xFF", "S1"),
                              usual("A1", "R9999", "S\xFF"),
                              Wire().raw(std::string(seen.str().size(), '\x12'))}) {
        ASSERT_EQ(other.str().size(), seen.str().size());
        EXPECT_EQ(skimmed({other}, {seen}), 0U);
    }
}

TEST(SelectorShapes, TwoFormsOfOneLengthAreKnownAndAThirdTakesThePlaceOfTheOlder) {
    const Wire one = usual("A1", "R9999", "S1");
    const Wire two = usual("A1", "R999", "S12");
    const Wire three = usual("A1", "R99", "S123");
    EXPECT_EQ(skimmed({one, two, one}, {one, two}), 3U);
    EXPECT_EQ(skimmed({one, two, one}, {one, two, one, one}), 3U);
    EXPECT_EQ(skimmed({three, two, one}, {one, two, three}), 2U);
    EXPECT_EQ(skimmed({two, usual("A1", "R123", "S12")}, {one, two}, {"R123"}), 1U);
}

TEST(SelectorShapes, NoMoreArePassedOverThanMayBe) {
    const Wire seen = usual("A1", "R9999", "S1");
    EXPECT_EQ(skimmed({seen, seen, seen}, {seen}, {}, 2), 2U);
    EXPECT_EQ(skimmed({seen, seen, seen}, {seen}, {}, 0), 0U);
}

TEST(SelectorShapes, CutAtEveryByteItNeverReadsOn) {
    SelectorShapes shapes;
    static_cast<void>(shapes.routeOf(usual("A1", "R9999", "S1").str()));
    const std::string whole = Wire().bytes(5, usual("A1", "R9999", "S1")).str();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const std::vector<char> block(whole.begin(),
                                      whole.begin() + static_cast<std::ptrdiff_t>(length));
        std::size_t left = 100;
        EXPECT_EQ(shapes.skim(block.data(), block.data() + block.size(), left), block.data());
        EXPECT_EQ(left, 100U) << length;
    }
}

} // namespace orvo::testing
