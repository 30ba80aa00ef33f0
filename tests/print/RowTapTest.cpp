#include "print/RowTap.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/geoservices/LocalAnalyticsStore.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/ApplicationProxy.h"
#include "platform/launchservices/PlugInKitProxy.h"
#include "print/SceneWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

/// Notes what it is asked, and answers with `error`.
class RecordingLauncher final : public ApplicationLauncher {
public:
    void openURLs(const std::string& application,
                  const std::vector<std::string>& urls,
                  CompletionHandler handler) override {
        asked.push_back(application + " " + urls.at(0));
        answer(std::move(handler));
    }
    void activateAction(const std::string& application,
                        const std::string& action,
                        const std::shared_ptr<NSData>& parameter,
                        CompletionHandler handler) override {
        asked.push_back(application + " " + action + (parameter ? " with payload" : ""));
        answer(std::move(handler));
    }

    std::vector<std::string> asked;
    std::shared_ptr<NSError> error;

private:
    void answer(CompletionHandler handler) const {
        DispatchQueue::mainQueue()->async(
            [handler = std::move(handler), why = error] { handler(why); });
    }
};

class RowTapTest : public ::testing::Test, protected testing::SceneWorld {
protected:
    std::optional<std::string> tap(std::optional<NCWidgetDisplayMode> mode, std::uint64_t row) {
        return tap(threeLines(), mode, row);
    }
    std::optional<std::string> tap(const std::vector<std::shared_ptr<TransitLineItem>>& lines,
                                   std::optional<NCWidgetDisplayMode> mode,
                                   std::uint64_t row) {
        answerWith(lines);
        return RowTap::perform(*updatedScene(), mode, row);
    }
    static std::vector<StoredAnalyticsSession> sessions() {
        return LocalAnalyticsStore::sessions(10, nullptr).value();
    }

    static constexpr auto Compact = NCWidgetDisplayMode::Compact;
    static constexpr auto Expanded = NCWidgetDisplayMode::Expanded;

    std::shared_ptr<RecordingLauncher> launcher = std::make_shared<RecordingLauncher>();
    EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>::Override launcherOverride =
        ApplicationLauncher::launcher().overrideWith(launcher);
    EnvironmentSlot<std::shared_ptr<BundleProxy>>::Override process =
        BundleProxy::currentProcess().overrideWith(
            PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
                "a.widget", ApplicationProxy::applicationProxyForIdentifier("a.map")));
};

TEST_F(RowTapTest, HandsAnExpandedRowsActivityOver) {
    EXPECT_EQ(tap(Expanded, 1), std::nullopt);
    EXPECT_EQ(launcher->asked, std::vector<std::string>{"a.map ContinueUserActivity with payload"});
}

TEST_F(RowTapTest, HandsTheSummarysActivityOver) {
    EXPECT_EQ(tap(Compact, 0), std::nullopt);
    EXPECT_EQ(launcher->asked.size(), 1U);
}

TEST_F(RowTapTest, OpensARowsURL) {
    EXPECT_EQ(tap(Expanded, 2), std::nullopt);
    EXPECT_EQ(launcher->asked,
              std::vector<std::string>{"a.map orvo://?favorites=2&t=r&session=S1"});
}

TEST_F(RowTapTest, SaysWhyAnActivityWasNotTaken) {
    launcher->error = NSError::errorWithMessage("Test", 1, "no such program");
    EXPECT_EQ(tap(Expanded, 0), "no such program");
}

TEST_F(RowTapTest, SaysWhyAURLWasNotTaken) {
    launcher->error = NSError::errorWithMessage("Test", 1, "no such program");
    EXPECT_EQ(tap(Expanded, 2), "no such program");
}

TEST_F(RowTapTest, WithoutABundleNoActivityCanBeHandedOver) {
    const auto none = BundleProxy::currentProcess().overrideWith(nullptr);
    EXPECT_EQ(tap(Expanded, 0), "what the row opens cannot be handed over to the map application");
    EXPECT_TRUE(launcher->asked.empty());
}

TEST_F(RowTapTest, ARowThatIsNotThereIsRefused) {
    EXPECT_EQ(tap(Expanded, 3), "there is no row 3 in expanded mode: the last is 2");
    EXPECT_EQ(tap(Compact, 1), "there is no row 1 in compact mode: the last is 0");
    EXPECT_EQ(tap({}, Expanded, 0), "there are no rows in expanded mode");
    EXPECT_TRUE(launcher->asked.empty());
}

TEST_F(RowTapTest, AnErrorRowOpensNothing) {
    fail();
    EXPECT_EQ(RowTap::perform(*updatedScene(), Compact, 0), "row 0 opens nothing");
}

TEST_F(RowTapTest, WithoutAModeTheLargestThatHasRowsIsTapped) {
    EXPECT_EQ(tap(std::nullopt, 2), std::nullopt);
    EXPECT_EQ(tap({}, std::nullopt, 1), "there is no row 1 in compact mode: the last is 0");
}

TEST_F(RowTapTest, ATapIsRecordedAsTheEndOfASession) {
    ASSERT_EQ(tap(Expanded, 1), std::nullopt);
    ASSERT_EQ(sessions().size(), 1U);
    const auto session = sessions()[0];
    EXPECT_EQ(session.endState, 1);
    EXPECT_EQ(session.tappedItemIndex, 1);
    EXPECT_TRUE(session.everExpanded);
    EXPECT_EQ(session.messageType, 4);
    ASSERT_EQ(session.incidents.size(), 2U);
    EXPECT_EQ(session.incidents[0].lineMuid, "1");
    EXPECT_EQ(session.incidents[1].incidentTitle, "Delays");
    const auto actions = LocalAnalyticsStore::actions(10, nullptr).value();
    ASSERT_EQ(actions.size(), 2U) << "the change of the mode, and the tap";
    EXPECT_TRUE(actions[0].action == 9001 || actions[1].action == 9001);
}

TEST_F(RowTapTest, TheCompactRowIsRecordedAsCompact) {
    ASSERT_EQ(tap(Compact, 0), std::nullopt);
    ASSERT_EQ(sessions().size(), 1U);
    EXPECT_FALSE(sessions()[0].everExpanded);
    EXPECT_EQ(sessions()[0].tappedItemIndex, 0);
}

TEST_F(RowTapTest, WhatOpensNothingIsRecordedAsNoTap) {
    launcher->error = NSError::errorWithMessage("Test", 1, "no such program");
    EXPECT_TRUE(tap(Expanded, 0));
    EXPECT_TRUE(tap(Expanded, 9));
    ASSERT_EQ(sessions().size(), 2U);
    EXPECT_NE(sessions()[0].endState, 1);
    EXPECT_NE(sessions()[1].endState, 1);
}

} // namespace
} // namespace orvo
