#pragma once

#include "platform/foundation/LocalizedFormat.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/geoservices/TransitSystemRecord.h"
#include "support/TestClock.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo::testing {

/// A bundle whose texts show their key and arguments: `key[%1$@][%2$@][%3$@]`, missing ones empty.
/// It notes what was asked.
class KeyBundle final : public NSBundle {
public:
    std::string
    localizedStringForKey_value_table(const std::string& key,
                                      const std::optional<std::string>& value,
                                      const std::optional<std::string>& table) const override {
        keys.push_back(key);
        values.push_back(value.value_or("(nil)"));
        tables.push_back(table.value_or("(nil)"));
        return hasTexts ? key + "[%1$@][%2$@][%3$@]" : value.value_or("");
    }
    mutable std::vector<std::string> keys;
    mutable std::vector<std::string> values;
    mutable std::vector<std::string> tables;
    bool hasTexts = true;
};

inline std::shared_ptr<TransitArtworkDataSource> artwork(const char* text) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource =
             TransitShieldDataSource::initWithFields({.shieldType = 1, .shieldText = text})});
}

inline std::shared_ptr<TransitSystem> system(std::optional<std::string> name, const char* mark) {
    return TransitSystemRecord::initWithFields(
        {.name = std::move(name), .artwork = mark ? artwork(mark) : nullptr});
}

struct IncidentPeriod {
    std::optional<double> startsIn; ///< seconds from now
    std::optional<double> endsIn;
};

inline std::shared_ptr<TransitIncident>
incident(std::uint64_t muid, const char* title = "Title", IncidentPeriod period = {}) {
    const auto date = [](const std::optional<double>& seconds) {
        return seconds ? NSDate::dateWithTimeIntervalSinceNow(*seconds) : nullptr;
    };
    return TransitIncidentRecord::initWithFields({.muid = muid,
                                                  .startDate = date(period.startsIn),
                                                  .endDate = date(period.endsIn),
                                                  .title = title,
                                                  .summary = "Summary"});
}

struct LineOptions {
    const char* name = "U1";
    std::shared_ptr<TransitSystem> system;
    std::shared_ptr<TransitArtworkDataSource> alternate;
};

inline std::shared_ptr<TransitLineItem>
line(std::uint64_t muid,
     std::vector<std::shared_ptr<TransitIncident>> incidents,
     LineOptions options = {}) {
    return TransitLineItemRecord::initWithFields_service(
        {.muid = muid,
         .name = options.name,
         .system = options.system,
         .artwork = artwork("never shown"),
         .modeArtwork = artwork("nor this"),
         .alternateArtwork = options.alternate},
        {.incidents = NSArray::arrayOf(incidents)});
}

/// Fixed texts and a stopped clock for the scope of a test.
struct BuilderWorld {
    StoppedClock clock;
    std::shared_ptr<KeyBundle> bundle = std::make_shared<KeyBundle>();
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override bundleOverride =
        NSBundle::main().overrideWith(bundle);
    std::shared_ptr<ArtworkDataSourceCache> cache =
        ArtworkDataSourceCache::initWithArtworkManager(nullptr);

    std::shared_ptr<OWTransitIncidentsDataSourceBuilder>
    builder(const std::vector<std::shared_ptr<TransitLineItem>>& lines,
            std::uint64_t maximum = 0,
            std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> analytics = nullptr) {
        return OWTransitIncidentsDataSourceBuilder::
            initWithLineItems_maxNumberOfItems_artworkCache_analytics(
                NSArray::arrayOf(lines), maximum, cache, std::move(analytics));
    }
    std::shared_ptr<OWTransitListItem>
    list(const std::vector<std::shared_ptr<TransitLineItem>>& lines, std::uint64_t maximum = 0) {
        return builder(lines, maximum)->listItem();
    }
};

inline std::vector<std::shared_ptr<OWTransitItem>>
rows(const std::shared_ptr<OWTransitListItem>& list) {
    return typed<OWTransitItem>(list->expandedItems());
}

} // namespace orvo::testing
