#include "presentation/OWTransitItemFixedHeightCell.h"

#include "CellTest.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/mapuikit/ArtworkImageView.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/uikit/UIStackView.h"
#include "presentation/DynamicTypeWizard.h"
#include "presentation/VisualEffectWrappingView.h"

namespace orvo {
namespace {

using Cell = OWTransitItemFixedHeightCell;
using Constraints = std::vector<std::shared_ptr<NSLayoutConstraint>>;

/// Notes what happens while it is made.
class RecordingCell final : public Cell {
public:
    static std::shared_ptr<RecordingCell> make() {
        auto cell = std::make_shared<RecordingCell>();
        cell->setIdentifier("cell");
        return cell->_initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "id") ? cell
                                                                                         : nullptr;
    }
    void _createSubviews() override {
        steps.push_back(contentView() ? "create after super" : "create");
        Cell::_createSubviews();
        steps.push_back("created");
    }
    Constraints _initialConstraints() override {
        initial = Cell::_initialConstraints();
        for (const auto& constraint : initial)
            if (constraint->isActive())
                steps.push_back("active before its time");
        steps.push_back("constraints");
        return initial;
    }
    std::vector<std::string> steps;
    Constraints initial;
};

class ItemCellTest : public testing::CellTest {
protected:
    std::shared_ptr<NSString> registeredIn(std::uint64_t phase) {
        const auto map = std::dynamic_pointer_cast<NSMapTable>(
            DynamicTypeWizard::_singletonInstance()->objectToSelectorStringMaps()->objectForKey(
                *NSNumber::numberWithUnsignedInteger(phase)));
        return std::dynamic_pointer_cast<NSString>(map->objectForKey(cell));
    }
    std::shared_ptr<RecordingCell> cell = RecordingCell::make();
};

// Creation

TEST_F(ItemCellTest, IsMadeAsOneOfTheKitsCells) {
    const auto made = Cell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "reuse");
    EXPECT_NE(dynamic_cast<KitTableViewCell*>(made.get()), nullptr);
    EXPECT_EQ(made->reuseIdentifier(), "reuse");
    EXPECT_EQ(made->className(), "OWTransitItemFixedHeightCell");
    EXPECT_EQ(made->transitItem(), nullptr);
    EXPECT_EQ(made->primaryLabel()->className(), "KitLabel");
    EXPECT_EQ(made->secondaryLabel()->className(), "KitLabel");
}

TEST_F(ItemCellTest, MakesItsViewsThenActivatesItsConstraints) {
    EXPECT_EQ(cell->steps, (Names{"create after super", "created", "constraints"}));
    for (const auto& constraint : cell->initial)
        EXPECT_TRUE(constraint->isActive()) << constraint->description();
}

TEST_F(ItemCellTest, ViewsLieInThisOrderWithoutFrames) {
    EXPECT_EQ("\n" + dumpViews(*cell), R"(
cell 0 0 0 0
  (contentGuide 0 0 0 0)
  contentView 0 0 0 0
    (trailingGutterGuide 0 0 0 0)
    stackView 0 0 0 0
      vibrancyViewForPrimaryLabel 0 0 0 0
        UIView2 0 0 0 0
          primaryLabel 0 0 0 0
      vibrancyViewForSecondaryLabel 0 0 0 0
        UIView3 0 0 0 0
          secondaryLabel 0 0 0 0
    nonVibrantImageView 0 0 0 0
    vibrantImageView 0 0 0 0
      UIView4 0 0 0 0
        vibrantArtwork 0 0 0 0
)");
}

TEST_F(ItemCellTest, ViewsAndGuidesAreMadeInThisOrder) {
    std::uint64_t last = 0;
    for (const auto* name : {"contentGuide",
                             "stackView",
                             "vibrancyViewForPrimaryLabel",
                             "primaryLabel",
                             "vibrancyViewForSecondaryLabel",
                             "secondaryLabel",
                             "trailingGutterGuide",
                             "nonVibrantImageView",
                             "vibrantImageView",
                             "vibrantArtwork"}) {
        const auto number = find(cell, name)->_creationNumber();
        EXPECT_GT(number, last) << name;
        last = number;
    }
}

