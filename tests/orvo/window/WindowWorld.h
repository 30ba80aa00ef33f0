#pragma once

#include "orvo/HandOffWorld.h"
#include "orvo/window/IncidentPage.h"
#include "platform/demo/DemoSchedule.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/Text.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <QApplication>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace orvo::testing {

/// Makes the application object that widgets need, once a process. False where another test of the
/// process has made one without windows: CTest gives each test a process.
inline bool haveWindowApplication() {
    if (!QCoreApplication::instance()) {
        static int count = 1;
        static char name[] = "test";
        static char* arguments[] = {name, nullptr};
        // Never destroyed: at the end of the process its platform would be gone before it.
        static auto* const application = new QApplication(count, arguments);
        return application != nullptr;
    }
    return qobject_cast<QApplication*>(QCoreApplication::instance()) != nullptr;
}

/// A profile of its own, a clock that stands still, English texts read from left to right.
class WindowTest : public ::testing::Test {
protected:
    /// A fixture may have windows among its members: they come after this.
    WindowTest() {
        haveWindowApplication();
        QGuiApplication::setLayoutDirection(Qt::LeftToRight);
    }

    static constexpr double Now = 1750000000; // 2025-06-15T15:06:40Z

    /// The demonstration city's schedule as the feed `city`.
    void importCity() const {
        const auto folder = profile.path() / "schedule";
        std::filesystem::create_directories(folder);
        for (const auto& [name, text] : demoSchedule(Now, "UTC"))
            std::ofstream(folder / name, std::ios::binary) << text;
        const auto error =
            schedules()->importSchedule("city", ScheduleSource::fromPath(folder), {}, nullptr);
        ASSERT_FALSE(error) << error->localizedDescription();
    }

    static std::shared_ptr<ScheduleStore> schedules() {
        return ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    }

    static IncidentPage pageOfLine(const std::vector<std::shared_ptr<TransitIncident>>& incidents,
                                   const ScheduleStore* schedules = nullptr) {
        return IncidentPage::ofLine(*TransitStorageLineItem::initWithLineItem(lineWith(incidents)),
                                    schedules);
    }

    static IncidentPage
    pageOfIncidents(const std::vector<std::shared_ptr<TransitIncident>>& incidents,
                    const ScheduleStore* schedules = nullptr) {
        std::vector<std::shared_ptr<TransitStorageIncident>> stored;
        for (const auto& incident : incidents)
            stored.push_back(TransitStorageIncident::initWithIncident(incident));
        return IncidentPage::ofIncidents(stored, schedules);
    }

    TemporaryProfile profile;
    StoppedClock clock{Now};
    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("en");
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override texts =
        NSBundle::main().overrideWith(NSBundle::bundleWithPath(ORVO_TEST_RESOURCES));
};

} // namespace orvo::testing
