#pragma once

#include "handoff/Doubles.h"
#include "handoff/NSDataOrvoExtra.h"
#include "handoff/NSURLOWOpenable.h"
#include "handoff/OrvoActivity.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/geoservices/Bzip2.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/mapuikit/TransitIncidentStringProvider.h"
#include "viewmodel/BuilderWorld.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <gtest/gtest.h>

namespace orvo::testing {

/// What the builder told analytics in one call.
struct Reported {
    std::shared_ptr<NSArray> lines;
    std::vector<std::shared_ptr<TransitIncident>> incidents;
    std::shared_ptr<NSMapTable> mapping;
};

class RecordingAnalytics final : public OWTransitIncidentsAnalyticsDelegate {
public:
    void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>& lines,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>& mapping) override {
        reports.push_back({lines, typed<TransitIncident>(incidents), mapping});
    }
    std::vector<Reported> reports;
};

/// Lists of lines made as a fetch makes them, and what their rows hold.
class BuilderTest : public ::testing::Test {
protected:
    using Lines = std::vector<std::shared_ptr<TransitLineItem>>;

    /// One line for each incident, and as many lines without any.
    static Lines lines(std::uint64_t advisories, std::uint64_t clear) {
        Lines all;
        for (std::uint64_t i = 1; i <= advisories; ++i)
            all.push_back(line(i, {incident(100 + i)}));
        for (std::uint64_t i = 0; i < clear; ++i)
            all.push_back(line(1000 + i, {}));
        return all;
    }
    static std::shared_ptr<SizedTransitArtwork> sized(const std::shared_ptr<OWTransitItem>& row) {
        return std::dynamic_pointer_cast<SizedTransitArtwork>(row->artwork()->artworkSource());
    }
    static std::string imageName(const std::shared_ptr<OWTransitItem>& row) {
        const auto image = std::dynamic_pointer_cast<UIImage>(row->artwork()->artworkSource());
        return image ? image->name().value_or("") : "(not a fixed image)";
    }
    static std::vector<std::uint64_t> muidsOfList(const std::shared_ptr<OWOpenable>& openable) {
        const auto classes = CodingClassTable::current().overrideWith(
            std::make_shared<const CodingClassTable>(CodingClassTable{
                CodingClass::of<TransitStorageIncident>("TransitStorageIncident")}));
        const auto activity = std::dynamic_pointer_cast<OWUserActivityData>(openable);
        if (!activity || activity->activityType() != "com.zentu.Orvo.Transit.IncidentList")
            return {};
        const auto archive = std::dynamic_pointer_cast<NSData>(
            activity->userInfo()->objectForKey("incidentListKey"));
        const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(archive, nullptr);
        const auto list =
            std::dynamic_pointer_cast<NSArray>(unarchiver->decodeObjectOfClasses_forKey(
                {"NSArray", "TransitStorageIncident"}, "root"));
        std::vector<std::uint64_t> muids;
        for (const auto& stored : typed<TransitStorageIncident>(list))
            muids.push_back(stored->muid());
        return muids;
    }
    static std::shared_ptr<OrvoActivity> payload(const std::shared_ptr<OWTransitItem>& row) {
        const auto activity = std::dynamic_pointer_cast<OWUserActivityData>(row->openable());
        if (!activity || activity->activityType() != "com.zentu.Orvo.Transit.Incident")
            return nullptr;
        const auto compressed =
            std::dynamic_pointer_cast<NSData>(activity->userInfo()->objectForKey("bs"));
        return protoMessageWithBytes<OrvoActivity>(
            NSDataOrvoExtra::bzip2UncompressedData(*compressed)->bytes());
    }
    std::shared_ptr<OWTransitItem> summaryRow(const std::shared_ptr<OWTransitListItem>& list) {
        return std::dynamic_pointer_cast<OWTransitItem>(list->summaryItem());
    }
    std::shared_ptr<OWTransitSummaryItem> summary(const std::shared_ptr<OWTransitListItem>& list) {
        return std::dynamic_pointer_cast<OWTransitSummaryItem>(list->summaryItem());
    }

    BuilderWorld world;
};

} // namespace orvo::testing
