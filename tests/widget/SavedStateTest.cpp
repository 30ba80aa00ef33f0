#include "platform/foundation/NSData.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using testing::makeItem;

constexpr const char* Key = "Orvo.TransitWidget.savedUIData";

std::shared_ptr<NSObject> stored() {
    return OrvoGroup::__orvo_groupUserDefaults()->objectForKey(Key);
}

void store(const std::shared_ptr<NSObject>& object) {
    ASSERT_EQ(OrvoGroup::__orvo_groupUserDefaults()->setObject_forKey(object, Key), nullptr);
}

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
    void expectLastLine(const char* format) const {
        EXPECT_EQ(lastWidgetRecord().format, format);
        EXPECT_EQ(lastWidgetRecord().level, LogLevel::Debug);
    }
};

TEST_F(SavedState, WithoutAnyTheWidgetStartsWithoutFavoriteLines) {
    load();
    expectLastLine("No view model found in NSUserDefaults (key: %{private}@)");
    EXPECT_NE(lastWidgetRecord().message.find(Key), std::string::npos);
    EXPECT_TRUE(controller->dataSource()->transitLineItemResult()->isSuccess());
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

} // namespace
} // namespace orvo
