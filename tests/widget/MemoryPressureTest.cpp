#include "platform/foundation/Signpost.h"
#include "support/GraphicalApplication.h"
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

/// Before the run loop makes an application object without a screen.
struct ForDrawing {
    bool canDraw = testing::haveGraphicalApplication();
};

class MemoryPressureOfTheWidget : protected ForDrawing, public testing::WidgetWorld {
protected:
    static void drawInto(ArtworkDataSourceCache& cache) {
        constexpr bool night = false;
        const auto artwork = TransitArtworkDataSource::initWithFields(
            {.artworkSourceType = 1,
             .shieldDataSource =
                 TransitShieldDataSource::initWithFields({.shieldType = 1, .shieldText = "M1"})});
        EXPECT_TRUE(cache.imageForArtwork_shieldSize_scale_nightMode(artwork, 3, 1, night));
    }
    std::vector<std::shared_ptr<FakeSource>> sources;
    std::vector<std::shared_ptr<DispatchQueue>> queues;

private:
    EnvironmentSlot<DispatchSource::Factory>::Override _factory =
        DispatchSource::memoryPressureFactory().overrideWith(
            [this](MemoryPressure mask, std::shared_ptr<DispatchQueue> queue) {
                EXPECT_TRUE(controller->isViewLoaded());
                EXPECT_EQ(controller->tableView(), nullptr) << "is made after the sources";
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
    EXPECT_EQ(controller->artworkCache(), cache);
}

TEST_F(MemoryPressureOfTheWidget, KeepsThePicturesWhichAWarningLetsGo) {
    if (!canDraw)
        GTEST_SKIP() << "another test of this process has made an application without a screen";
    controller = makeController();
    (void)controller->view();
    const auto cache = controller->artworkCache();
    drawInto(*cache);
    const auto bytes = cache->bytes();
    ASSERT_GT(bytes, 0U);
    for (const auto& source : sources)
        source->handler();
    EXPECT_EQ(cache->bytes(), bytes);
    controller->didReceiveMemoryWarning();
    EXPECT_EQ(cache->bytes(), 0U);
    EXPECT_EQ(controller->artworkCache(), cache);
}

} // namespace
} // namespace orvo
