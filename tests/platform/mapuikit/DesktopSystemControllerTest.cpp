#include "platform/mapuikit/DesktopSystemController.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationLauncher.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSUserActivity> activity(std::shared_ptr<NSDictionary> userInfo = nullptr) {
    auto made = NSUserActivity::initWithActivityType("com.zentu.Orvo.Transit.Incident");
    made->setUserInfo(std::move(userInfo));
    return made;
}

std::shared_ptr<NSDictionary> everyKindOfValue() {
    const std::vector<std::uint8_t> bytes{0, 1, 254, 255};
    return NSDictionary::dictionaryWithTextKeys({
        {"data", NSData::dataWithBytes(bytes)},
        {"text", NSString::string("Straße 東京")},
        {"number", NSNumber::numberWithInteger(-7)},
        {"list", NSArray::arrayWithObjects({NSString::string("a"), NSString::string("b")})},
        {"inner", NSDictionary::dictionaryWithTextKeys({{"k", NSString::string("v")}})},
    });
}

TEST(UserActivityEncoding, ComesBackAsItWent) {
    const auto given = activity(everyKindOfValue());
    const auto bytes = encodedUserActivity(*given);
    ASSERT_TRUE(bytes);
    std::shared_ptr<NSError> error;
    const auto back = decodedUserActivity(*bytes, &error);
    ASSERT_TRUE(back);
    EXPECT_FALSE(error);
    EXPECT_EQ(back->activityType(), given->activityType());
    EXPECT_TRUE(equal(back->userInfo(), given->userInfo()));
}

TEST(UserActivityEncoding, NilUserInfoStaysNilAndAnEmptyOneEmpty) {
    EXPECT_EQ(decodedUserActivity(*encodedUserActivity(*activity()), nullptr)->userInfo(), nullptr);
    const auto empty = decodedUserActivity(
        *encodedUserActivity(*activity(NSDictionary::dictionaryWithTextKeys({}))), nullptr);
    ASSERT_TRUE(empty->userInfo());
    EXPECT_EQ(empty->userInfo()->count(), 0U);
}

TEST(UserActivityEncoding, ObjectOutsidePropertyListsCannotTravel) {
    EXPECT_EQ(encodedUserActivity(
                  *activity(NSDictionary::dictionaryWithTextKeys({{"activity", activity()}}))),
              nullptr);
}

TEST(UserActivityEncoding, IsNilWithAnErrorWhereverTheBytesAreCut) {
    const auto bytes = encodedUserActivity(*activity(everyKindOfValue()));
    for (std::size_t length = 0; length < bytes->length(); ++length) {
        const std::vector<std::uint8_t> cut(
            bytes->bytes().begin(), bytes->bytes().begin() + static_cast<std::ptrdiff_t>(length));
        std::shared_ptr<NSError> error;
        EXPECT_EQ(decodedUserActivity(*NSData::dataWithBytes(cut), &error), nullptr) << length;
        EXPECT_TRUE(error) << length;
    }
}

TEST(UserActivityEncoding, OtherPropertyListsAreNoActivity) {
    const auto refused = [](const std::shared_ptr<NSObject>& root) {
        std::shared_ptr<NSError> error;
        const auto decoded = decodedUserActivity(*PropertyList::write(*root), &error);
        return !decoded && error &&
               decodedUserActivity(*PropertyList::write(*root), nullptr) == nullptr;
    };
    EXPECT_TRUE(refused(NSString::string("text")));
    EXPECT_TRUE(refused(NSDictionary::dictionaryWithTextKeys({})));
    EXPECT_TRUE(refused(
        NSDictionary::dictionaryWithTextKeys({{"activityType", NSNumber::numberWithInteger(1)}})));
    EXPECT_TRUE(refused(
        NSDictionary::dictionaryWithTextKeys({{"activityType", NSString::string("no type!")}})));
}

/// Keeps what it was asked for; answers when the test says so.
class RecordingLauncher final : public ApplicationLauncher {
public:
    void openURLs(const std::string&, const std::vector<std::string>&, CompletionHandler) override {
        ADD_FAILURE() << "no URL is opened here";
    }
    void activateAction(const std::string& givenIdentifier,
                        const std::string& givenAction,
                        const std::shared_ptr<NSData>& givenParameter,
                        CompletionHandler completionHandler) override {
        ++calls;
        identifier = givenIdentifier;
        action = givenAction;
        parameter = givenParameter;
        handler = std::move(completionHandler);
    }

