#include "viewmodel/OWTransitItem.h"

#include "handoff/NSURLOWOpenable.h"
#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSCoder.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSString.h"
#include "platform/uikit/UIImage.h"
#include "viewmodel/ArtworkDataSourceCacheTransitWidget.h"
#include "viewmodel/GuidanceManeuverArtwork.h"
#include "viewmodel/OWTransitListItem.h"
#include "viewmodel/OWTransitSummaryItem.h"

#include <gtest/gtest.h>

#include <set>

namespace orvo {
namespace {

/// An artwork source of a known hash, equal to nobody else.
class HashedSource : public ArtworkImageSource {
public:
    explicit HashedSource(std::uint64_t hash)
        : _hash(hash) {}
    std::shared_ptr<UIImage> imageToDisplayWithScreenScale_nightMode(double, bool) override {
        return nullptr;
    }
    std::uint64_t hash() const override { return _hash; }

private:
    std::uint64_t _hash;
};

class CodedSource final : public HashedSource, public NSSecureCoding {
public:
    CodedSource(std::string content, bool isSecure)
        : HashedSource(1)
        , _content(std::move(content))
        , _isSecure(isSecure) {}
    void encodeWithCoder(NSCoder& coder) const override {
        coder.encodeString_forKey(_content, "content");
    }
    bool supportsSecureCoding() const override { return _isSecure; }

private:
    std::string _content;
    bool _isSecure;
};

std::shared_ptr<OWConfiguredArtwork> configured(std::shared_ptr<ArtworkImageSource> source,
                                                double alpha) {
    return OWConfiguredArtwork::initWithArtworkSource_alpha(std::move(source), alpha);
}

std::shared_ptr<OWTransitItem> item(std::optional<std::string> primary = std::nullopt,
                                    std::optional<std::string> secondary = std::nullopt,
                                    std::shared_ptr<OWConfiguredArtwork> artwork = nullptr,
                                    bool hidden = false,
                                    std::shared_ptr<OWOpenable> openable = nullptr) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::move(primary), std::move(secondary), std::move(artwork), hidden, std::move(openable));
}

std::shared_ptr<OWOpenable> url(const char* text) {
    return NSURLOWOpenable::openableWithURL(NSURL::URLWithString(text));
}

class SubItem final : public OWTransitItem {
public:
    static std::shared_ptr<SubItem> make(std::optional<std::string> primary) {
        auto made = std::make_shared<SubItem>();
        made->_initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            std::move(primary), std::nullopt, nullptr, false, nullptr);
        return made;
    }

protected:
    std::shared_ptr<OWTransitItem> _alloc() const override { return std::make_shared<SubItem>(); }
};

TEST(OWConfiguredArtwork, ComparesAlphaExactly) {
    const auto source = std::make_shared<HashedSource>(1);
    EXPECT_TRUE(equal(configured(source, 1.0), configured(source, 1.0)));
    EXPECT_FALSE(equal(configured(source, 1.0), configured(source, 0.9999)));
    EXPECT_FALSE(equal(configured(source, 0.3), configured(source, 0.3F)));
}

TEST(OWConfiguredArtwork, SourcesAreEqualByNilContentOrArchive) {
    const auto source = std::make_shared<HashedSource>(1);
    EXPECT_TRUE(equal(configured(nullptr, 1), configured(nullptr, 1)));
    EXPECT_FALSE(equal(configured(nullptr, 1), configured(source, 1)));
    EXPECT_FALSE(equal(configured(source, 1), configured(nullptr, 1)));
    EXPECT_FALSE(equal(configured(source, 1), configured(std::make_shared<HashedSource>(1), 1)));
    const auto coded = [](const char* content, bool isSecure) {
        return std::make_shared<CodedSource>(content, isSecure);
    };
    EXPECT_TRUE(equal(configured(coded("a", true), 1), configured(coded("a", true), 1)));
    EXPECT_FALSE(equal(configured(coded("a", true), 1), configured(coded("b", true), 1)));
}

TEST(OWConfiguredArtwork, OneSourceWithoutSecureCodingIsUnequalEvenWithTheSameContent) {
    const auto secure = configured(std::make_shared<CodedSource>("a", true), 1);
    const auto insecure = configured(std::make_shared<CodedSource>("a", false), 1);
    EXPECT_FALSE(equal(secure, insecure));
    EXPECT_FALSE(equal(insecure, secure));
}

