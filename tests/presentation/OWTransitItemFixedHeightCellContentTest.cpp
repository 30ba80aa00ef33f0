#include "CellTest.h"
#include "platform/mapuikit/ArtworkImageView.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/uikit/UIImage.h"
#include "presentation/OWTransitItemFixedHeightCell.h"
#include "presentation/VisualEffectWrappingView.h"

#include <algorithm>
#include <functional>

namespace orvo {
namespace {

using Cell = OWTransitItemFixedHeightCell;

std::shared_ptr<UIImage> picture(double width = 28) {
    const auto pixels = static_cast<std::size_t>(width) * 20;
    return UIImage::imageWithPixels_size_scale(std::vector<std::uint32_t>(pixels), {width, 20}, 1);
}

struct ItemOptions {
    std::optional<std::string> primary = "Line 1";
    std::optional<std::string> secondary = "Delays";
    std::shared_ptr<ArtworkImageSource> source;
    double alpha = 1;
    bool hidden = false;
};

std::shared_ptr<OWTransitItem> item(const ItemOptions& options = {}) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        options.primary,
        options.secondary,
        OWConfiguredArtwork::initWithArtworkSource_alpha(options.source, options.alpha),
        options.hidden,
        nullptr);
}

std::shared_ptr<OWTransitItem> itemWithoutArtwork() {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        "Line 1", "Delays", nullptr, false, nullptr);
}

/// Lets the test look around before its source changes.
class WatchedArtworkView final : public ArtworkImageView {
public:
    static std::shared_ptr<WatchedArtworkView> make() {
        auto view = std::make_shared<WatchedArtworkView>();
        view->_initWithFrame({});
        return view;
    }
    void setImageSource(std::shared_ptr<ArtworkImageSource> source) override {
        if (beforeSource)
            beforeSource();
        ArtworkImageView::setImageSource(std::move(source));
    }
    std::function<void()> beforeSource;
};

/// Notes which of the two constraints at its texts' trailing edge hold, whenever that changes.
class WatchedItemCell final : public Cell {
public:
    static std::shared_ptr<WatchedItemCell> make() {
        auto cell = std::make_shared<WatchedItemCell>();
        cell->_initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "id");
        return cell;
    }
    std::vector<std::shared_ptr<NSLayoutConstraint>> _initialConstraints() override {
        auto initial = Cell::_initialConstraints();
        for (const auto& constraint : initial)
            if (constraint->identifier() == "stackViewToTrailingGuide")
                _toGutter = constraint;
        return initial;
    }
    /// Asked for whenever a constraint in here comes or goes.
    bool _isLayoutRoot() const override {
        const std::string holding =
            std::string(_toGutter && _toGutter->isActive() ? "gutter" : "") +
            (holdsToTheEdge() ? "edge" : "");
        if (steps.empty() || steps.back() != holding)
            steps.push_back(holding);
        return Cell::_isLayoutRoot();
    }
    mutable std::vector<std::string> steps;

private:
    [[nodiscard]] bool holdsToTheEdge() const {
        return std::ranges::any_of(constraints(), [](const auto& constraint) {
            return constraint->identifier() == "stackViewToContentGuideTrailing";
        });
    }
    std::shared_ptr<NSLayoutConstraint> _toGutter;
};

class ItemCellContentTest : public testing::CellTest {
protected:
    std::shared_ptr<ArtworkImageView> plain() {
        return find<ArtworkImageView>(cell, "nonVibrantImageView");
    }
    std::shared_ptr<ArtworkImageView> vibrant() {
        return find<ArtworkImageView>(cell, "vibrantArtwork");
    }
    static void expectUnused(const std::shared_ptr<ArtworkImageView>& view) {
        EXPECT_EQ(view->imageSource(), nullptr);
        EXPECT_EQ(view->alpha(), 1);
        EXPECT_TRUE(view->isHidden());
    }

    std::shared_ptr<Cell> cell =
        Cell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "id");
};

