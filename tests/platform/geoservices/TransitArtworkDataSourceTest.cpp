#include "platform/geoservices/TransitArtworkDataSource.h"

#include "platform/foundation/NSString.h"
#include "platform/geoservices/ServerFormatToken.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSArray> texts(std::initializer_list<const char*> list) {
    NSArray::Elements elements;
    for (const char* text : list)
        elements.push_back(NSString::string(text));
    return NSArray::arrayWithObjects(std::move(elements));
}

std::shared_ptr<TransitShieldDataSource> shield() {
    return TransitShieldDataSource::initWithFields(
        {.shieldType = 1, .shieldText = "U1", .shieldColorString = "FF0000"});
}

ServerFormattedString::Fields formatted() {
    return {.formatStrings = texts({"a", "b"}),
            .separators = texts({", "}),
            .formatTokens = NSArray::arrayOf(
                {ServerFormatToken::initWithFields({.type = 1, .token = "n", .text = "x"})}),
            .alternativeString = "alternative"};
}

TransitArtworkDataSource::Fields full() {
    return {.artworkSourceType = 1,
            .artworkUseType = 2,
            .shieldDataSource = shield(),
            .iconDataSource = TransitIconDataSource::initWithFields({.iconType = 3}),
            .iconFallbackShieldDataSource = shield(),
            .textDataSource = TransitTextDataSource::initWithFields(
                {.text = ServerFormattedString::initWithFields(formatted())}),
            .hasRoutingIncidentBadge = false,
            .accessibilityText = "Line U1"};
}

/// Whether a change to one field makes two otherwise equal artworks different, both ways.
template <class Change>
bool tellsApart(Change&& change) {
    auto fields = full();
    change(fields);
    const auto a = TransitArtworkDataSource::initWithFields(full());
    const auto b = TransitArtworkDataSource::initWithFields(std::move(fields));
    return !equal(a, b) && !equal(b, a);
}

TEST(TransitArtworkDataSource, DistinctObjectsWithTheSameFieldsAreEqualAndHashAlike) {
    const auto a = TransitArtworkDataSource::initWithFields(full());
    const auto b = TransitArtworkDataSource::initWithFields(full());
    EXPECT_TRUE(equal(a, b));
    EXPECT_EQ(a->hash(), b->hash());
}

TEST(TransitArtworkDataSource, EachFieldTellsArtworksApart) {
    EXPECT_TRUE(tellsApart([](auto& f) { f.artworkSourceType = 9; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.artworkUseType = 9; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.shieldDataSource = nullptr; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.iconDataSource = nullptr; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.iconFallbackShieldDataSource = nullptr; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.textDataSource = nullptr; }));
    const auto other = TransitShieldDataSource::initWithFields({.shieldType = 1});
    EXPECT_TRUE(tellsApart([&](auto& f) { f.shieldDataSource = other; }));
    EXPECT_TRUE(tellsApart([&](auto& f) { f.iconFallbackShieldDataSource = other; }));
    EXPECT_TRUE(tellsApart([](auto& f) {
        f.textDataSource = TransitTextDataSource::initWithFields(
            {.text = ServerFormattedString::initWithFields({.alternativeString = "alternative"})});
    }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.hasRoutingIncidentBadge = true; }));
    EXPECT_TRUE(tellsApart([](auto& f) { f.accessibilityText = std::nullopt; }));
    EXPECT_FALSE(tellsApart([](auto&) {}));
}

TEST(TransitShieldDataSource, EachFieldTellsShieldsApartNilFromEmptyToo) {
    const auto differs = [](TransitShieldDataSource::Fields fields) {
        return !equal(shield(), TransitShieldDataSource::initWithFields(std::move(fields)));
    };
    EXPECT_FALSE(differs({.shieldType = 1, .shieldText = "U1", .shieldColorString = "FF0000"}));
    EXPECT_TRUE(differs({.shieldType = 2, .shieldText = "U1", .shieldColorString = "FF0000"}));
    EXPECT_TRUE(differs({.shieldType = 1, .shieldText = "U2", .shieldColorString = "FF0000"}));
    EXPECT_TRUE(differs({.shieldType = 1, .shieldText = "U1", .shieldColorString = "00FF00"}));
    EXPECT_TRUE(differs({.shieldType = 1, .shieldText = "U1"}));
    EXPECT_FALSE(equal(TransitShieldDataSource::initWithFields({.shieldText = ""}),
                       TransitShieldDataSource::initWithFields({})));
}

