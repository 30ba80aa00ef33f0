#include "platform/foundation/Signpost.h"
#include "platform/foundation/WorkerThreads.h"
#include "support/GraphicalApplication.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

#include <atomic>
#include <thread>

namespace orvo {
namespace {

using ::testing::AllOf;
using testing::Calls;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::SizeIs;
using ::testing::StrEq;

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

/// Lets the test look around when its base class hears of something.
class WatchedWidget final : public OWTransitIncidentsViewController {
public:
    static std::shared_ptr<WatchedWidget> make() {
        auto widget = std::make_shared<WatchedWidget>();
        EXPECT_TRUE(widget->_initWithNibName_bundle(std::nullopt, nullptr));
        return widget;
    }
    std::function<void()> whenReached;

private:
    void _hasReachedBase(const char*) override {
        if (whenReached)
            whenReached();
    }
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

TEST_F(MemoryPressureOfTheWidget, ItsQueueIsSerialAndKeepsItsMisspeltName) {
    controller = makeController();
    (void)controller->view();
    std::atomic<bool> isOver = false;
    std::vector<std::string> names;
    std::vector<std::thread::id> threads;
    for (const auto& queue : queues)
        queue->async([&] {
            names.push_back(WorkerThreads::currentName());
            threads.push_back(std::this_thread::get_id());
        });
    queues[0]->async([&] { isOver = true; });
    ASSERT_TRUE(runUntil([&] { return isOver.load(); }));
    EXPECT_THAT(names, AllOf(SizeIs(4), Each(StrEq("com.zentu.Orvo.TransitWidget.memoryPresure"))));
    EXPECT_THAT(threads, Each(threads.at(0)));
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
    const auto widget = WatchedWidget::make();
    controller = widget;
    (void)controller->view();
    const auto cache = controller->artworkCache();
    drawInto(*cache);
    const auto bytes = cache->bytes();
    ASSERT_GT(bytes, 0U);
    for (const auto& source : sources)
        source->handler();
    EXPECT_EQ(cache->bytes(), bytes);
    std::vector<std::size_t> bytesWhenTheBaseHears;
    widget->whenReached = [&] {
        bytesWhenTheBaseHears.push_back(cache->bytes());
    };
    controller->didReceiveMemoryWarning();
    EXPECT_THAT(bytesWhenTheBaseHears, ElementsAre(bytes));
    EXPECT_EQ(cache->bytes(), 0U);
    EXPECT_EQ(controller->artworkCache(), cache);
}

} // namespace
} // namespace orvo