TEST_F(ItemCellContentTest, HeightAndColumnWidthAreTheConstantsOfTheirConstraints) {
    EXPECT_EQ(cell->rowHeight(), 110);
    EXPECT_EQ(cell->trailingArtworkColumnWidth(), 0);
    const auto constraints = dumpConstraints(*cell);
    cell->setRowHeight(80);
    cell->setTrailingArtworkColumnWidth(73);
    EXPECT_EQ(active(cell, "rowHeight")->constant(), 80);
    EXPECT_EQ(active(cell, "trailingArtworkColumnWidth")->constant(), 73);
    active(cell, "rowHeight")->setConstant(81);
    active(cell, "trailingArtworkColumnWidth")->setConstant(74);
    EXPECT_EQ(cell->rowHeight(), 81);
    EXPECT_EQ(cell->trailingArtworkColumnWidth(), 74);
    cell->setRowHeight(110);
    cell->setTrailingArtworkColumnWidth(0);
    EXPECT_EQ(dumpConstraints(*cell), constraints);
}

TEST_F(ItemCellContentTest, ShowsTheTextsOfItsItem) {
    const auto shown = item();
    cell->setTransitItem(shown);
    EXPECT_EQ(cell->transitItem(), shown);
    EXPECT_EQ(cell->primaryLabel()->text(), "Line 1");
    EXPECT_EQ(cell->secondaryLabel()->text(), "Delays");
    cell->setTransitItem(item({.primary = "Line 2", .secondary = "Closed"}));
    EXPECT_EQ(cell->primaryLabel()->text(), "Line 2");
    EXPECT_EQ(cell->secondaryLabel()->text(), "Closed");
}

TEST_F(ItemCellContentTest, AnEqualItemChangesNothing) {
    const auto source = picture();
    const auto first = item({.source = source});
    cell->setTransitItem(first);
    cell->primaryLabel()->setText("by hand");
    plain()->setImageSource(nullptr);
    cell->setTransitItem(first);
    cell->setTransitItem(item({.source = source}));
    EXPECT_EQ(cell->transitItem(), first);
    EXPECT_EQ(cell->primaryLabel()->text(), "by hand");
    EXPECT_EQ(plain()->imageSource(), nullptr);
}

TEST_F(ItemCellContentTest, NoItemEmptiesTheRow) {
    cell->setTransitItem(nullptr); // as it is
    cell->setTransitItem(item({.source = picture(), .hidden = true}));
    cell->setTransitItem(nullptr);
    EXPECT_EQ(cell->primaryLabel()->text(), std::nullopt);
    EXPECT_EQ(cell->secondaryLabel()->text(), std::nullopt);
    EXPECT_TRUE(cell->secondaryLabel()->isHidden());
    EXPECT_EQ(vibrant()->imageSource(), nullptr);
    EXPECT_EQ(vibrant()->alpha(), 0);
    EXPECT_FALSE(vibrant()->isHidden());
    expectUnused(plain());
    EXPECT_NE(active(cell, "stackViewToTrailingGuide"), nullptr);
}

TEST_F(ItemCellContentTest, DimmedArtworkIsShownInTheVibrantView) {
    const auto source = picture();
    for (const double alpha : {0.0, 0.3, 0.5, 0.999}) {
        cell->setTransitItem(item({.source = source, .alpha = alpha}));
        EXPECT_EQ(vibrant()->imageSource(), source) << alpha;
        EXPECT_EQ(vibrant()->alpha(), alpha);
        EXPECT_FALSE(vibrant()->isHidden());
        expectUnused(plain());
    }
}

TEST_F(ItemCellContentTest, OpaqueArtworkIsShownInItsOwnColours) {
    const auto source = picture();
    for (const double alpha : {1.0, 1.5}) {
        cell->setTransitItem(item({.source = source, .alpha = alpha}));
        EXPECT_EQ(plain()->imageSource(), source) << alpha;
        EXPECT_EQ(plain()->alpha(), alpha);
        EXPECT_FALSE(plain()->isHidden());
        expectUnused(vibrant());
    }
}

TEST_F(ItemCellContentTest, TheOtherArtworkViewIsEmptiedWithEachItem) {
    cell->setTransitItem(item({.source = picture(), .alpha = 0.5}));
    cell->setTransitItem(item({.source = picture()}));
    expectUnused(vibrant());
    EXPECT_FALSE(plain()->isHidden());
    cell->setTransitItem(item({.source = picture(), .alpha = 0.5}));
    expectUnused(plain());
    EXPECT_FALSE(vibrant()->isHidden());
}