TEST(OWConfiguredArtwork, SourcesAreArchivedSecurelyAndOnlyWhereThatDecides) {
    int archived = 0;
    const auto scope = NSKeyedArchiver::archiving().overrideWith(
        [&](const auto&, bool requiresSecureCoding, auto*) {
            EXPECT_TRUE(requiresSecureCoding);
            ++archived;
            return NSData::dataWithString("the same");
        });
    const auto source = [](bool isSecure) {
        return std::make_shared<CodedSource>("a", isSecure);
    };
    EXPECT_TRUE(equal(configured(source(true), 1), configured(source(true), 1)));
    EXPECT_EQ(archived, 2);
    const auto one = source(true);
    EXPECT_TRUE(equal(configured(one, 1), configured(one, 1)));
    EXPECT_FALSE(equal(configured(one, 1), configured(source(true), 0.5)));
    EXPECT_FALSE(equal(configured(one, 1), configured(source(false), 1)));
    EXPECT_FALSE(equal(configured(one, 1), configured(std::make_shared<HashedSource>(1), 1)));
    EXPECT_EQ(archived, 2);
}

TEST(OWConfiguredArtwork, SourcesThatCannotBeArchivedAreUnequal) {
    const auto scope = NSKeyedArchiver::archiving().overrideWith(
        [](const auto&, bool, auto*) { return std::shared_ptr<NSData>(); });
    EXPECT_FALSE(equal(configured(std::make_shared<CodedSource>("a", true), 1),
                       configured(std::make_shared<CodedSource>("a", true), 1)));
}

TEST(OWConfiguredArtwork, AcceptsSubclasses) {
    class Sub final : public OWConfiguredArtwork {};
    EXPECT_TRUE(equal(configured(nullptr, 0), std::make_shared<Sub>()));
    EXPECT_TRUE(equal(std::make_shared<Sub>(), configured(nullptr, 0)));
}

TEST(OWConfiguredArtwork, HashIsAlphaXorTheSourcesOwn) {
    const auto hashOfAlpha = [](double alpha) {
        return configured(std::make_shared<HashedSource>(0), alpha)->hash();
    };
    EXPECT_EQ(hashOfAlpha(2.25), 4611686023736259426U);
    EXPECT_EQ(hashOfAlpha(0.5), 2654435761U);
    EXPECT_EQ(hashOfAlpha(0.7), 2654435761U);
    EXPECT_EQ(hashOfAlpha(1.0), 2654435761U);
    EXPECT_EQ(hashOfAlpha(0.0), 0U);
    EXPECT_EQ(hashOfAlpha(-0.0), 0U);
    EXPECT_TRUE(equal(configured(nullptr, 0.0), configured(nullptr, -0.0)));
    EXPECT_EQ(configured(std::make_shared<HashedSource>(5), 1.0)->hash(), 5U ^ 2654435761U);
}

TEST(OWTransitItem, AllNilFieldsAreEqualAndHashAlike) {
    EXPECT_TRUE(equal(item(), item()));
    EXPECT_EQ(item()->hash(), 0U);
}

TEST(OWTransitItem, IsNeverEqualToASubclassWithTheSameFields) {
    const auto plain = item("a");
    const auto sub = SubItem::make("a");
    EXPECT_FALSE(equal(plain, sub));
    EXPECT_FALSE(equal(sub, SubItem::make("a"))); // only exactly this class is accepted
    EXPECT_TRUE(equal(sub, sub));
    EXPECT_TRUE(equal(sub, plain)); // the other's class is what counts
}

TEST(OWTransitItem, EachFieldTellsItemsApart) {
    const auto artwork = configured(nullptr, 1);
    const auto base = item("a", "b", artwork, false, url("orvo://?t=r"));
    EXPECT_TRUE(equal(base, item("a", "b", configured(nullptr, 1), false, url("orvo://?t=r"))));
    for (const auto& other : {item("x", "b", artwork, false, url("orvo://?t=r")),
                              item("a", std::nullopt, artwork, false, url("orvo://?t=r")),
                              item("a", "b", nullptr, false, url("orvo://?t=r")),
                              item("a", "b", artwork, true, url("orvo://?t=r")),
                              item("a", "b", artwork, false, url("orvo://?t=m"))}) {
        EXPECT_FALSE(equal(base, other));
        EXPECT_FALSE(equal(other, base));
    }
}

