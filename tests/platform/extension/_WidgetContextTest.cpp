#include "platform/extension/_WidgetContext.h"

#include "platform/launchservices/ApplicationLauncher.h"
#include "support/LogCapture.h"

#include <gtest/gtest.h>

#include <optional>

namespace orvo {
namespace {

using ContextMode = NCWidgetDisplayMode;

/// Opens nothing, and answers what a test says.
class NotingLauncher final : public ApplicationLauncher {
public:
    void openURLs(const std::string& applicationIdentifier,
                  const std::vector<std::string>& urls,
                  CompletionHandler completionHandler) override {
        opened.push_back(applicationIdentifier);
        opened.insert(opened.end(), urls.begin(), urls.end());
        completionHandler(answer);
    }
    void activateAction(const std::string&,
                        const std::string&,
                        const std::shared_ptr<NSData>&,
                        CompletionHandler) override {
        ADD_FAILURE() << "a URL is no action";
    }

    std::vector<std::string> opened;
    std::shared_ptr<NSError> answer;
};

class WidgetContextTest : public ::testing::Test {
protected:
    std::optional<bool> open(const std::string& url) {
        std::optional<bool> success;
        context->openURL_completionHandler(NSURL::URLWithString(url),
                                           [&](bool opened) { success = opened; });
        return success;
    }

    std::shared_ptr<_WidgetContext> context =
        _WidgetContext::contextWithApplicationIdentifier("a.map");
    std::shared_ptr<NotingLauncher> launcher = std::make_shared<NotingLauncher>();
    EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>::Override launchers =
        ApplicationLauncher::launcher().overrideWith(launcher);
};

TEST_F(WidgetContextTest, BeginsCompactAndWithoutSizes) {
    EXPECT_EQ(context->widgetActiveDisplayMode(), ContextMode::Compact);
    EXPECT_EQ(context->widgetLargestAvailableDisplayMode(), ContextMode::Compact);
    EXPECT_EQ(context->widgetMaximumSizeForDisplayMode(ContextMode::Compact), CGSize());
}

TEST_F(WidgetContextTest, ShowsWhatTheHostHasSet) {
    context->setActiveMode(ContextMode::Expanded);
    context->setMaxima({359, 110}, {359, 616});
    EXPECT_EQ(context->widgetActiveDisplayMode(), ContextMode::Expanded);
    EXPECT_EQ(context->widgetMaximumSizeForDisplayMode(ContextMode::Compact), CGSize(359, 110));
    EXPECT_EQ(context->widgetMaximumSizeForDisplayMode(ContextMode::Expanded), CGSize(359, 616));
}

TEST_F(WidgetContextTest, TellsTheHostOfTheLargestModeEachTimeItIsSaid) {
    context->setWidgetLargestAvailableDisplayMode(ContextMode::Expanded); // nobody listens yet
    int told = 0;
    context->setLargestModeTold([&] {
        ++told;
        EXPECT_EQ(context->widgetLargestAvailableDisplayMode(), ContextMode::Expanded);
    });
    context->setWidgetLargestAvailableDisplayMode(ContextMode::Expanded);
    context->setWidgetLargestAvailableDisplayMode(ContextMode::Expanded);
    EXPECT_EQ(told, 2);
}

TEST_F(WidgetContextTest, URLsAreOpenedByTheContainingApplication) {
    EXPECT_EQ(open("orvo://?t=r"), true);
    EXPECT_EQ(launcher->opened, (std::vector<std::string>{"a.map", "orvo://?t=r"}));
    context->openURL_completionHandler(NSURL::URLWithString("orvo://?t=r"), {});
    EXPECT_EQ(launcher->opened.size(), 4U) << "the handler may be empty";
}

TEST_F(WidgetContextTest, AFailureIsAnsweredAndItsReasonLogged) {
    const testing::LogCapture log;
    launcher->answer = NSError::errorWithMessage("Test", 1, "nobody is there");
    EXPECT_EQ(open("orvo://?t=r"), false);
    ASSERT_EQ(log.records().size(), 1U);
    EXPECT_EQ(log.records().front().level, LogLevel::Error);
    EXPECT_NE(log.messages().front().find("nobody is there"), std::string::npos);
}

} // namespace
} // namespace orvo
