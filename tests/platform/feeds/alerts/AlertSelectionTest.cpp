#include "platform/feeds/alerts/AlertSelection.h"

#include "AlertMaker.h"
#include "TestLines.h"

#include <gtest/gtest.h>

#include <random>

namespace orvo::testing {

namespace {

AlertMaker maker(const std::string& id, const std::string& header, std::vector<Wire> selectors) {
    AlertMaker maker;
    maker.id = id;
    maker.header = {{header, "en"}};
    maker.selectors = std::move(selectors);
    return maker;
}

/// Which of the entities are chosen for the route R1.
std::string chosen(const std::vector<Wire>& entities, bool stepFree = false) {
    AlertSelection selection(*smallIndex(), {lineMuid("town", "R1")}, stepFree);
    for (const Wire& entity : entities)
        selection.look(entity.str());
    selection.choose();
    std::string text;
    for (std::size_t i = 0; i < entities.size(); ++i)
        text += selection.isChosen(i) ? '1' : '0';
    return text;
}

std::string chosenFor(const Wire& selector) {
    return chosen({maker("1", "x", {selector}).entity()});
}

} // namespace

TEST(AlertSelection, ChoosesWhatMayNameTheLine) {
    EXPECT_EQ(chosenFor(route("R1")), "1");
    EXPECT_EQ(chosenFor(route(" R1")), "1");
    EXPECT_EQ(chosenFor(Wire().bytes(4, Wire().bytes(5, "R1"))), "1");
    EXPECT_EQ(chosenFor(Wire().bytes(1, "A1")), "1");
    EXPECT_EQ(chosenFor(Wire().number(3, 3)), "1");
    EXPECT_EQ(chosenFor(Wire().number(3, 701)), "1");
    EXPECT_EQ(chosenFor(Wire().bytes(5, "S1")), "1");
}

TEST(AlertSelection, PassesOverTheRest) {
    EXPECT_EQ(chosenFor(route("R2")), "0");
    EXPECT_EQ(chosenFor(Wire().bytes(1, "A2")), "0");
    EXPECT_EQ(chosenFor(Wire().number(3, 1)), "0");
    EXPECT_EQ(chosenFor(route("R2").bytes(5, "S1")), "0");
    EXPECT_EQ(chosenFor(Wire()), "0");
    EXPECT_EQ(chosen({Wire().bytes(1, "x").bytes(3, "trip")}), "0");
}

TEST(AlertSelection, ChoosesWhatCannotBeRead) {
    EXPECT_EQ(chosenFor(route("R2").bytes(5, "\xFF")), "1");
    EXPECT_EQ(chosenFor(Wire().raw("\xFF")), "1");
    EXPECT_EQ(chosen({Wire().number(5, 1)}), "1");
    EXPECT_EQ(chosen({Wire().bytes(1, "x").raw("\x2A\x7F")}), "1");
    AlertMaker unreadable = maker("1", "x", {Wire().number(2, 7)});
    unreadable.effect = 10;
    EXPECT_EQ(chosen({unreadable.entity()}), "1");
}

TEST(AlertSelection, PassesOverWhatIsNoIncident) {
    AlertMaker notice = maker("1", "x", {route("R1")});
    notice.effect = 10;
    EXPECT_EQ(chosen({notice.entity()}), "0");
    notice.effect = 11;
    EXPECT_EQ(chosen({notice.entity()}), "0");
    EXPECT_EQ(chosen({notice.entity()}, true), "1");
}

TEST(AlertSelection, FollowsIdentifiersAndHeadersAsFarAsTheyLead) {
    EXPECT_EQ(chosen({maker("1", "Delay", {route("R1")}).entity(),
                      maker("2", " <b>Delay</b>", {route("R2")}).entity(),
                      maker("3", "Closed", {route("R2")}).entity(),
                      maker("2", "Retard", {}).entity(),
                      maker("4", "Retard", {route("R3")}).entity()}),
              "11011");
}

TEST(AlertSelection, AlertsWithoutAHeaderMayBeTheSame) {
    AlertMaker one = maker("1", "", {route("R1")});
    AlertMaker other = maker("2", "", {route("R2")});
    one.header.clear();
    other.header.clear();
    EXPECT_EQ(chosen({one.entity(), other.entity()}), "11");
}

TEST(AlertSelection, ForgetsWhatAFailedMessageHeld) {
    AlertSelection selection(*smallIndex(), {lineMuid("town", "R1")}, false);
    selection.look(maker("1", "a", {route("R1")}).entity().str());
    selection.look(maker("2", "b", {route("R2")}).entity().str());
    selection.truncate(1);
    selection.look(maker("3", "b", {route("R1")}).entity().str());
    selection.choose();
    ASSERT_EQ(selection.count(), 2U);
    EXPECT_TRUE(selection.isChosen(0));
    EXPECT_TRUE(selection.isChosen(1));
}

} // namespace orvo::testing
