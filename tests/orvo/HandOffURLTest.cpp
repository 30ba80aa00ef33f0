#include "orvo/HandOffURL.h"

#include "orvo/HandOffError.h"
#include "platform/geoservices/MapURLBuilder.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

HandOffErrorCode refusal(const std::string& text) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(HandOffURL::parse(text, &error)) << text;
    EXPECT_FALSE(HandOffURL::parse(text, nullptr)) << text;
    if (!error)
        return {};
    EXPECT_EQ(error->domain(), HandOffErrorDomain);
    return static_cast<HandOffErrorCode>(error->code());
}

TEST(HandOffURL, ReadsWhatTheBuilderWrites) {
    const auto builder = MapURLBuilder::URLForShowingFavoritesWithType(2);
    for (const std::int32_t mapType : {0, 1, 2, 3, 9}) {
        builder->setMapType(mapType);
        const auto url = HandOffURL::parse(builder->build()->absoluteString(), nullptr);
        ASSERT_TRUE(url) << mapType;
        EXPECT_EQ(url->favoritesType, 2);
        EXPECT_EQ(url->mapType, mapType);
    }
}

TEST(HandOffURL, NamesAndValuesMayBePercentEncoded) {
    const auto url = HandOffURL::parse("orvo://?%66avorites=%32&%74=%72", nullptr);
    ASSERT_TRUE(url);
    EXPECT_EQ(url->favoritesType, 2);
    EXPECT_EQ(url->mapType, 3);
    for (const char* text :
         {"orvo://?t=%00", "orvo://?t=%", "orvo://?t=%7", "orvo://?t=%r2", "orvo://?favorites=%33"})
        EXPECT_EQ(refusal(text), HandOffErrorCode::Unknown) << text;
}

TEST(HandOffURL, TheMapAloneHasNoFavorites) {
    const auto url = HandOffURL::parse("orvo://?t=r", nullptr);
    ASSERT_TRUE(url);
    EXPECT_EQ(url->mapType, 3);
    EXPECT_FALSE(url->favoritesType);
    EXPECT_TRUE(HandOffURL::parse("orvo:", nullptr));
    EXPECT_TRUE(HandOffURL::parse("ORVO://", nullptr));
}

TEST(HandOffURL, OtherParametersArePassedOverAndTheLaterOfTwoCounts) {
    const auto url =
        HandOffURL::parse("orvo://?session=00ff&favorites=2&t=m&x&&=&t=r#t=k", nullptr);
    ASSERT_TRUE(url);
    EXPECT_EQ(url->mapType, 3);
    EXPECT_EQ(url->favoritesType, 2);
}

TEST(HandOffURL, AURLForOthersIsNotOurs) {
    EXPECT_EQ(refusal(""), HandOffErrorCode::NotOurs);
    EXPECT_EQ(refusal("orvo"), HandOffErrorCode::NotOurs);
    EXPECT_EQ(refusal("https://t.example/?t=r"), HandOffErrorCode::NotOurs);
    EXPECT_EQ(refusal("orvo2://?t=r"), HandOffErrorCode::NotOurs);
    EXPECT_EQ(refusal("orvo://?t=r x"), HandOffErrorCode::NotOurs);
}

TEST(HandOffURL, WhatThereIsNotIsUnknown) {
    for (const char* text : {"orvo://place?t=r",
                             "orvo://?t=z",
                             "orvo://?t=",
                             "orvo://?favorites=",
                             "orvo://?favorites=3",
                             "orvo://?favorites=2x",
                             "orvo://?favorites=99999999999"})
        EXPECT_EQ(refusal(text), HandOffErrorCode::Unknown) << text;
}

TEST(HandOffURL, AnEndlessURLIsTooLarge) {
    const std::string longest =
        "orvo://?" + std::string(HandOffURL::MaximumLength - std::string("orvo://?").size(), 'x');
    EXPECT_TRUE(HandOffURL::parse(longest, nullptr));
    EXPECT_EQ(refusal(longest + "x"), HandOffErrorCode::TooLarge);
}

TEST(HandOffURL, ARefusalNamesTheURLWithoutObeyingIt) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(HandOffURL::parse("a\x1b[2Jb", &error));
    EXPECT_EQ(error->localizedDescription().find('\x1b'), std::string::npos);
    EXPECT_NE(error->localizedDescription().find("[2Jb"), std::string::npos);
}

} // namespace
} // namespace orvo
