#include "viewmodel/WidgetTexts.h"

#include "platform/foundation/Text.h"
#include "viewmodel/BuilderWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::BuilderWorld;
using testing::line;

std::shared_ptr<TransitLine> named(const char* name) {
    return line(1, {}, {.name = name});
}

TEST(WidgetTexts, LooksUpInTheMainBundlesDefaultTableWithTheFallback) {
    const BuilderWorld world;
    world.bundle->hasTexts = false;
    EXPECT_EQ(WidgetTexts::goodServiceTitle(), "localized string not found");
    EXPECT_EQ(WidgetTexts::summaryText(3), "localized string not found");
    EXPECT_EQ(
        world.bundle->values,
        (std::vector<std::string>{"localized string not found", "localized string not found"}));
    EXPECT_EQ(world.bundle->tables, (std::vector<std::string>{"(nil)", "(nil)"}));
}

TEST(WidgetTexts, KeysAreSpeltAsTheTablesHaveThem) {
    const BuilderWorld world;
    (void)WidgetTexts::noFavoritesTitle();
    (void)WidgetTexts::noFavoritesSecondaryText();
    (void)WidgetTexts::goodServiceTitle();
    EXPECT_EQ(WidgetTexts::goodServiceSecondaryText(2),
              "TransitWidget_GoodService_SecondaryText[2][][]");
    EXPECT_EQ(WidgetTexts::clearServiceSecondaryText(3),
              "TransitWidget_GoodService_Overflow_SecondaryText[3][][]");
    EXPECT_EQ(WidgetTexts::summaryText(4), "TransitWidget_Summary_advisory_count[4][][]");
    EXPECT_EQ(WidgetTexts::overflowTitle(5), "TransitWidget_advisory_overflow_title[5][][]");
    EXPECT_EQ(WidgetTexts::overflowSecondaryText(6),
              "TransitWidget_AdvisoriesOverflow_SecondaryText[6][][]");
    EXPECT_EQ(world.bundle->keys[0], "TransitWidget_NoFavoriteTransitLines_Title");
    EXPECT_EQ(world.bundle->keys[1], "TransitWidget_NoFavoriteTransitLines_SecondaryText");
    EXPECT_EQ(world.bundle->keys[2], "TransitWidget_GoodService_Title");
}

TEST(LineNames, OneTwoAndMoreNamesTakeTheirOwnKeysBeforeAText) {
    const BuilderWorld world;
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A")}, "text"),
              "TransitWidget_Single_Line_Prepended_Incident_Text[A][text][]");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A"), named("B")}, "text"),
              "TransitWidget_2_Lines_Prepended_Incident_Text[A][B][text]");
}

TEST(LineNames, FourNamesPassTheListOfThreeTheFourthAndTheText) {
    const BuilderWorld world;
    const auto join =
        commaDelimitedListJoin().overrideWith([](const std::vector<std::string>& items) {
            std::string joined;
            for (const auto& item : items)
                joined += "<" + item + ">";
            return joined;
        });
    const std::vector<std::shared_ptr<TransitLine>> lines{
        named("A"), named("B"), named("C"), named("D")};
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText(lines, "text"),
              "TransitWidget_N_Lines_Prepended_Incident_Text[<A><B><C>][D][text]");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText(lines, std::nullopt),
              "TransitWidget_N_Lines_Names_Concatenated[<A><B><C>][D][]");
}

TEST(LineNames, WithoutATextNamesStandAlone) {
    const BuilderWorld world;
    for (const std::optional<std::string>& text :
         {std::optional<std::string>(), std::optional<std::string>("")}) {
        world.bundle->keys.clear();
        EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A")}, text), "A");
        EXPECT_TRUE(world.bundle->keys.empty()); // as it stands, without any lookup
        EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A"), named("B")}, text),
                  "TransitWidget_2_Lines_Concatenated[A][B][]");
    }
}

TEST(LineNames, TwoLinesOfOneNameGiveOneName) {
    const BuilderWorld world;
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A"), named("A")}, "text"),
              "TransitWidget_Single_Line_Prepended_Incident_Text[A][text][]");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A"), named("A")}, std::nullopt), "A");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("A"), named("B"), named("A")}, "text"),
              "TransitWidget_2_Lines_Prepended_Incident_Text[A][B][text]");
}

TEST(LineNames, LineWithoutANameTakesItsSystemsAndOneWithNeitherIsLeftOut) {
    const BuilderWorld world;
    const auto ofSystem = [](const char* name, std::optional<std::string> system) {
        return line(1, {}, {.name = name, .system = testing::system(std::move(system), nullptr)});
    };
    EXPECT_EQ(
        WidgetTexts::_prependLineNames_toText(
            {ofSystem("", "City"), ofSystem("", ""), ofSystem("", std::nullopt)}, std::nullopt),
        "City");
    EXPECT_EQ(
        WidgetTexts::_prependLineNames_toText({named("City"), ofSystem("", "City")}, std::nullopt),
        "City");
}

TEST(LineNames, NoNamesLeaveTheTextAsItIs) {
    const BuilderWorld world;
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("")}, "text"), "text");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("")}, ""), "");
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("")}, std::nullopt), std::nullopt);
    EXPECT_TRUE(world.bundle->keys.empty());
}

TEST(LineNames, PercentSignsInNamesAreNotFormats) {
    const BuilderWorld world;
    EXPECT_EQ(WidgetTexts::_prependLineNames_toText({named("100 %@"), named("%2$@")}, "%lu"),
              "TransitWidget_2_Lines_Prepended_Incident_Text[100 %@][%2$@][%lu]");
}

} // namespace
} // namespace orvo
