#include "platform/launchservices/ApplicationService.h"

#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/BusTest.h"

#include <optional>

namespace orvo {
namespace {

class RecordingHandler final : public ApplicationRequestHandler {
public:
    std::shared_ptr<NSError> activate(const ApplicationRequest& request) override {
        return note("activate", request);
    }
    std::shared_ptr<NSError> openURLs(const std::vector<std::string>& urls,
                                      const ApplicationRequest& request) override {
        std::string call = "open";
        for (const auto& url : urls)
            call += " " + url;
        return note(std::move(call), request);
    }
    std::shared_ptr<NSError> activateAction(const std::string& action,
                                            const std::shared_ptr<NSData>& parameter,
                                            const ApplicationRequest& request) override {
        return note("action " + action +
                        (parameter ? " of " + std::string(parameter->stringView()) : ""),
                    request);
    }

    void busIsGone() override { calls.emplace_back("the bus is gone"); }

    std::vector<std::string> calls;
    ApplicationRequest last;
    std::shared_ptr<NSError> answer;

private:
    std::shared_ptr<NSError> note(std::string call, const ApplicationRequest& request) {
        calls.push_back(std::move(call));
        last = request;
        return answer;
    }
};

class ApplicationServiceTest : public testing::BusTest {
protected:
    void start() {
        std::shared_ptr<NSError> error;
        service = ApplicationService::start(Application, handler, &error);
        ASSERT_TRUE(service) << error->localizedDescription();
    }

