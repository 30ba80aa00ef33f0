#include "platform/launchservices/DesktopApplicationLauncher.h"

#include "platform/launchservices/BusTest.h"
#include "platform/launchservices/ScriptedProgram.h"

#include <QDBusVirtualObject>

namespace orvo {
namespace {

/// Another program's application, which answers as it is told.
class MockApplication final : public QDBusVirtualObject {
public:
    explicit MockApplication(QDBusConnection connection, QString name, const QString& path)
        : _connection(std::move(connection))
        , _name(std::move(name)) {
        _connection.registerVirtualObject(path, this);
        _connection.registerService(_name);
    }
    ~MockApplication() override { _connection.unregisterService(_name); }

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
        received = message;
        connection.send(refusal.isEmpty()
                            ? message.createReply()
                            : message.createErrorReply("org.example.Error.Busy", refusal));
        return true;
    }

    QDBusMessage received;
    QString refusal;

private:
    QDBusConnection _connection;
    QString _name;
};

struct Outcome {
    int answers = 0;
    std::shared_ptr<NSError> error;

    ApplicationLauncher::CompletionHandler handler() {
        return [this](const std::shared_ptr<NSError>& answered) {
            ++answers;
            error = answered;
        };
    }
    [[nodiscard]] LaunchServicesErrorCode code() const {
        return static_cast<LaunchServicesErrorCode>(error ? error->code() : 0);
    }
};

class DesktopApplicationLauncherTest : public testing::BusTest {
protected:
    void TearDown() override {
        unsetenv("XDG_ACTIVATION_TOKEN");
        unsetenv("DESKTOP_STARTUP_ID");
    }

    void serve() { application.emplace(other(), Application, Path); }
    void open(const std::vector<std::string>& urls) {
        outcome = {};
        launcher.openURLs(Application, urls, outcome.handler());
        EXPECT_EQ(outcome.answers, 0); // never inside the call
        ASSERT_TRUE(waitFor([&] { return outcome.answers > 0; }));
    }
    void activate(const std::shared_ptr<NSData>& parameter) {
        outcome = {};
        launcher.activateAction(Application, "Go", parameter, outcome.handler());
        EXPECT_EQ(outcome.answers, 0);
        ASSERT_TRUE(waitFor([&] { return outcome.answers > 0; }));
    }
    QVariantMap platformData() const {
        return qdbus_cast<QVariantMap>(application->received.arguments().last());
    }

