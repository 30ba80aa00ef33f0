#include "platform/favorites/StoredTransitLine.h"

#include "platform/favorites/FavoriteLines.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/geoservices/FeedTransitLineItem.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(StoredTransitLine, KeepsALineOfNoFeedWithoutOrigin) {
    const auto line = TransitLineRecord::initWithFields(testing::favoriteLine(7, "7")->fields());
    EXPECT_EQ(StoredTransitLine::originOf(*line), std::nullopt);
    const auto back = StoredTransitLine::decode(StoredTransitLine::encode(*line)->bytes());
    ASSERT_NE(back, nullptr);
    EXPECT_EQ(dynamic_cast<FeedTransitLine*>(back.get()), nullptr);
    EXPECT_EQ(back->name(), "7");
}

TEST(StoredTransitLine, FindsTheOriginOfEveryKindOfLine) {
    const auto line = testing::favoriteLine(7, "7");
    const auto item =
        FeedTransitLineItem::initWithFields_service_origin(line->fields(), {}, line->origin());
    const auto storage = TransitStorageLineItem::initWithLineItem(line);
    EXPECT_EQ(StoredTransitLine::originOf(*line), line->origin());
    EXPECT_EQ(StoredTransitLine::originOf(*item), line->origin());
    EXPECT_EQ(StoredTransitLine::originOf(*storage), line->origin());
}

TEST(StoredTransitLine, KeepsNoService) {
    const auto line = testing::favoriteLine(7, "7");
    TransitLineItemRecord::Service service;
    service.incidents = NSArray::array();
    const auto item = FeedTransitLineItem::initWithFields_service_origin(
        line->fields(), std::move(service), line->origin());
    EXPECT_TRUE(StoredTransitLine::encode(*item)->isEqual(StoredTransitLine::encode(*line).get()));
}

TEST(StoredTransitLine, AnIdentifierOtherThanTheNumberAndNoNameAreKept) {
    auto fields = testing::favoriteLine(7, "7")->fields();
    fields.identifier = nullptr;
    fields.name = std::nullopt;
    fields.system = nullptr;
    const auto line = TransitLineRecord::initWithFields(std::move(fields));
    const auto back = StoredTransitLine::decode(StoredTransitLine::encode(*line)->bytes());
    EXPECT_EQ(back->identifier(), nullptr);
    EXPECT_EQ(back->name(), std::nullopt);
    EXPECT_EQ(back->system(), nullptr);
}

TEST(StoredTransitLine, BytesCutAnywhereNeverReadPastTheEnd) {
    const auto data = StoredTransitLine::encode(*testing::favoriteLine(7, "Seven"));
    const auto bytes = data->bytes();
    for (std::size_t length = 0; length < bytes.size(); ++length) {
        // A block of exactly that size, so that the sanitizer sees a byte too far.
        const std::vector<std::uint8_t> cut(bytes.begin(),
                                            bytes.begin() + static_cast<std::ptrdiff_t>(length));
        const auto line = StoredTransitLine::decode(cut);
        if (line) {
            EXPECT_LT(StoredTransitLine::encode(*line)->length(), bytes.size());
        }
    }
}

} // namespace
} // namespace orvo
