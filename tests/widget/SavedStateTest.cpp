#include "platform/foundation/NSData.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSString.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "viewmodel/OWTransitItemDataSourceBuilder.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using testing::makeItem;

constexpr const char* Key = "Orvo.TransitWidget.savedUIData";

std::shared_ptr<NSObject> stored() {
    return OrvoGroup::__orvo_groupUserDefaults()->objectForKey(Key);
}

void store(const std::shared_ptr<NSObject>& object) {
    ASSERT_EQ(OrvoGroup::__orvo_groupUserDefaults()->setObject_forKey(object, Key), nullptr);
}

/// Nothing that an archive can hold.
class Unarchivable final : public virtual NSObject {};

/// A record whose archive has the flag and nothing else.
class FlagAlone final : public virtual NSSecureCoding {
public:
    void encodeWithCoder(NSCoder& coder) const override {
        coder.encodeBool_forKey(true, "expanded");
    }
    std::vector<std::string> classesForCoder() const override {
        return {"OWTransitIncidentViewControllerState", "NSObject"};
    }
};

/// What the widget keeps from one life to the next.
class SavedState : public testing::WidgetWorld {
protected:
    void keep(const std::shared_ptr<Result>& result, bool expanded = false) {
        const auto data = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
            OWTransitIncidentViewControllerState::initWithLineItemsResult_expanded(result,
                                                                                   expanded),
            true);
        ASSERT_TRUE(data);
        store(data);
    }
    void load() {
        controller = makeController();
        (void)controller->view();
    }
    LogRecord lastWidgetRecord() const {
        LogRecord last{};
        for (const auto& record : log.records())
            if (record.category == "TransitWidget")
                last = record;
        return last;
    }
    std::ptrdiff_t linesOf(const char* format) const {
        return std::ranges::count(log.formats(), format);
    }
    /// The rows that the builder makes of a result.
    static std::shared_ptr<OWTransitListItem> rowsOf(const std::shared_ptr<Result>& result) {
        return OWTransitDataSourceBuilderForResult(result, 0, nullptr, nullptr)->listItem();
    }
    void expectLastLine(const char* format) const {
        EXPECT_EQ(lastWidgetRecord().format, format);
        EXPECT_EQ(lastWidgetRecord().level, LogLevel::Debug);
    }
};

TEST_F(SavedState, WithoutAnyTheWidgetStartsWithoutFavoriteLines) {
    load();
    expectLastLine("No view model found in NSUserDefaults (key: %{private}@)");
    EXPECT_EQ(lastWidgetRecord().message,
              std::string("No view model found in NSUserDefaults (key: ") + Key + ")");
    EXPECT_TRUE(controller->dataSource()->transitLineItemResult()->isSuccess());
    EXPECT_TRUE(equal(controller->dataSource()->listItem(), rowsOf(success())));
    EXPECT_EQ(controller->transitLineItemResult(), nullptr);
    EXPECT_FALSE(controller->dataSource()->isExpanded());
}

TEST_F(SavedState, IsShownBeforeAnyFetchHasEnded) {
    keep(failure(), false);
    load();
    expectLastLine("View model loaded from NSUserDefaults (key: %{private}@): %{private}@");
    EXPECT_FALSE(controller->dataSource()->transitLineItemResult()->isSuccess());
    EXPECT_EQ(controller->transitLineItemResult(), nullptr);
    EXPECT_EQ(controller->request(), nullptr);
    EXPECT_EQ(controller->updater(), nullptr);
    EXPECT_TRUE(equal(controller->dataSource()->listItem(), rowsOf(failure())));
    EXPECT_FALSE(equal(controller->dataSource()->listItem(), rowsOf(success())));
}