    std::optional<MockApplication> application;
    DesktopApplicationLauncher launcher;
    Outcome outcome;
    std::optional<std::filesystem::path> program;
    EnvironmentSlot<DesktopApplicationLauncher::ProgramLookup>::Override lookup =
        DesktopApplicationLauncher::programLookup().overrideWith(
            [this](const std::string&) { return program; });
};

TEST_F(DesktopApplicationLauncherTest, OpensURLsOverTheBus) {
    serve();
    open({"a:1", "a:2"});
    EXPECT_FALSE(outcome.error);
    EXPECT_EQ(application->received.member(), "Open");
    EXPECT_EQ(application->received.interface(), Interface);
    EXPECT_EQ(application->received.path(), Path);
    EXPECT_EQ(application->received.signature(), "asa{sv}");
    EXPECT_EQ(application->received.arguments()[0].toStringList(), (QStringList{"a:1", "a:2"}));
    EXPECT_TRUE(platformData().isEmpty());
}

TEST_F(DesktopApplicationLauncherTest, ActivatesActionsOverTheBus) {
    serve();
    activate(NSData::dataWithString(std::string_view("a\0b", 3)));
    EXPECT_FALSE(outcome.error);
    EXPECT_EQ(application->received.signature(), "sava{sv}");
    EXPECT_EQ(application->received.arguments()[0].toString(), "Go");
    const auto parameters = qdbus_cast<QVariantList>(application->received.arguments()[1]);
    ASSERT_EQ(parameters.size(), 1);
    EXPECT_EQ(parameters[0].toByteArray(), QByteArray("a\0b", 3));
}

TEST_F(DesktopApplicationLauncherTest, ANilParameterIsNone) {
    serve();
    activate(nullptr);
    EXPECT_TRUE(qdbus_cast<QVariantList>(application->received.arguments()[1]).isEmpty());
}

TEST_F(DesktopApplicationLauncherTest, PassesTheActivationTokenOn) {
    constexpr int replace = 1;
    setenv("XDG_ACTIVATION_TOKEN", "t1", replace);
    setenv("DESKTOP_STARTUP_ID", "s1", replace);
    serve();
    open({"a:1"});
    EXPECT_EQ(platformData(),
              (QVariantMap{{"activation-token", "t1"}, {"desktop-startup-id", "s1"}}));
}

TEST_F(DesktopApplicationLauncherTest, CarriesTheDemonstrationAlong) {
    const auto demonstration = Environment::profile().overrideWith(ProfileFolders::demonstration());
    serve();
    open({"a:1"});
    EXPECT_EQ(platformData(), (QVariantMap{{"com.zentu.Orvo.demo", true}}));
}

TEST_F(DesktopApplicationLauncherTest, TellsWhyTheApplicationRefused) {
    serve();
    application->refusal = "busy";
    open({"a:1"});
    EXPECT_EQ(outcome.code(), LaunchServicesErrorCode::Refused);
    EXPECT_NE(outcome.error->localizedDescription().find("busy"), std::string::npos);
}

TEST_F(DesktopApplicationLauncherTest, AnEmptyHandlerIsFine) {
    serve();
    launcher.openURLs(Application, {"a:1"}, {});
    EXPECT_TRUE(waitFor([&] { return application->received.member() == "Open"; }));
    open({"a:2"});
}

TEST_F(DesktopApplicationLauncherTest, WhereNobodyServesTheProgramIsStarted) {
    const testing::ScriptedProgram script;
    program = script.path();
    open({"a:1", "a:2"});
    EXPECT_FALSE(outcome.error);
    EXPECT_EQ(script.report(), "open a:1 a:2|");
    activate(NSData::dataWithString("bytes"));
    EXPECT_EQ(script.report(), "receive Go|bytes");
    EXPECT_FALSE(outcome.error);
}

TEST_F(DesktopApplicationLauncherTest, TheProgramIsToldOfTheDemonstration) {
    const auto demonstration = Environment::profile().overrideWith(ProfileFolders::demonstration());
    const testing::ScriptedProgram script;
    program = script.path();
    open({"a:1"});
    EXPECT_EQ(script.report(), "open a:1 --demo|");
}

TEST_F(DesktopApplicationLauncherTest, AMissingProgramIsSaidToBeMissing) {
    open({"a:1"});
    EXPECT_EQ(outcome.code(), LaunchServicesErrorCode::ApplicationNotFound);
    EXPECT_NE(outcome.error->localizedDescription().find(Application), std::string::npos);
    EXPECT_NE(outcome.error->localizedDescription().find("program map"), std::string::npos);
}

TEST_F(DesktopApplicationLauncherTest, AProgramThatDoesNotStartIsAnError) {
    program = profile.path() / "gone";
    open({"a:1"});
    EXPECT_EQ(outcome.code(), LaunchServicesErrorCode::NotStarted);
    EXPECT_NE(outcome.error->localizedDescription().find("gone"), std::string::npos);
}

TEST(DesktopApplicationLauncherDeathTest, WithoutABusTheProgramIsStarted) {
    GTEST_FLAG_SET(death_test_style, "threadsafe"); // a process that never knew a bus
    EXPECT_EXIT(
        {
            (void)RunLoop::main();
            const testing::ScriptedProgram script;
            const auto lookup = DesktopApplicationLauncher::programLookup().overrideWith(
                [&](const std::string&) { return std::optional(script.path()); });
            Outcome outcome;
            DesktopApplicationLauncher launcher;
            launcher.openURLs("org.example.Map", {"a:1"}, outcome.handler());
            constexpr NSTimeInterval Patience = 30;
            const bool hasAnswer =
                outcome.answers == 0 &&
                RunLoop::main().runUntil([&] { return outcome.answers == 1; }, Patience);
            std::_Exit(hasAnswer && !outcome.error && script.report() == "open a:1|" ? 0 : 1);
        },
        ::testing::ExitedWithCode(0),
        "");
}

} // namespace
} // namespace orvo