TEST(OWTransitItem, HashIsTheExclusiveOrOfItsFields) {
    const auto full =
        item("a", "b", configured(std::make_shared<HashedSource>(5), 0), true, url("orvo://?t=r"));
    EXPECT_EQ(full->hash(),
              NSString::string("a")->hash() ^ NSString::string("b")->hash() ^ 5U ^ HashMultiplier ^
                  url("orvo://?t=r")->hash());
}

TEST(OWTransitItem, CopyKeepsTheReceiversOwnClass) {
    const auto copy = SubItem::make("a")->copy();
    const auto sub = std::dynamic_pointer_cast<SubItem>(copy);
    ASSERT_TRUE(sub);
    EXPECT_EQ(sub->primaryText(), "a");
    const auto original = item("a", "b", configured(nullptr, 1), true, url("orvo://?t=r"));
    const auto plain = original->copy();
    EXPECT_NE(plain, original);
    EXPECT_TRUE(equal(plain, original));
}

TEST(OWTransitItem, DescriptionShowsEveryField) {
    const auto described =
        item("A", std::nullopt, nullptr, true, url("orvo://?t=r"))->description();
    EXPECT_EQ(described.substr(0, 17), "<OWTransitItem:0x");
    EXPECT_EQ(described.substr(described.find(" | ")),
              " | text: A | subtext: (null) | artwork: (null) | hideArtwork?: YES | openable: "
              "orvo://?t=r>");
    EXPECT_NE(item()->description().find("hideArtwork?: NO"), std::string::npos);
}

TEST(OWTransitListItem, KeepsTheSummaryObjectAndOffersExpandedOnlyWithRows) {
    const auto summary = NSString::string("anything");
    const auto compact =
        OWTransitListItem::initWithSummaryItem_expandedItems(summary, NSArray::array());
    EXPECT_EQ(compact->summaryItem(), summary);
    EXPECT_EQ(OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(*compact),
              NCWidgetDisplayMode::Compact);
    const auto expanded =
        OWTransitListItem::initWithSummaryItem_expandedItems(summary, NSArray::arrayOf({item()}));
    EXPECT_EQ(OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(*expanded),
              NCWidgetDisplayMode::Expanded);
}

TEST(OWTransitListItem, ComparesSummaryThenRowsInOrderAndAcceptsSubclasses) {
    class Sub final : public OWTransitListItem {};
    const auto list = [](const char* summary,
                         std::initializer_list<std::shared_ptr<OWTransitItem>> rows) {
        return OWTransitListItem::initWithSummaryItem_expandedItems(NSString::string(summary),
                                                                    NSArray::arrayOf(rows));
    };
    EXPECT_TRUE(equal(list("s", {item("a"), item("b")}), list("s", {item("a"), item("b")})));
    EXPECT_FALSE(equal(list("s", {item("a"), item("b")}), list("s", {item("b"), item("a")})));
    EXPECT_FALSE(equal(list("s", {item("a")}), list("t", {item("a")})));
    EXPECT_TRUE(equal(OWTransitListItem::initWithSummaryItem_expandedItems(nullptr, nullptr),
                      std::make_shared<Sub>()));
    EXPECT_EQ(list("s", {item("a")})->hash(),
              NSString::string("s")->hash() ^ NSArray::arrayOf({item("a")})->hash());
}

TEST(ArtworkDataSourceCacheTransitWidget, MakesANewCacheEachTimeWithoutAtlases) {
    const auto manager = std::make_shared<IconManager>();
    const auto scope = IconManager::manager().overrideWith(manager);
    const auto a = ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache();
    const auto b = ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache();
    EXPECT_NE(a, b);
    EXPECT_NE(a->artworkManager(), b->artworkManager());
    EXPECT_EQ(a->artworkManager()->iconManager(), manager);
    EXPECT_FALSE(manager->isCachingAtlases());
}

TEST(ArtworkDataSourceCacheTransitWidget, MakesACacheWithoutAnIconManagerToo) {
    const auto scope = IconManager::manager().overrideWith(nullptr);
    ASSERT_TRUE(ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache());
}

