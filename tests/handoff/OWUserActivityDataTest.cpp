#include "handoff/OWUserActivityData.h"

#include "handoff/ApplicationProxyOrvoExtras.h"
#include "handoff/Doubles.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/launchservices/PlugInKitProxy.h"
#include "platform/mapuikit/MapItem.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <optional>
#include <thread>

namespace orvo {
namespace {

const char* const Type = "com.zentu.Orvo.Transit.Incident";

std::shared_ptr<NSDictionary> info(const char* value) {
    return NSDictionary::dictionaryWithTextKeys({{"bs", NSString::string(value)}});
}

struct Answer {
    bool success;
    std::shared_ptr<NSError> error;
};

class OWUserActivityDataTest : public ::testing::Test {
protected:
    OWOpenable::CompletionHandler recorder() {
        return [this](bool success, const std::shared_ptr<NSError>& error) {
            answers.push_back({success, error});
        };
    }
    static EnvironmentSlot<std::shared_ptr<BundleProxy>>::Override
    process(std::shared_ptr<BundleProxy> proxy) {
        return BundleProxy::currentProcess().overrideWith(std::move(proxy));
    }

    testing::OpeningDoubles doubles;
    std::vector<Answer> answers;
};

TEST_F(OWUserActivityDataTest, SessionStepRunsAtCreationBeforeTheUserInfoIsAmended) {
    const auto data = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    EXPECT_EQ(*doubles.journal,
              (std::vector<std::string>{"session callback=0 share=1 reset=0", "conversion"}));
    EXPECT_EQ(data->activityType(), Type);
    EXPECT_TRUE(equal(data->userInfo()->objectForKey("bs"), NSString::string("a")));
    EXPECT_TRUE(
        equal(data->userInfo()->objectForKey(MapItem::SharedSessionKey), NSString::string("S1")));
}

TEST_F(OWUserActivityDataTest, SessionStepRunsAtEveryCreation) {
    for (int i = 0; i < 3; ++i)
        (void)OWUserActivityData::initWithActivityType_userInfo(Type, nullptr);
    EXPECT_EQ(std::ranges::count(*doubles.journal, "session callback=0 share=1 reset=0"), 3);
}

TEST_F(OWUserActivityDataTest, EqualsTheSameTypeAndEqualUserInfo) {
    const auto a = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    const auto b = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    EXPECT_TRUE(equal(a, b));
    EXPECT_TRUE(equal(b, a));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(equal(a, OWUserActivityData::initWithActivityType_userInfo(Type, info("b"))));
    EXPECT_FALSE(
        equal(a, OWUserActivityData::initWithActivityType_userInfo("com.zentu.Other", info("a"))));
    EXPECT_FALSE(equal(a, NSString::string(Type)));
}

TEST_F(OWUserActivityDataTest, NilTypesOnBothSidesAreEqual) {
    const auto a = OWUserActivityData::initWithActivityType_userInfo(std::nullopt, nullptr);
    const auto b = OWUserActivityData::initWithActivityType_userInfo(std::nullopt, nullptr);
    EXPECT_TRUE(equal(a, b));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(equal(a, OWUserActivityData::initWithActivityType_userInfo("", nullptr)));
}

TEST_F(OWUserActivityDataTest, NilUserInfosAreEqualDifferFromEmptyOnesAndHashAsZero) {
    doubles.session->identifier = ""; // so that nothing is added to them
    const auto make = [](const std::shared_ptr<NSDictionary>& userInfo) {
        return OWUserActivityData::initWithActivityType_userInfo(Type, userInfo);
    };
    ASSERT_FALSE(make(nullptr)->userInfo());
    EXPECT_TRUE(equal(make(nullptr), make(nullptr)));
    EXPECT_FALSE(equal(make(nullptr), make(NSDictionary::dictionary())));
    EXPECT_FALSE(equal(make(NSDictionary::dictionary()), make(nullptr)));
    EXPECT_EQ(make(nullptr)->hash(), NSString::string(Type)->hash());
    EXPECT_EQ(OWUserActivityData::initWithActivityType_userInfo(std::nullopt, nullptr)->hash(), 0U);
}

TEST_F(OWUserActivityDataTest, HashIsTypeXorUserInfo) {
    const auto data = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    EXPECT_EQ(data->hash(), NSString::string(Type)->hash() ^ data->userInfo()->hash());
    const auto typeless =
        OWUserActivityData::initWithActivityType_userInfo(std::nullopt, info("a"));
    EXPECT_EQ(typeless->hash(), typeless->userInfo()->hash());
}

TEST_F(OWUserActivityDataTest, OpensTheActivityInTheContainingApplicationAskingToUnlock) {
    const auto application = ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo");
    const auto scope = process(PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
        "com.zentu.Orvo.Widget", application));
    const auto data = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    data->openInContext_completionHandler(nullptr, recorder()); // the context is not used
    ASSERT_EQ(doubles.system->calls, 1);
    EXPECT_EQ(doubles.system->activity->activityType(), Type);
    EXPECT_EQ(doubles.system->activity->userInfo(), data->userInfo());
    EXPECT_EQ(doubles.system->application, application);
    EXPECT_TRUE(doubles.system->promptsUnlock);
    EXPECT_TRUE(answers.empty()); // the answer is the platform's alone
    doubles.system->handler(true, nullptr);
    ASSERT_EQ(answers.size(), 1U);
    EXPECT_TRUE(answers[0].success);
}

TEST_F(OWUserActivityDataTest, PassesANilHandlerThroughAsNil) {
    const auto scope = process(ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo"));
    OWUserActivityData::initWithActivityType_userInfo(Type, nullptr)
        ->openInContext_completionHandler(nullptr, {});
    ASSERT_EQ(doubles.system->calls, 1);
    EXPECT_FALSE(doubles.system->handler);
}

TEST_F(OWUserActivityDataTest, OpeningSharesNoSessionASecondTime) {
    const auto scope = process(ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo"));
    const auto data = OWUserActivityData::initWithActivityType_userInfo(Type, info("a"));
    doubles.journal->clear();
    data->openInContext_completionHandler(doubles.controller, {});
    EXPECT_EQ(*doubles.journal, (std::vector<std::string>{"open activity"}));
}

TEST_F(OWUserActivityDataTest, HandlerIsCalledWhereThePlatformAnswers) {
    const auto scope = process(ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo"));
    std::thread::id calledOn;
    OWUserActivityData::initWithActivityType_userInfo(Type, nullptr)
        ->openInContext_completionHandler(nullptr, [&](bool, const std::shared_ptr<NSError>&) {
            calledOn = std::this_thread::get_id();
        });
    std::thread platform([&] { doubles.system->handler(true, nullptr); });
    const auto platformThread = platform.get_id();
    platform.join();
    EXPECT_EQ(calledOn, platformThread);
}

TEST_F(OWUserActivityDataTest, RefusedTypeEndsWithAnErrorThatHoldsTheDescription) {
    const auto scope = process(ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo"));
    const auto data = OWUserActivityData::initWithActivityType_userInfo("", info("a"));
    data->openInContext_completionHandler(nullptr, recorder());
    data->openInContext_completionHandler(nullptr, {});
    EXPECT_EQ(doubles.system->calls, 0);
    ASSERT_EQ(answers.size(), 1U);
    EXPECT_FALSE(answers[0].success);
    EXPECT_EQ(answers[0].error->domain(), "OWUserActivityErrorDomain");
    EXPECT_EQ(answers[0].error->code(), 0);
    EXPECT_EQ(answers[0].error->userInfo()->count(), 1U);
    EXPECT_EQ(answers[0].error->userInfo()->objectForKey("OWUserActivityErrorMissingActivityKey"),
              data);
}

TEST_F(OWUserActivityDataTest, ProcessWithoutBundleEndsWithTheLookupsError) {
    const auto scope = process(nullptr);
    OWUserActivityData::initWithActivityType_userInfo(Type, nullptr)
        ->openInContext_completionHandler(nullptr, recorder());
    EXPECT_EQ(doubles.system->calls, 0);
    ASSERT_EQ(answers.size(), 1U);
    EXPECT_FALSE(answers[0].success);
    EXPECT_EQ(answers[0].error->domain(), "OrvoActivityErrorDomain");
    EXPECT_EQ(answers[0].error->code(), 0);
    EXPECT_TRUE(equal(answers[0].error->userInfo()->objectForKey(NSDebugDescriptionErrorKey),
                      NSString::string("no appliction proxy object for current process")));
    OWUserActivityData::initWithActivityType_userInfo(Type, nullptr)
        ->openInContext_completionHandler(nullptr, {});
}

TEST_F(OWUserActivityDataTest, NoApplicationWithoutAnErrorStillAsksTheSystemWithNil) {
    const auto scope = process(PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
        "com.zentu.Orvo.Widget",
        PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle("x.y", nullptr)));
    OWUserActivityData::initWithActivityType_userInfo(Type, nullptr)
        ->openInContext_completionHandler(nullptr, recorder());
    ASSERT_EQ(doubles.system->calls, 1);
    EXPECT_FALSE(doubles.system->application);
    EXPECT_TRUE(answers.empty());
}

class OtherBundle final : public BundleProxy {};

TEST(ApplicationProxyOrvoExtras, AnApplicationContainsItself) {
    const auto application = ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo");
    const auto scope = BundleProxy::currentProcess().overrideWith(application);
    std::shared_ptr<NSError> error;
    EXPECT_EQ(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error), application);
    EXPECT_FALSE(error);
}

TEST(ApplicationProxyOrvoExtras, APlugInGivesItsContainingApplicationOrNil) {
    const auto application = ApplicationProxy::applicationProxyForIdentifier("com.zentu.Orvo");
    std::shared_ptr<NSError> error;
    {
        const auto scope = BundleProxy::currentProcess().overrideWith(
            PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle("a.b", application));
        EXPECT_EQ(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error),
                  application);
    }
    const auto scope = BundleProxy::currentProcess().overrideWith(
        PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
            "a.b", std::make_shared<OtherBundle>()));
    EXPECT_FALSE(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error));
    EXPECT_FALSE(error);
}

TEST(ApplicationProxyOrvoExtras, AnotherKindOfBundleGivesNilWithoutAnError) {
    const auto scope = BundleProxy::currentProcess().overrideWith(std::make_shared<OtherBundle>());
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error));
    EXPECT_FALSE(error);
}

TEST(ApplicationProxyOrvoExtras, NoBundleGivesAnErrorWhereOneIsWanted) {
    const auto scope = BundleProxy::currentProcess().overrideWith(nullptr);
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->domain(), "OrvoActivityErrorDomain");
    EXPECT_FALSE(ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(nullptr));
}

} // namespace
} // namespace orvo
