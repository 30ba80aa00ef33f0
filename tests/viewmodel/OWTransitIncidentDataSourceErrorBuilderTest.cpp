#include "viewmodel/OWTransitIncidentDataSourceErrorBuilder.h"

#include "platform/mapuikit/NetworkFailureDiagnosis.h"
#include "viewmodel/BuilderWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class ErrorBuilderTest : public ::testing::Test {
protected:
    static std::shared_ptr<OWTransitIncidentDataSourceErrorBuilder>
    builder(const char* message = "m") {
        return OWTransitIncidentDataSourceErrorBuilder::initWithError(
            NSError::errorWithMessage("d", 1, message));
    }
    std::optional<std::string> secondLine(std::uint64_t code) {
        diagnosis = code;
        return builder()->_errorMessage();
    }

    testing::BuilderWorld world;
    std::uint64_t diagnosis = 0;
    int questions = 0;
    EnvironmentSlot<std::function<std::uint64_t()>>::Override source =
        NetworkFailureDiagnosisSource().overrideWith([this] {
            ++questions;
            return diagnosis;
        });
};

TEST_F(ErrorBuilderTest, GivesOneRowThatCannotBeTapped) {
    const auto list = builder()->listItem();
    const auto row = std::dynamic_pointer_cast<OWTransitItem>(list->summaryItem());
    ASSERT_TRUE(row);
    EXPECT_EQ(row->primaryText(), "TransitWidgetLoadingError_Title[%1$@][%2$@][%3$@]");
    EXPECT_FALSE(row->artwork());
    EXPECT_TRUE(row->isArtworkHidden());
    EXPECT_FALSE(row->openable());
    ASSERT_TRUE(list->expandedItems());
    EXPECT_EQ(list->expandedItems()->count(), 0U);
}

TEST_F(ErrorBuilderTest, SecondLineSaysTheNetworksState) {
    EXPECT_EQ(secondLine(0), "TransitWidgetLoadingError_Unknown[%1$@][%2$@][%3$@]");
    EXPECT_EQ(secondLine(1), "TransitWidgetLoadingError_AirplaneMode[%1$@][%2$@][%3$@]");
    EXPECT_EQ(secondLine(2), "TransitWidgetLoadingError_CellDataDisabled[%1$@][%2$@][%3$@]");
    EXPECT_EQ(secondLine(3), "TransitWidgetLoadingError_No_Internet[%1$@][%2$@][%3$@]");
    EXPECT_EQ(secondLine(4), "TransitWidgetLoadingError_Unknown[%1$@][%2$@][%3$@]");
}

TEST_F(ErrorBuilderTest, TitleIsLookedUpBeforeTheSecondLine) {
    (void)builder()->listItem();
    EXPECT_EQ(world.bundle->keys,
              (std::vector<std::string>{"TransitWidgetLoadingError_Title",
                                        "TransitWidgetLoadingError_Unknown"}));
}

TEST_F(ErrorBuilderTest, DiagnosisAboveFourHasNoMessage) {
    EXPECT_EQ(secondLine(5), std::nullopt);
    EXPECT_EQ(secondLine(~std::uint64_t{0}), std::nullopt);
}

TEST_F(ErrorBuilderTest, ListItemIsBuiltOnceWhenFirstAskedFor) {
    const auto made = builder();
    EXPECT_EQ(questions, 0);
    diagnosis = 3;
    const auto list = made->listItem();
    diagnosis = 1;
    EXPECT_EQ(made->listItem(), list);
    EXPECT_EQ(questions, 1);
}

TEST_F(ErrorBuilderTest, KeepsTheErrorAndNeverShowsIt) {
    const auto error = NSError::errorWithMessage("d", 1, "one");
    const auto made = OWTransitIncidentDataSourceErrorBuilder::initWithError(error);
    EXPECT_EQ(made->error(), error);
    const auto list = made->listItem();
    made->setError(NSError::errorWithMessage("d", 2, "two"));
    EXPECT_EQ(made->listItem(), list);
    EXPECT_TRUE(equal(list->summaryItem(), builder("another")->listItem()->summaryItem()));
}

TEST_F(ErrorBuilderTest, AnswersAnalyticsWithNothing) {
    EXPECT_EQ(builder()->analyticsResultType(), 0);
    ASSERT_TRUE(builder()->analyticsTransitIncidentItems());
    EXPECT_FALSE(*builder()->analyticsTransitIncidentItems());
}

TEST_F(ErrorBuilderTest, MissingTextsShowTheFallback) {
    world.bundle->hasTexts = false;
    const auto row = std::dynamic_pointer_cast<OWTransitItem>(builder()->listItem()->summaryItem());
    EXPECT_EQ(row->primaryText(), "localized string not found");
    EXPECT_EQ(row->secondaryText(), "localized string not found");
}

} // namespace
} // namespace orvo
