#include "platform/mapuikit/LookupService.h"

#include "platform/geoservices/TransitLineRecord.h"
#include "platform/mapuikit/FeedLookupService.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class NoService final : public virtual LookupService {
public:
    std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& /*identifiers*/,
                                 const std::shared_ptr<NSObject>& /*traits*/) override {
        return nullptr;
    }
};

TEST(LookupService, TheSharedServiceLooksInTheFeedsAndIsOneObject) {
    const auto service = LookupService::sharedService();
    EXPECT_NE(dynamic_cast<FeedLookupService*>(service.get()), nullptr);
    EXPECT_EQ(LookupService::sharedService(), service);
}

TEST(LookupService, AnotherServiceCanStandInForAWhile) {
    const auto earlier = LookupService::sharedService();
    const auto other = std::make_shared<NoService>();
    {
        const auto scope = LookupService::shared().overrideWith(other);
        EXPECT_EQ(LookupService::sharedService(), other);
    }
    EXPECT_EQ(LookupService::sharedService(), earlier);
}

TEST(LookupService, TheIdentifierOfALineIsItsOwnOrNil) {
    TransitLineRecord::Fields fields;
    EXPECT_EQ(MapItemIdentifierFromTransitLine(TransitLineRecord::initWithFields(fields)), nullptr);
    fields.muid = 4;
    fields.identifier = MapItemIdentifier::identifierWithMuid(9);
    EXPECT_EQ(MapItemIdentifierFromTransitLine(TransitLineRecord::initWithFields(fields)),
              fields.identifier);
    EXPECT_EQ(MapItemIdentifierFromTransitLine(nullptr), nullptr);
}

} // namespace
} // namespace orvo
