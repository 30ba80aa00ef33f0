#include "platform/extension/DesktopSystemEvents.h"

#include "platform/foundation/DispatchSource.h"
#include "platform/foundation/RunLoop.h"
#include "support/ScriptedBusService.h"

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
class ScriptedServices final : public testing::ScriptedBusService {
public:
    explicit ScriptedServices(const std::string& address)
        : ScriptedBusService(address, {Login, Network}) {}

    void setLocked(bool isLocked) {
        locked = isLocked;
        propertiesChanged(
            "/org/freedesktop/login1/session/_31", Session, {{"LockedHint", isLocked}}, {});
    }
    void setNetwork(uint state) {
        network = state;
        signal(NetworkPath, Network, "StateChanged", {state});
    }
    void prepareForSleep(bool begins) const {
        signal("/org/freedesktop/login1", Manager, "PrepareForSleep", {begins});
    }

    bool locked = false;
    uint network = Online;

protected:
    QVariant answerTo(const QDBusMessage& question) override {
        const auto name = question.arguments().value(1).toString();
        return propertyAnswer(name == "LockedHint" ? QVariant(locked) : QVariant(network));
    }
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
        services.prepareForSleep(false);
        RunLoop::main().runUntil([&] { return !heard.empty() && heard.back() == "woke"; },
                                 Patience);
        if (!heard.empty())
            heard.pop_back();
    }

    ScriptedServices services{testing::desktopBusAddress()};
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
    services.prepareForSleep(true);
    services.prepareForSleep(false);
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