TEST(GuidanceManeuverArtwork, KnowsStartAndArrivalManoeuvres) {
    const std::set<std::int32_t> starts{17, 25};
    const std::set<std::int32_t> arrivals{16, 18, 33, 34, 39};
    for (std::int32_t maneuver = 0; maneuver <= 64; ++maneuver) {
        const auto artwork = GuidanceManeuverArtwork::artworkWithManeuver(maneuver);
        EXPECT_EQ(artwork->isStartRouteManeuver(), starts.contains(maneuver)) << maneuver;
        EXPECT_EQ(artwork->isArriveManeuver(), arrivals.contains(maneuver)) << maneuver;
        EXPECT_FALSE(artwork->junction());
        EXPECT_EQ(artwork->drivingSide(), 0);
    }
}

TEST(GuidanceManeuverArtwork, EqualityIsByExactClassAndEveryField) {
    class Sub final : public GuidanceManeuverArtwork {};
    const auto make = [](std::int32_t maneuver, const char* junction, std::int32_t side) {
        return GuidanceManeuverArtwork::initWithManeuver_junction_drivingSide(
            maneuver, junction ? NSString::string(junction) : nullptr, side);
    };
    EXPECT_TRUE(equal(make(1, "j", 2), make(1, "j", 2)));
    EXPECT_TRUE(equal(make(1, nullptr, 2), make(1, nullptr, 2)));
    EXPECT_FALSE(equal(make(1, "j", 2), make(2, "j", 2)));
    EXPECT_FALSE(equal(make(1, "j", 2), make(1, "j", 3)));
    EXPECT_FALSE(equal(make(1, "j", 2), make(1, nullptr, 2)));
    EXPECT_FALSE(equal(make(0, nullptr, 0), std::make_shared<Sub>()));
    EXPECT_EQ(make(3, "j", 1)->hash(),
              NSString::string("j")->hash() ^ (3 * HashMultiplier) ^ HashMultiplier);
}

std::shared_ptr<TransitArtworkDataSource> shield(const char* text) {
    return TransitArtworkDataSource::initWithFields(
        {.shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = text})});
}

TEST(OWTransitSummaryItem, EqualsThroughDistinctButEqualArtworksAndHashesAlike) {
    const auto make =
        [](const char* text,
           std::initializer_list<std::shared_ptr<TransitArtworkDataSource>> artworks) {
            return OWTransitSummaryItem::initWithText_artworks_userActivityData(
                text, NSArray::arrayOf(artworks), nullptr);
        };
    EXPECT_TRUE(
        equal(make("a", {shield("1"), shield("2")}), make("a", {shield("1"), shield("2")})));
    EXPECT_EQ(make("a", {shield("1")})->hash(), make("a", {shield("1")})->hash());
    EXPECT_FALSE(
        equal(make("a", {shield("1"), shield("2")}), make("a", {shield("2"), shield("1")})));
    EXPECT_FALSE(equal(make("a", {shield("1")}), make("a", {shield("1"), shield("1")})));
    EXPECT_FALSE(equal(make("a", {}), make("b", {})));
    const auto nilArtworks =
        OWTransitSummaryItem::initWithText_artworks_userActivityData("a", nullptr, nullptr);
    EXPECT_FALSE(equal(nilArtworks, make("a", {})));
    EXPECT_FALSE(equal(make("a", {}), nilArtworks));
    EXPECT_TRUE(
        equal(nilArtworks,
              OWTransitSummaryItem::initWithText_artworks_userActivityData("a", nullptr, nullptr)));
}

TEST(OWTransitSummaryItem, AcceptsSubclassesAndComparesTheActivity) {
    class Sub final : public OWTransitSummaryItem {};
    EXPECT_TRUE(equal(OWTransitSummaryItem::initWithText_artworks_userActivityData(
                          std::nullopt, nullptr, nullptr),
                      std::make_shared<Sub>()));
    const auto with = [](const char* type) {
        return OWTransitSummaryItem::initWithText_artworks_userActivityData(
            "a",
            NSArray::array(),
            OWUserActivityData::initWithActivityType_userInfo(type, nullptr));
    };
    EXPECT_TRUE(equal(with("a.b"), with("a.b")));
    EXPECT_FALSE(equal(with("a.b"), with("a.c")));
    EXPECT_EQ(with("a.b")->hash(),
              NSString::string("a")->hash() ^ NSArray::array()->hash() ^
                  with("a.b")->userActivityData()->hash());
}

} // namespace
} // namespace orvo