TEST_F(ItemCellContentTest, TheOtherArtworkViewIsEmptiedBeforeTheArtworkIsShown) {
    const auto watched = WatchedArtworkView::make();
    find<VisualEffectWrappingView>(cell, "vibrantImageView")->setWrappedView(watched);
    const auto source = picture();
    cell->setTransitItem(item({.source = source}));
    int looks = 0;
    watched->beforeSource = [&] {
        ++looks;
        expectUnused(plain());
        EXPECT_EQ(cell->primaryLabel()->text(), "dimmed") << "the texts are there by then";
        EXPECT_FALSE(cell->secondaryLabel()->isHidden()) << "and are hidden afterwards";
    };
    cell->setTransitItem(
        item({.primary = "dimmed", .secondary = std::nullopt, .source = source, .alpha = 0.5}));
    EXPECT_EQ(looks, 1);
    EXPECT_TRUE(cell->secondaryLabel()->isHidden());
    watched->beforeSource = [&] {
        ++looks;
        expectUnused(plain());
    };
    cell->setTransitItem(item({.source = source}));
    EXPECT_EQ(looks, 2);
    EXPECT_EQ(plain()->imageSource(), source);
}

TEST_F(ItemCellContentTest, AnItemWithoutArtworkShowsNothingInTheVibrantView) {
    cell->setTransitItem(item({.source = picture()}));
    cell->setTransitItem(itemWithoutArtwork());
    EXPECT_EQ(vibrant()->imageSource(), nullptr);
    EXPECT_EQ(vibrant()->alpha(), 0);
    EXPECT_FALSE(vibrant()->isHidden());
    expectUnused(plain());
}

TEST_F(ItemCellContentTest, HiddenArtworkKeepsItsSource) {
    const auto source = picture();
    cell->setTransitItem(item({.source = source, .hidden = true}));
    EXPECT_TRUE(plain()->isHidden());
    EXPECT_EQ(plain()->imageSource(), source);
    expectUnused(vibrant());
    cell->setTransitItem(item({.source = source, .alpha = 0.5, .hidden = true}));
    EXPECT_TRUE(vibrant()->isHidden());
    EXPECT_EQ(vibrant()->imageSource(), source);
    EXPECT_EQ(vibrant()->alpha(), 0.5);
}

TEST_F(ItemCellContentTest, OnlyNilHidesTheTextBelowTheTitle) {
    cell->setTransitItem(item({.secondary = std::nullopt}));
    EXPECT_TRUE(cell->secondaryLabel()->isHidden());
    cell->setTransitItem(item({.secondary = ""}));
    EXPECT_FALSE(cell->secondaryLabel()->isHidden());
    EXPECT_EQ(cell->secondaryLabel()->text(), "");
    // The effect view around it is never hidden itself.
    EXPECT_FALSE(find<UIView>(cell, "vibrancyViewForSecondaryLabel")->isHidden());
}

TEST_F(ItemCellContentTest, TextsRunToTheEdgeWhileTheArtworkIsHidden) {
    const auto check = [&](bool toGutter) {
        EXPECT_EQ(active(cell, "stackViewToTrailingGuide") != nullptr, toGutter);
        const auto other = active(cell, "stackViewToContentGuideTrailing");
        EXPECT_EQ(other == nullptr, toGutter);
        EXPECT_EQ(descriptionOf(other),
                  toGutter ? "(null)"
                           : "stackViewToContentGuideTrailing: stackView.trailing == "
                             "contentGuide.trailing");
    };
    check(true);
    cell->setTransitItem(item({.hidden = true}));
    check(false);
    cell->setTransitItem(item());
    check(true);
}

TEST_F(ItemCellContentTest, OfTheTwoTrailingConstraintsTheGuttersIsSwitchedFirst) {
    const auto watched = WatchedItemCell::make();
    const auto table = UIView::init();
    table->addSubview(watched);
    const auto steps = [&](bool hidden) {
        watched->steps.clear();
        watched->setTransitItem(item({.hidden = hidden}));
        return watched->steps;
    };
    EXPECT_EQ(steps(true), (Names{"gutter", "", "edge"}));
    EXPECT_EQ(steps(false), (Names{"edge", "gutteredge", "gutter"}));
}

} // namespace
} // namespace orvo