TEST(TransitIconDataSource, EachFieldTellsIconsApart) {
    const auto icon = [](TransitIconDataSource::Fields fields) {
        return TransitIconDataSource::initWithFields(fields);
    };
    const auto plain = icon({1, 2, 3, 4, 5});
    EXPECT_TRUE(equal(plain, icon({1, 2, 3, 4, 5})));
    EXPECT_FALSE(equal(plain, icon({9, 2, 3, 4, 5})));
    EXPECT_FALSE(equal(plain, icon({1, 9, 3, 4, 5})));
    EXPECT_FALSE(equal(plain, icon({1, 2, 9, 4, 5})));
    EXPECT_FALSE(equal(plain, icon({1, 2, 3, 9, 5})));
    EXPECT_FALSE(equal(plain, icon({1, 2, 3, 4, 9})));
}

TEST(ServerFormattedString, EachListAndTheAlternativeTellTextsApart) {
    const auto differs = [](auto&& change) {
        auto fields = formatted();
        change(fields);
        return !equal(ServerFormattedString::initWithFields(formatted()),
                      ServerFormattedString::initWithFields(std::move(fields)));
    };
    EXPECT_FALSE(differs([](auto&) {}));
    EXPECT_TRUE(differs([](auto& f) { f.formatStrings = texts({"a"}); }));
    EXPECT_TRUE(differs([](auto& f) { f.formatStrings = texts({"b", "a"}); }));
    EXPECT_TRUE(differs([](auto& f) { f.separators = nullptr; }));
    EXPECT_TRUE(differs([](auto& f) { f.separators = texts({"; "}); }));
    EXPECT_TRUE(differs([](auto& f) { f.formatTokens = nullptr; }));
    EXPECT_TRUE(differs([](auto& f) {
        f.formatTokens = NSArray::arrayOf(
            {ServerFormatToken::initWithFields({.type = 1, .token = "n", .text = "y"})});
    }));
    EXPECT_TRUE(differs([](auto& f) { f.alternativeString = std::nullopt; }));
}

TEST(ServerFormatToken, EachFieldTellsTokensApart) {
    const auto token = [](ServerFormatToken::Fields fields) {
        return ServerFormatToken::initWithFields(std::move(fields));
    };
    const auto plain = token({.type = 1, .token = "n", .text = "x", .value = 2});
    EXPECT_TRUE(equal(plain, token({.type = 1, .token = "n", .text = "x", .value = 2})));
    EXPECT_FALSE(equal(plain, token({.type = 9, .token = "n", .text = "x", .value = 2})));
    EXPECT_FALSE(equal(plain, token({.type = 1, .token = "m", .text = "x", .value = 2})));
    EXPECT_FALSE(equal(plain, token({.type = 1, .token = "n", .text = "y", .value = 2})));
    EXPECT_FALSE(equal(plain, token({.type = 1, .token = "n", .text = std::nullopt, .value = 2})));
    EXPECT_FALSE(equal(plain, token({.type = 1, .token = "n", .text = "x", .value = 3})));
    const auto zero = token({.value = 0.0});
    EXPECT_TRUE(equal(zero, token({.value = -0.0})));
    EXPECT_EQ(zero->hash(), token({.value = -0.0})->hash());
}

TEST(ServerFormattedString, NilListEqualsAnEmptyOne) {
    const auto nilLists = ServerFormattedString::initWithFields({});
    const auto emptyLists =
        ServerFormattedString::initWithFields({.formatStrings = NSArray::array(),
                                               .separators = NSArray::array(),
                                               .formatTokens = NSArray::array()});
    EXPECT_TRUE(equal(nilLists, emptyLists));
    EXPECT_TRUE(equal(emptyLists, nilLists));
    EXPECT_EQ(nilLists->hash(), emptyLists->hash());
}

TEST(TransitTextDataSource, OneNilTextIsUnequal) {
    const auto none = TransitTextDataSource::initWithFields({});
    const auto some =
        TransitTextDataSource::initWithFields({.text = ServerFormattedString::initWithFields({})});
    EXPECT_FALSE(equal(none, some));
    EXPECT_FALSE(equal(some, none));
    EXPECT_TRUE(equal(none, TransitTextDataSource::initWithFields({})));
}

} // namespace
} // namespace orvo