TEST_F(ItemCellTest, GuidesBelongToTheCellAndToItsContentView) {
    EXPECT_EQ(find<UILayoutGuide>(cell, "contentGuide")->owningView(), cell);
    EXPECT_EQ(find<UILayoutGuide>(cell, "trailingGutterGuide")->owningView(), cell->contentView());
}

TEST_F(ItemCellTest, ViewsThatAreConstrainedHaveNoFramesOfTheirOwn) {
    for (const auto* name : {"stackView",
                             "vibrancyViewForPrimaryLabel",
                             "primaryLabel",
                             "vibrancyViewForSecondaryLabel",
                             "secondaryLabel",
                             "nonVibrantImageView",
                             "vibrantImageView",
                             "vibrantArtwork"})
        EXPECT_FALSE(find<UIView>(cell, name)->translatesAutoresizingMaskIntoConstraints()) << name;
}

TEST_F(ItemCellTest, TextsStandInAColumnByTheirBaselines) {
    const auto stack = find<UIStackView>(cell, "stackView");
    EXPECT_EQ(stack->axis(), UILayoutConstraintAxis::Vertical);
    EXPECT_TRUE(stack->isBaselineRelativeArrangement());
    EXPECT_EQ(stack->distribution(), UIStackViewDistribution::Fill);
    EXPECT_EQ(stack->alignment(), UIStackViewAlignment::Fill);
    EXPECT_EQ(stack->superview(), cell->contentView());
    EXPECT_EQ(stack->arrangedSubviews(),
              (std::vector<std::shared_ptr<UIView>>{
                  find<UIView>(cell, "vibrancyViewForPrimaryLabel"),
                  find<UIView>(cell, "vibrancyViewForSecondaryLabel")}));
}

TEST_F(ItemCellTest, VibrancyIsThatOfPrimaryAndSecondaryTexts) {
    const auto check =
        [&](const char* name, std::int64_t style, const std::shared_ptr<UIView>& of) {
            const auto view = find<VisualEffectWrappingView>(cell, name);
            EXPECT_EQ(view->effect()->style(), style) << name;
            EXPECT_EQ(view->wrappedView(), of) << name;
        };
    check("vibrancyViewForPrimaryLabel", 101, cell->primaryLabel());
    check("vibrancyViewForSecondaryLabel", 102, cell->secondaryLabel());
    check("vibrantImageView", 102, find<ArtworkImageView>(cell, "vibrantArtwork"));
}

TEST_F(ItemCellTest, TextsHaveAsManyLinesAsTheyNeedWhileThereIsRoom) {
    constexpr auto Vertical = UILayoutConstraintAxis::Vertical;
    EXPECT_EQ(cell->primaryLabel()->numberOfLines(), 0);
    EXPECT_EQ(cell->secondaryLabel()->numberOfLines(), 0);
    EXPECT_EQ(cell->primaryLabel()->contentCompressionResistancePriorityForAxis(Vertical), 749);
    EXPECT_EQ(cell->secondaryLabel()->contentCompressionResistancePriorityForAxis(Vertical), 748);
}

TEST_F(ItemCellTest, InitialConstraintsAreTheseInThisOrder) {
    EXPECT_EQ(textOf(cell->initial), R"(
rowHeight: contentView.height == 110
contentGuide.centerY == contentView.centerY
contentGuide.leading == contentView.leading
contentGuide.trailing == contentView.trailing
contentGuide.top >= contentView.top
contentGuide.bottom <= contentView.bottom
trailingGutterGuide.top == contentGuide.top
trailingGutterGuide.bottom == contentGuide.bottom
trailingGutterGuide.trailing == contentGuide.trailing
trailingArtworkColumnWidth: trailingGutterGuide.width == 0
primaryLabel.top >= contentView.top
primaryLabelToContentGuide: primaryLabel.firstBaseline == contentGuide.top + 12 @750
contentGuide.bottom == stackView.lastBaseline
stackView.leading == contentGuide.leading
stackViewToTrailingGuide: stackView.trailing == trailingGutterGuide.leading
vibrantImageView.trailing == trailingGutterGuide.trailing
vibrantImageView.centerY == contentGuide.centerY
vibrantImageView.top >= contentView.top + 8
vibrantImageView.bottom <= contentView.bottom - 8
vibrantImageView.trailing == nonVibrantImageView.trailing
vibrantImageView.leading == nonVibrantImageView.leading
vibrantImageView.top == nonVibrantImageView.top
vibrantImageView.bottom == nonVibrantImageView.bottom
)");
    EXPECT_EQ(cell->initial.size(), 23U);
    EXPECT_EQ(active(cell, "stackViewToContentGuideTrailing"), nullptr);
}