    int calls = 0;
    std::string identifier;
    std::string action;
    std::shared_ptr<NSData> parameter;
    CompletionHandler handler;
};

class DesktopSystemControllerTest : public ::testing::Test {
protected:
    DesktopSystemControllerTest() { (void)RunLoop::main(); }

    void open(const std::shared_ptr<NSUserActivity>& given,
              const std::shared_ptr<ApplicationProxy>& application) {
        DesktopSystemController()
            .openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
                given,
                application,
                true,
                [this](bool success, const std::shared_ptr<NSError>& error) {
                    EXPECT_TRUE(RunLoop::isMainThread());
                    answers.emplace_back(success, error);
                });
    }
    static std::shared_ptr<ApplicationProxy> application() {
        return ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo");
    }

    std::shared_ptr<RecordingLauncher> launcher = std::make_shared<RecordingLauncher>();
    EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>::Override launcherOverride =
        ApplicationLauncher::launcher().overrideWith(launcher);
    std::vector<std::pair<bool, std::shared_ptr<NSError>>> answers;
};

TEST_F(DesktopSystemControllerTest, HandsTheActivityToTheApplicationAsAnAction) {
    open(activity(everyKindOfValue()), application());
    ASSERT_EQ(launcher->calls, 1);
    EXPECT_EQ(launcher->identifier, "com.zentu.Orvo");
    EXPECT_EQ(launcher->action, DesktopSystemController::Action);
    EXPECT_TRUE(
        equal(decodedUserActivity(*launcher->parameter, nullptr)->userInfo(), everyKindOfValue()));
    EXPECT_TRUE(answers.empty());
}

TEST_F(DesktopSystemControllerTest, AnswersWhatTheLauncherAnswers) {
    open(activity(), application());
    launcher->handler(nullptr);
    const auto error = NSError::errorWithMessage("Domain", 3, "refused");
    open(activity(), application());
    launcher->handler(error);
    ASSERT_EQ(answers.size(), 2U);
    EXPECT_TRUE(answers[0].first);
    EXPECT_FALSE(answers[0].second);
    EXPECT_FALSE(answers[1].first);
    EXPECT_EQ(answers[1].second, error);
}

TEST_F(DesktopSystemControllerTest, NilApplicationIsAnErrorInALaterTurnOfTheMainQueue) {
    open(activity(), nullptr);
    EXPECT_TRUE(answers.empty());
    RunLoop::main().runOnce();
    ASSERT_EQ(answers.size(), 1U);
    EXPECT_FALSE(answers[0].first);
    EXPECT_EQ(answers[0].second->domain(), SystemControllerErrorDomain);
    EXPECT_EQ(answers[0].second->code(),
              static_cast<std::int64_t>(SystemControllerErrorCode::NoApplication));
    EXPECT_EQ(launcher->calls, 0);
}

TEST_F(DesktopSystemControllerTest, ContentThatCannotTravelIsAnErrorInALaterTurn) {
    open(activity(NSDictionary::dictionaryWithTextKeys({{"activity", activity()}})), application());
    EXPECT_TRUE(answers.empty());
    RunLoop::main().runOnce();
    ASSERT_EQ(answers.size(), 1U);
    EXPECT_EQ(answers[0].second->code(),
              static_cast<std::int64_t>(SystemControllerErrorCode::CannotEncode));
    EXPECT_EQ(launcher->calls, 0);
}

TEST_F(DesktopSystemControllerTest, EmptyHandlerIsNeverCalled) {
    const auto openUnheard = [](const std::shared_ptr<ApplicationProxy>& given) {
        DesktopSystemController()
            .openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
                activity(), given, true, {});
    };
    openUnheard(nullptr);
    openUnheard(application());
    launcher->handler(nullptr);
    RunLoop::main().runOnce();
    EXPECT_EQ(launcher->calls, 1);
}

} // namespace
} // namespace orvo