TEST_F(SavedState, OfASuccessIsShownAsRowsInItsMode) {
    keep(success({disturbedLine(1, "Works"), disturbedLine(2, "Delays")}), true);
    load();
    EXPECT_TRUE(controller->dataSource()->isExpanded());
    EXPECT_THAT(titles(*controller->dataSource()), ElementsAre("Works", "Delays"));
    EXPECT_EQ(controller->tableView()->numberOfRowsInSection(0), 2);
    EXPECT_EQ(controller->transitLineItemResult(), nullptr);
    controller->viewWillAppear(false);
    EXPECT_TRUE(controller->request()) << "the fetch has not ended";
    EXPECT_EQ(context->largest, NCWidgetDisplayMode::Expanded);
    EXPECT_THAT(titles(*controller->dataSource()), ElementsAre("Works", "Delays"));
    runUntilFetched();
    EXPECT_EQ(context->largest, NCWidgetDisplayMode::Compact);
}

TEST_F(SavedState, IsShownWithinTheHostsNumberOfRows) {
    keep(success({disturbedLine(1, "A"), disturbedLine(2, "B"), disturbedLine(3, "C")}), true);
    context->expandedMaximum.height = 300;
    load();
    EXPECT_EQ(controller->tableView()->numberOfRowsInSection(0), 2);
    context->expandedMaximum.height = 616;
    load();
    EXPECT_EQ(controller->tableView()->numberOfRowsInSection(0), 3);
}

TEST_F(SavedState, OfAnyAgeIsShown) {
    keep(success({disturbedLine(1, "Works"), disturbedLine(2, "Delays")}), true);
    constexpr double Decade = 10 * 365 * 86400.0;
    clock->advance(Decade);
    load();
    EXPECT_THAT(titles(*controller->dataSource()), ElementsAre("Works", "Delays"));
    EXPECT_TRUE(stored());
}

TEST_F(SavedState, IsReadOnceAndWrittenOnceInALife) {
    keep(success({makeItem(1)}));
    load();
    controller->viewWillAppear(false);
    controller->viewDidAppear(false);
    runUntilFetched();
    EXPECT_EQ(linesOf("Saving view model to NSUserDefault (key: %{private}@) : %{private}@"), 0);
    controller->viewWillDisappear(false);
    controller->viewDidDisappear(false);
    EXPECT_EQ(linesOf("View model loaded from NSUserDefaults (key: %{private}@): %{private}@"), 1);
    EXPECT_EQ(linesOf("Saving view model to NSUserDefault (key: %{private}@) : %{private}@"), 1);
}

TEST_F(SavedState, OfALifeThatEndsBeforeItsFetchIsKeptAgain) {
    saveFavorites({1}); // its lookup is not answered
    keep(success({disturbedLine(1, "Works"), disturbedLine(2, "Delays")}), true);
    for (int life = 0; life < 2; ++life) {
        load();
        controller->viewWillAppear(false);
        controller->viewWillDisappear(false);
        ASSERT_EQ(controller->transitLineItemResult(), nullptr);
    }
    load();
    EXPECT_TRUE(controller->dataSource()->isExpanded());
    EXPECT_THAT(titles(*controller->dataSource()), ElementsAre("Works", "Delays"));
}

TEST_F(SavedState, TheLinesNameKeyAndRecord) {
    load();
    controller->_saveUIData();
    const std::string keyed = std::string("(key: ") + Key + ")";
    EXPECT_THAT(lastWidgetRecord().message,
                HasSubstr("Saving view model to NSUserDefault " + keyed + " : <"));
    EXPECT_THAT(lastWidgetRecord().message, HasSubstr("expanded: NO"));
    load();
    EXPECT_THAT(lastWidgetRecord().message,
                HasSubstr("View model loaded from NSUserDefaults " + keyed + ": <"));
    EXPECT_THAT(lastWidgetRecord().message, HasSubstr("expanded: NO"));
}

TEST_F(SavedState, WithoutAResultIsLoggedAsLoadedAndStays) {
    store(NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        std::make_shared<FlagAlone>(), true));
    load();
    EXPECT_EQ(lastWidgetRecord().message,
              std::string("View model loaded from NSUserDefaults (key: ") + Key + "): (null)");
    EXPECT_TRUE(stored());
    EXPECT_FALSE(controller->dataSource()->isExpanded());
    EXPECT_TRUE(equal(controller->dataSource()->listItem(), rowsOf(success())));
}