    RecordingHandler handler;
    std::unique_ptr<ApplicationService> service;
};

TEST_F(ApplicationServiceTest, HandsRequestsToItsHandler) {
    start();
    EXPECT_EQ(ask("Activate", {QVariantMap()}).type(), QDBusMessage::ReplyMessage);
    EXPECT_EQ(ask("Open", {QStringList{"a:1", "a:2"}, QVariantMap()}).type(),
              QDBusMessage::ReplyMessage);
    EXPECT_EQ(
        ask("ActivateAction", {"Go", QVariantList{QByteArray("bytes")}, QVariantMap()}).type(),
        QDBusMessage::ReplyMessage);
    EXPECT_EQ(ask("ActivateAction", {"Go", QVariantList(), QVariantMap()}).type(),
              QDBusMessage::ReplyMessage);
    EXPECT_EQ(
        handler.calls,
        (std::vector<std::string>{"activate", "open a:1 a:2", "action Go of bytes", "action Go"}));
}

TEST_F(ApplicationServiceTest, BytesMayHoldAnything) {
    start();
    const QByteArray bytes("a\0b\xff", 4);
    ask("ActivateAction", {"Go", QVariantList{bytes}, QVariantMap()});
    EXPECT_EQ(handler.calls.back(), std::string("action Go of a\0b\xff", 17));
}

TEST_F(ApplicationServiceTest, TellsWhatGoesAlong) {
    start();
    ask("Activate", {QVariantMap()});
    EXPECT_EQ(handler.last.activationToken, "");
    EXPECT_FALSE(handler.last.usesDemonstration);
    ask("Activate",
        {QVariantMap{{"activation-token", "t1"}, {"com.zentu.Orvo.demo", true}, {"other", 7}}});
    EXPECT_EQ(handler.last.activationToken, "t1");
    EXPECT_TRUE(handler.last.usesDemonstration);
    ask("Activate", {QVariantMap{{"desktop-startup-id", "s1"}}});
    EXPECT_EQ(handler.last.activationToken, "s1");
}

TEST_F(ApplicationServiceTest, ARefusalIsAnErrorWithItsReason) {
    start();
    handler.answer = NSError::errorWithMessage("D", 1, "not this one");
    const auto answer = ask("Open", {QStringList{"a:1"}, QVariantMap()});
    EXPECT_EQ(answer.type(), QDBusMessage::ErrorMessage);
    EXPECT_EQ(answer.errorMessage(), "not this one");
}

TEST_F(ApplicationServiceTest, WhatDoesNotFitTheInterfaceIsRefused) {
    start();
    EXPECT_EQ(ask("Open", {"a:1", QVariantMap()}).errorName(),
              "org.freedesktop.DBus.Error.InvalidArgs");
    EXPECT_EQ(ask("Close", {}).errorName(), "org.freedesktop.DBus.Error.UnknownMethod");
    EXPECT_EQ(ask("ActivateAction", {"Go", QVariantList{"text"}, QVariantMap()}).errorName(),
              "org.freedesktop.DBus.Error.InvalidArgs");
    EXPECT_EQ(
        ask("ActivateAction", {"Go", QVariantList{QByteArray("a"), QByteArray("b")}, QVariantMap()})
            .errorName(),
        "org.freedesktop.DBus.Error.InvalidArgs");
    EXPECT_TRUE(handler.calls.empty());
}

TEST_F(ApplicationServiceTest, DescribesItsInterface) {
    start();
    const auto pending = other().asyncCall(QDBusMessage::createMethodCall(
        Application, Path, "org.freedesktop.DBus.Introspectable", "Introspect"));
    EXPECT_TRUE(answerTo(pending).arguments().value(0).toString().contains(Interface));
}

TEST_F(ApplicationServiceTest, RunsFromItsStartToItsEnd) {
    EXPECT_FALSE(ApplicationService::isRunning(Application));
    start();
    EXPECT_TRUE(ApplicationService::isRunning(Application));
    service.reset();
    EXPECT_FALSE(ApplicationService::isRunning(Application));
    start();
    EXPECT_TRUE(ApplicationService::isRunning(Application));
}

TEST_F(ApplicationServiceTest, IsTheOnlyOneOfItsName) {
    ASSERT_TRUE(other().registerService(Application));
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(ApplicationService::start(Application, handler, &error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->code(), static_cast<std::int64_t>(LaunchServicesErrorCode::AlreadyRuns));
    EXPECT_FALSE(ApplicationService::start(Application, handler, nullptr));
    other().unregisterService(Application);
    start();
}

TEST_F(ApplicationServiceTest, AnswersWhatWasAskedBeforeItsEnd) {
    start();
    ask("Open", {QStringList{"a:1"}, QVariantMap()}); // from now on requests are delivered
    handler.calls.clear();
    auto call = QDBusMessage::createMethodCall(Application, Path, Interface, "Activate");
    call.setArguments({QVariantMap()});
    const auto pending = other().asyncCall(call);
    // Who has this answer has had the call sent on before it.
    ASSERT_TRUE(other().interface()->isServiceRegistered(Application));
    EXPECT_TRUE(handler.calls.empty());
    service.reset();
    EXPECT_EQ(handler.calls, std::vector<std::string>{"activate"});
    EXPECT_EQ(answerTo(pending).type(), QDBusMessage::ReplyMessage);
}

TEST(ApplicationServiceDeathTest, WithoutABusThereIsNothingToServeOn) {
    GTEST_FLAG_SET(death_test_style, "threadsafe"); // a process that never knew a bus
    EXPECT_EXIT(
        {
            RecordingHandler handler;
            std::shared_ptr<NSError> error;
            const bool serves = ApplicationService::start("org.example.Map", handler, &error) ||
                                ApplicationService::isRunning("org.example.Map");
            const bool isNoBus =
                error && error->code() == static_cast<std::int64_t>(LaunchServicesErrorCode::NoBus);
            std::_Exit(!serves && isNoBus ? 0 : 1);
        },
        ::testing::ExitedWithCode(0),
        "");
}

TEST(ApplicationServiceDeathTest, TellsItsHandlerWhenTheBusIsGone) {
    GTEST_FLAG_SET(death_test_style, "threadsafe"); // a process whose bus may go
    EXPECT_EXIT(
        {
            auto bus = std::make_unique<testing::PrivateBus>();
            constexpr int replace = 1;
            setenv("DBUS_SESSION_BUS_ADDRESS", bus->address().c_str(), replace);
            RecordingHandler handler;
            const auto service = ApplicationService::start("org.example.Map", handler, nullptr);
            bus.reset();
            constexpr NSTimeInterval patience = 30;
            const bool isTold =
                RunLoop::main().runUntil([&] { return !handler.calls.empty(); }, patience);
            std::_Exit(service && isTold &&
                               handler.calls == std::vector<std::string>{"the bus is gone"}
                           ? 0
                           : 1);
        },
        ::testing::ExitedWithCode(0),
        "");
}

} // namespace
} // namespace orvo
