#include "platform/extension/DesktopSystemEvents.h"

#include "platform/foundation/DispatchSource.h"
#include "platform/foundation/RunLoop.h"
#include "support/PrivateBus.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVariant>
#include <QDBusVirtualObject>
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace orvo {
namespace {

constexpr const char* Login = "org.freedesktop.login1";
constexpr const char* Manager = "org.freedesktop.login1.Manager";
constexpr const char* Session = "org.freedesktop.login1.Session";
constexpr const char* Network = "org.freedesktop.NetworkManager";
constexpr const char* NetworkPath = "/org/freedesktop/NetworkManager";
constexpr uint Online = 70;
constexpr uint Offline = 20;
constexpr double Patience = 20;

/// Stands for logind and NetworkManager: answers for two properties, and sends signals.
class ScriptedServices final : public QDBusVirtualObject {
public:
    explicit ScriptedServices(const std::string& address)
        : bus(QDBusConnection::connectToBus(QString::fromStdString(address), "scripted-services")) {
        bus.registerVirtualObject("/", this, QDBusConnection::SubPath);
        bus.registerService(Login);
        bus.registerService(Network);
    }
    ~ScriptedServices() override { QDBusConnection::disconnectFromBus("scripted-services"); }

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
        ++asked;
        const auto name = message.arguments().value(1).toString();
        const QVariant value = name == "LockedHint" ? QVariant(locked) : QVariant(network);
        connection.send(message.createReply(QVariant::fromValue(QDBusVariant(value))));
        return true;
    }
    void
    signal(const char* path, const char* interface, const char* name, const QVariant& value) const {
        auto message = QDBusMessage::createSignal(path, interface, name);
        message << value;
        bus.send(message);
    }
    void setLocked(bool isLocked) {
        locked = isLocked;
        auto message = QDBusMessage::createSignal("/org/freedesktop/login1/session/_31",
                                                  "org.freedesktop.DBus.Properties",
                                                  "PropertiesChanged");
        message << QString(Session) << QVariantMap{{"LockedHint", isLocked}} << QStringList();
        bus.send(message);
    }
    void setNetwork(uint state) {
        network = state;
        signal(NetworkPath, Network, "StateChanged", state);
    }

    QDBusConnection bus;
    bool locked = false;
    uint network = Online;
    int asked = 0;
};

/// Memory that becomes scarce when the test says so.
class ScriptedMemory final : public DispatchSource {
public:
    void setEventHandler(DispatchQueue::Block handler) override { event = std::move(handler); }
    void activate() override { active = true; }
    void cancel() override { active = false; }

    DispatchQueue::Block event;
    bool active = false;
};

class DesktopSystemEventsTest : public ::testing::Test {
protected:
    using Strings = std::vector<std::string>;

    /// One for all tests of the process, which finds the system's bus only once.
    static std::string busAddress() {
        static const testing::PrivateBus bus;
        (void)RunLoop::main();
        setenv("DBUS_SYSTEM_BUS_ADDRESS", bus.address().c_str(), 1);
        return bus.address();
    }
    /// Until both services have answered what is asked at the start.
    void start() {
        events.start(handlers());
        EXPECT_EQ(heard, Strings{}) << "nothing inside the call";
        RunLoop::main().runUntil([&] { return services.asked >= 2; }, Patience);
        wake();
    }
    SystemEvents::Handlers handlers() {
        return {.lockDidChange =
                    [this](bool locked) { heard.emplace_back(locked ? "locked" : "unlocked"); },
                .machineDidWake = [this] { heard.emplace_back("woke"); },
                .networkDidChange = [this] { heard.emplace_back("network"); },
                .memoryIsScarce =
                    [this] {
                        heard.emplace_back("memory");
                    }};
    }
    bool hears(const Strings& expected) {
        return RunLoop::main().runUntil([&] { return heard.size() >= expected.size(); },
                                        Patience) &&
               std::exchange(heard, {}) == expected;
    }
    /// Messages come in order: what was sent before has arrived then.
    void wake() {
        services.signal("/org/freedesktop/login1", Manager, "PrepareForSleep", false);
        RunLoop::main().runUntil([&] { return !heard.empty() && heard.back() == "woke"; },
                                 Patience);
        if (!heard.empty())
            heard.pop_back();
    }

    ScriptedServices services{busAddress()};
    std::vector<std::shared_ptr<ScriptedMemory>> memory;
    EnvironmentSlot<DispatchSource::Factory>::Override memoryOverride =
        DispatchSource::memoryPressureFactory().overrideWith(
            [this](MemoryPressure, std::shared_ptr<DispatchQueue>) {
                return memory.emplace_back(std::make_shared<ScriptedMemory>());
            });
    Strings heard;
    DesktopSystemEvents events;
};

TEST_F(DesktopSystemEventsTest, TellsWhenTheSessionIsLockedAndUnlocked) {
    start();
    services.setLocked(true);
    EXPECT_TRUE(hears({"locked"}));
    services.setLocked(true);
    services.setLocked(false);
    EXPECT_TRUE(hears({"unlocked"})) << "each change once";
}

TEST_F(DesktopSystemEventsTest, TellsOfASessionThatIsLockedFromTheStart) {
    services.locked = true;
    events.start(handlers());
    EXPECT_TRUE(hears({"locked"}));
}

TEST_F(DesktopSystemEventsTest, TellsWhenTheMachineWakesAndNotWhenItGoesToSleep) {
    start();
    services.signal("/org/freedesktop/login1", Manager, "PrepareForSleep", true);
    services.signal("/org/freedesktop/login1", Manager, "PrepareForSleep", false);
    EXPECT_TRUE(hears({"woke"}));
}

TEST_F(DesktopSystemEventsTest, TellsWhenTheNetworkGoesAndReturns) {
    start();
    services.setNetwork(Online);
    services.setNetwork(Offline);
    services.setNetwork(40); // connecting
    services.setNetwork(Online);
    EXPECT_TRUE(hears({"network", "network"}));
}

TEST_F(DesktopSystemEventsTest, TellsWhenMemoryIsScarceInAnyWay) {
    start();
    ASSERT_EQ(memory.size(), 4U);
    for (const auto& source : memory) {
        EXPECT_TRUE(source->active);
        source->event();
    }
    EXPECT_TRUE(hears(Strings(4, "memory")));
}

TEST_F(DesktopSystemEventsTest, TellsNothingMoreAfterItsEnd) {
    start();
    events.stop();
    EXPECT_FALSE(memory.front()->active);
    services.setNetwork(Offline);
    services.setLocked(true);
    DesktopSystemEvents others;
    bool othersHeard = false;
    auto told = handlers();
    told.lockDidChange = [&](bool) {
        othersHeard = true;
    };
    others.start(told);
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return othersHeard; }, Patience));
    EXPECT_EQ(heard, Strings{});
}

TEST(DesktopSystemEventsWithoutABus, IsSilent) {
    setenv("DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/nonexistent", 1);
    DesktopSystemEvents events;
    events.start({});
    RunLoop::main().runOnce();
    events.stop();
}

} // namespace
} // namespace orvo
