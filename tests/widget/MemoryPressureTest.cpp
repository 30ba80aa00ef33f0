#include "platform/foundation/Signpost.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using testing::Calls;
using ::testing::ElementsAre;

class FakeSource final : public DispatchSource {
public:
    FakeSource(std::string name, Calls& calls)
        : _name(std::move(name))
        , _calls(calls) {}
    void setEventHandler(DispatchQueue::Block block) override {
        handler = std::move(block);
        _calls.push_back(_name + " handler");
    }
    void activate() override { _calls.push_back(_name + " on"); }
    void cancel() override { _calls.push_back(_name + " off"); }
    DispatchQueue::Block handler;

private:
    std::string _name;
    Calls& _calls;
};

class MemoryPressureOfTheWidget : public testing::WidgetWorld {
protected:
    std::vector<std::shared_ptr<FakeSource>> sources;
    std::vector<std::shared_ptr<DispatchQueue>> queues;

private:
    EnvironmentSlot<DispatchSource::Factory>::Override _factory =
        DispatchSource::memoryPressureFactory().overrideWith(
            [this](MemoryPressure mask, std::shared_ptr<DispatchQueue> queue) {
                queues.push_back(std::move(queue));
                sources.push_back(std::make_shared<FakeSource>(
                    std::to_string(static_cast<unsigned>(mask)), calls));
                return sources.back();
            });
};

TEST_F(MemoryPressureOfTheWidget, IsListenedToByFourSourcesOfOneBitEachOnOneQueue) {
    controller = makeController();
    (void)controller->view();
    EXPECT_THAT(calls,
                ElementsAre("2 handler",
                            "4 handler",
                            "16 handler",
                            "32 handler",
                            "2 on",
                            "4 on",
                            "16 on",
                            "32 on"));
    ASSERT_EQ(queues.size(), 4U);
    for (const auto& queue : queues)
        EXPECT_EQ(queue, queues[0]);
    calls.clear();
    controller.reset();
    EXPECT_THAT(calls, ElementsAre("2 off", "4 off", "16 off", "32 off"));
}

TEST_F(MemoryPressureOfTheWidget, LeavesAMarkAndFreesNothing) {
    std::vector<SignpostEvent> events;
    const auto scope =
        Signpost::sink().overrideWith([&](const SignpostEvent& event) { events.push_back(event); });
    controller = makeController();
    (void)controller->view();
    const auto cache = controller->artworkCache();
    const auto bytes = cache->bytes();
    for (const auto& source : sources)
        source->handler();
    ASSERT_EQ(events.size(), 4U);
    EXPECT_EQ(events[0].name, "SystemMemoryPressureWarning");
    EXPECT_EQ(events[1].name, "SystemMemoryPressureCritical");
    EXPECT_EQ(events[2].name, "ProcessMemoryPressureWarning");
    EXPECT_EQ(events[3].name, "ProcessMemoryPressureCritical");
    for (const auto& event : events) {
        EXPECT_EQ(event.message, " enableTelemetry=YES ");
        EXPECT_EQ(event.category, "TransitWidget");
        EXPECT_EQ(event.subsystem, "com.zentu.Orvo.suggestions");
    }
    EXPECT_EQ(cache->bytes(), bytes);
    EXPECT_EQ(controller->artworkCache(), cache);
}

} // namespace
} // namespace orvo
