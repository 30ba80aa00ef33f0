#pragma once

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/Text.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/geoservices/TransitSystemRecord.h"
#include "platform/geoservices/UserSession.h"
#include "print/PrintedWidget.h"
#include "support/TestClock.h"
#include "viewmodel/ArtworkDataSourceCacheTransitWidget.h"
#include "viewmodel/OWTransitItemDataSourceBuilder.h"
#include "widget/OWTransitIncidentViewControllerState.h"

#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace orvo::testing {

/// A session whose identifier is always the same.
class FixedUserSession final : public UserSession {
public:
    std::string sharedSessionID() const override { return "S1"; }
};

/// The program's own texts in English, a stopped clock, and what the program's `main` sets up, for
/// the scope of a test.
struct PrintWorld {
    StoppedClock clock;
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override bundle =
        NSBundle::main().overrideWith(NSBundle::bundleWithPath(ORVO_TEST_RESOURCES));
    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("en");
    EnvironmentSlot<std::shared_ptr<UserSession>>::Override session =
        UserSession::instance().overrideWith(std::make_shared<FixedUserSession>());
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override classes =
        CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
            CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                             CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                             CodingClass::of<OWTransitIncidentViewControllerState>(
                                 "OWTransitIncidentViewControllerState")}));
};

inline std::shared_ptr<TransitArtworkDataSource> shield(std::string text,
                                                        std::optional<std::string> colours = {}) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource = TransitShieldDataSource::initWithFields(
             {.shieldType = 1, .shieldText = text, .shieldColorString = colours})});
}

inline std::shared_ptr<TransitIncident>
incident(std::uint64_t muid, std::string title = "Title", std::string summary = "Summary") {
    return TransitIncidentRecord::initWithFields(
        {.muid = muid, .title = std::move(title), .summary = std::move(summary)});
}

/// A line called as its shield.
inline std::shared_ptr<TransitLineItem>
line(std::uint64_t muid,
     const std::string& name,
     std::vector<std::shared_ptr<TransitIncident>> incidents,
     std::optional<std::string> colours = {}) {
    return TransitLineItemRecord::initWithFields_service(
        {.muid = muid, .name = name, .alternateArtwork = shield(name, std::move(colours))},
        {.incidents = NSArray::arrayOf(incidents)});
}

inline std::shared_ptr<Result> success(const std::vector<std::shared_ptr<TransitLineItem>>& lines) {
    return Result::initWithSuccess(NSArray::arrayOf(lines));
}

inline std::shared_ptr<Result> failure() {
    return Result::initWithError(NSError::errorWithMessage("Test", 1, "no lookup today"));
}

/// What is printed of a result; `maxRows` 0 is no limit.
inline PrintedWidget widgetOfResult(const std::shared_ptr<Result>& result,
                                    std::uint64_t maxRows = 0) {
    const auto builder = OWTransitDataSourceBuilderForResult(
        result,
        maxRows == 0 ? std::numeric_limits<std::uint64_t>::max() : maxRows,
        ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache(),
        nullptr);
    return PrintedWidget::of(*builder->listItem(), result);
}
inline PrintedWidget widgetOf(const std::vector<std::shared_ptr<TransitLineItem>>& lines,
                              std::uint64_t maxRows = 0) {
    return widgetOfResult(success(lines), maxRows);
}

} // namespace orvo::testing