TEST_F(ItemCellTest, ConstraintsThatHoldAreTheseInThisOrder) {
    EXPECT_EQ("\n" + dumpConstraints(*cell), R"(
contentGuide.centerY == contentView.centerY
contentGuide.leading == contentView.leading
contentGuide.trailing == contentView.trailing
contentGuide.top >= contentView.top
contentGuide.bottom <= contentView.bottom
trailingGutterGuide.top == contentGuide.top
trailingGutterGuide.bottom == contentGuide.bottom
trailingGutterGuide.trailing == contentGuide.trailing
primaryLabelToContentGuide: primaryLabel.firstBaseline == contentGuide.top + 12 @750
contentGuide.bottom == stackView.lastBaseline
stackView.leading == contentGuide.leading
vibrantImageView.centerY == contentGuide.centerY
rowHeight: contentView.height == 110
trailingArtworkColumnWidth: trailingGutterGuide.width == 0
primaryLabel.top >= contentView.top
stackViewToTrailingGuide: stackView.trailing == trailingGutterGuide.leading
vibrantImageView.trailing == trailingGutterGuide.trailing
vibrantImageView.top >= contentView.top + 8
vibrantImageView.bottom <= contentView.bottom - 8
vibrantImageView.trailing == nonVibrantImageView.trailing
vibrantImageView.leading == nonVibrantImageView.leading
vibrantImageView.top == nonVibrantImageView.top
vibrantImageView.bottom == nonVibrantImageView.bottom
vibrancyViewForPrimaryLabel.top == stackView.top
vibrancyViewForPrimaryLabel.leading == stackView.leading
vibrancyViewForPrimaryLabel.trailing == stackView.trailing
vibrancyViewForSecondaryLabel.firstBaseline == vibrancyViewForPrimaryLabel.lastBaseline + 21
vibrancyViewForSecondaryLabel.leading == stackView.leading
vibrancyViewForSecondaryLabel.trailing == stackView.trailing
vibrancyViewForSecondaryLabel.bottom == stackView.bottom
primaryLabel.leading == vibrancyViewForPrimaryLabel.leading
primaryLabel.trailing == vibrancyViewForPrimaryLabel.trailing
primaryLabel.top == vibrancyViewForPrimaryLabel.top
primaryLabel.bottom == vibrancyViewForPrimaryLabel.bottom
secondaryLabel.leading == vibrancyViewForSecondaryLabel.leading
secondaryLabel.trailing == vibrancyViewForSecondaryLabel.trailing
secondaryLabel.top == vibrancyViewForSecondaryLabel.top
secondaryLabel.bottom == vibrancyViewForSecondaryLabel.bottom
vibrantArtwork.leading == vibrantImageView.leading
vibrantArtwork.trailing == vibrantImageView.trailing
vibrantArtwork.top == vibrantImageView.top
vibrantArtwork.bottom == vibrantImageView.bottom
)");
}

// Dynamic type

TEST_F(ItemCellTest, TitleIsABoldHeadlineAboveASubheadline) {
    const auto title = cell->_primaryFont()->fontDescriptor();
    EXPECT_EQ(title->textStyle(), UIFontTextStyleHeadline);
    EXPECT_EQ(title->symbolicTraits(), 2U);
    EXPECT_EQ(title->pointSize(), 17);
    const auto below = cell->_secondaryFont()->fontDescriptor();
    EXPECT_EQ(below->textStyle(), UIFontTextStyleSubheadline);
    EXPECT_EQ(below->symbolicTraits(), 0U);
    EXPECT_EQ(below->pointSize(), 15);
    EXPECT_TRUE(equal(cell->primaryLabel()->font(), cell->_primaryFont()));
    EXPECT_TRUE(equal(cell->secondaryLabel()->font(), cell->_secondaryFont()));
}