TEST_F(SavedState, OfAnotherKindThanDataIsLoggedAsLoadedAndStays) {
    store(NSString::string("a text"));
    load();
    EXPECT_EQ(lastWidgetRecord().message,
              std::string("View model loaded from NSUserDefaults (key: ") + Key + "): (null)");
    EXPECT_TRUE(stored());
}

TEST_F(SavedState, NoUpdaterWatchesIt) {
    keep(success({makeItem(1)}));
    load();
    controller->viewWillAppear(false);
    EXPECT_EQ(controller->updater(), nullptr);
    runUntilFetched();
    EXPECT_TRUE(controller->updater());
}

TEST_F(SavedState, OfTheDataSourceIsSavedSoThatALifeWithoutAFetchKeepsIt) {
    keep(success({makeItem(1), makeItem(2)}));
    load();
    controller->_saveUIData();
    expectLastLine("Saving view model to NSUserDefault (key: %{private}@) : %{private}@");
    load();
    std::size_t count = 0;
    controller->dataSource()->transitLineItemResult()->withValue_orError(
        [&](const auto& value) { count = std::dynamic_pointer_cast<NSArray>(value)->count(); },
        [](const auto&) {});
    EXPECT_EQ(count, 2U);
}

TEST_F(SavedState, IsWrittenWhenTheWidgetDisappearsAndReadAtTheNextStart) {
    load();
    controller->viewWillAppear(false);
    runUntilFetched();
    controller->setTransitLineItemResult(failure());
    controller->viewWillDisappear(false);
    EXPECT_TRUE(std::dynamic_pointer_cast<NSData>(stored()));
    load();
    EXPECT_FALSE(controller->dataSource()->transitLineItemResult()->isSuccess());
}

TEST_F(SavedState, CorruptDataIsRemovedAndNothingIsShownOfIt) {
    const auto other = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        NSArray::array(), true);
    store(other); // an archive, but of something else
    load();
    expectLastLine("Error parsing ViewModel data loaded from NSUserDefaults, removing it (key: "
                   "%{private}@): %{private}@ - error: %{private}@");
    EXPECT_THAT(lastWidgetRecord().message,
                HasSubstr(std::string("(key: ") + Key + "): (null) - "));
    EXPECT_THAT(lastWidgetRecord().message, HasSubstr("- error: Error Domain=NSCocoaErrorDomain"));
    EXPECT_EQ(stored(), nullptr);
    EXPECT_TRUE(controller->dataSource()->transitLineItemResult()->isSuccess());
}

TEST_F(SavedState, BytesThatCannotBeOpenedAreLoggedAsLoadedAndStay) {
    store(NSData::dataWithString("these are no archive"));
    load();
    expectLastLine("View model loaded from NSUserDefaults (key: %{private}@): %{private}@");
    EXPECT_TRUE(stored());
}

TEST_F(SavedState, WhatCannotBeArchivedLeavesTheFormerOne) {
    load();
    controller->_saveUIData();
    const auto former = stored();
    ASSERT_TRUE(former);
    const auto scope = NSKeyedArchiver::archiving().overrideWith(
        [](const auto&, bool requiresSecureCoding, std::shared_ptr<NSError>*) {
            EXPECT_TRUE(requiresSecureCoding);
            return std::shared_ptr<NSData>();
        });
    controller->_saveUIData();
    expectLastLine("Unable to cache view model to disk because it couldnt be converted to NSData: "
                   "%{private}@");
    EXPECT_TRUE(equal(stored(), former));
}

TEST_F(SavedState, AnErrorThatNoArchiveCanHoldLeavesTheFormerOne) {
    keep(success({makeItem(1)}));
    const auto former = stored();
    load();
    controller->setTransitLineItemResult(
        Result::resultWithError(NSError::errorWithDomain_code_userInfo(
            "LookupDomain",
            5,
            NSDictionary::dictionaryWithTextKeys({{"of", std::make_shared<Unarchivable>()}}))));
    controller->viewWillDisappear(false);
    expectLastLine("Unable to cache view model to disk because it couldnt be converted to NSData: "
                   "%{private}@");
    EXPECT_THAT(lastWidgetRecord().message, HasSubstr("expanded: NO"));
    EXPECT_TRUE(equal(stored(), former));
}

} // namespace
} // namespace orvo
