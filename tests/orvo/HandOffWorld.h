#pragma once

#include "handoff/OWUserActivityData.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSUserActivity.h"
#include "platform/geoservices/FeedTransitIncident.h"
#include "platform/geoservices/TransitAffectedEntityRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/geoservices/TransitSystemRecord.h"
#include "platform/mapuikit/DesktopSystemController.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo::testing {

/// An incident of a feed, from half an hour before the clock's time to an hour after it, in Tokyo.
inline std::shared_ptr<TransitIncident> feedIncident(std::uint64_t muid, const char* title) {
    return FeedTransitIncident::initWithFields_details(
        {.muid = muid,
         .startDate = NSDate::dateWithTimeIntervalSinceNow(-1800),
         .endDate = NSDate::dateWithTimeIntervalSinceNow(3600),
         .title = title,
         .summary = "Short.",
         .fullDescription = "First paragraph.\n\nSecond paragraph.",
         .affectedEntities = NSArray::arrayOf(
             std::vector{TransitAffectedEntityRecord::initWithFields({.muid = 7}),
                         TransitAffectedEntityRecord::initWithFields({.muid = 8})})},
        {.feed = "city", .link = "https://t.example/i", .timeZone = "Asia/Tokyo"});
}

inline std::shared_ptr<TransitLineItem>
lineWith(const std::vector<std::shared_ptr<TransitIncident>>& incidents) {
    return TransitLineItemRecord::initWithFields_service(
        {.muid = 7, .name = "U1", .system = TransitSystemRecord::initWithFields({.name = "Metro"})},
        {.incidents = NSArray::arrayOf(incidents)});
}

/// An activity as it travels from the widget.
inline std::shared_ptr<NSData> travelling(const OWUserActivityData& data) {
    const auto activity = NSUserActivity::initWithActivityType(data.activityType());
    activity->setUserInfo(data.userInfo());
    return encodedUserActivity(*activity);
}

/// The same of a type and its payload.
inline std::shared_ptr<NSData>
travelling(const char* type, const char* key, std::shared_ptr<NSObject> payload) {
    const auto activity = NSUserActivity::initWithActivityType(type);
    activity->setUserInfo(NSDictionary::dictionaryWithTextKeys({{key, std::move(payload)}}));
    return encodedUserActivity(*activity);
}

/// What a tap on an incident's row hands over.
inline std::shared_ptr<NSData> tapOnLine(const std::shared_ptr<TransitLineItem>& line) {
    return travelling(*OWTransitIncidentsDataSourceBuilder::_userActivityDataForLineItem(line));
}

/// What a tap on the summary hands over.
inline std::shared_ptr<NSData>
tapOnIncidents(const std::vector<std::shared_ptr<TransitIncident>>& incidents) {
    return travelling(*OWTransitIncidentsDataSourceBuilder::_activityDataForIncidents(incidents));
}

/// The classes of the program's own table.
inline std::shared_ptr<const CodingClassTable> storableClasses() {
    return std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                         CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem")});
}

} // namespace orvo::testing