TEST_F(ItemCellTest, FontsSpacingAndOffsetFollowTheTextSize) {
    const auto stack = find<UIStackView>(cell, "stackView");
    EXPECT_EQ(stack->spacing(), 21);
    const auto check =
        [&](UIContentSizeCategory size, double title, double below, double spacing, double offset) {
            changeSize(size);
            EXPECT_EQ(cell->primaryLabel()->font()->pointSize(), title);
            EXPECT_EQ(cell->primaryLabel()->font()->fontDescriptor()->symbolicTraits(), 2U);
            EXPECT_EQ(cell->secondaryLabel()->font()->pointSize(), below);
            EXPECT_EQ(stack->spacing(), spacing);
            EXPECT_EQ(active(cell, "primaryLabelToContentGuide")->constant(), offset);
        };
    check(UIContentSizeCategory::XS, 14, 12, 17, 10);
    check(UIContentSizeCategory::AX5, 53, 49, 65, 37);
    check(UIContentSizeCategory::L, 17, 15, 21, 12);
}

TEST_F(ItemCellTest, OffsetIsUpdatedAfterFontsByItsMisspeltName) {
    EXPECT_EQ(registeredIn(0), nullptr);
    EXPECT_EQ(registeredIn(2), nullptr);
    EXPECT_EQ(stringValue(registeredIn(1).get()), "_updatePrimaryLabelToContentGuideConstaint");
    active(cell, "primaryLabelToContentGuide")->setConstant(99);
    (void)cell->performSelector(Selector("_updatePrimaryLabelToContentGuideConstaint"));
    EXPECT_EQ(active(cell, "primaryLabelToContentGuide")->constant(), 12);
    EXPECT_FALSE(cell->respondsToSelector(Selector("_updatePrimaryLabelToContentGuideConstraint")));
}

/// Capitals of 15.3 points.
class TallCapitals final : public TextMeasurer {
public:
    FontMetrics metricsOf(const FontFace&) override { return {16, -4, 15.3, 0}; }
    std::vector<double> advances(const std::string&,
                                 std::span<const TextRun>,
                                 std::span<const std::size_t> clusters,
                                 bool) override {
        return std::vector<double>(clusters.size(), 5);
    }
};

TEST_F(ItemCellTest, OffsetIsTheHeightOfCapitalsInWholePixels) {
    const auto measurer = TextMeasurer::shared().overrideWith(std::make_shared<TallCapitals>());
    cell->primaryLabel()->setFont(UIFont::systemFontOfSize_weight(20, 400));
    const auto offsetAt = [&](double scale) {
        cell->setTraitCollection(UITraitCollection{.displayScale = scale});
        cell->_updatePrimaryLabelToContentGuideConstaint();
        return active(cell, "primaryLabelToContentGuide")->constant();
    };
    EXPECT_EQ(offsetAt(1), 15);
    EXPECT_EQ(offsetAt(2), 15.5);
    EXPECT_NEAR(offsetAt(3), 46.0 / 3, 1e-9);
}

TEST_F(ItemCellTest, WithoutAFontThereIsNoOffset) {
    cell->primaryLabel()->setFont(nullptr);
    cell->_updatePrimaryLabelToContentGuideConstaint();
    EXPECT_EQ(active(cell, "primaryLabelToContentGuide")->constant(), 0);
}

TEST_F(ItemCellTest, RegistrationsDoNotKeepTheCell) {
    const auto label = cell->primaryLabel();
    const auto stack = find<UIStackView>(cell, "stackView");
    const std::weak_ptr<Cell> weak = cell;
    cell.reset();
    EXPECT_TRUE(weak.expired());
    changeSize(UIContentSizeCategory::AX5);
    EXPECT_EQ(label->font(), nullptr); // nobody is left to say which
    EXPECT_EQ(stack->spacing(), 21);
}

} // namespace
} // namespace orvo
