#include "KitViewTest.h"
#include "platform/mapuikit/ArtworkImageView.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/mapuikit/KitTableViewCell.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/mapuikit/TransitInfoLabelView.h"
#include "platform/uikit/table/UITableView.h"

namespace orvo {
namespace {

/// A title, a shield at its right, and a row of shields under it.
class LineCell final : public KitTableViewCell {
public:
    static std::shared_ptr<LineCell> make(const std::string& identifier) {
        auto cell = std::make_shared<LineCell>();
        cell->_initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, identifier);
        const auto content = cell->contentView();
        const auto put = [&](const std::shared_ptr<UIView>& view, CGFloat left, CGFloat top) {
            view->setTranslatesAutoresizingMaskIntoConstraints(false);
            content->addSubview(view);
            NSLayoutConstraint::activateConstraints(
                {view->leadingAnchor().constraintEqualToAnchor_constant(content->leadingAnchor(),
                                                                        left),
                 view->topAnchor().constraintEqualToAnchor_constant(content->topAnchor(), top)});
        };
        put(cell->title, 0, 0);
        put(cell->shield, 200, 0);
        put(cell->row, 0, 30);
        content->heightAnchor().constraintEqualToConstant(110)->setActive(true);
        return cell;
    }
    void layoutSubviews() override {
        KitTableViewCell::layoutSubviews();
        row->setMaxWidth_textForTruncationGenerator(
            60, [](std::uint64_t leftOut) { return "+" + std::to_string(leftOut); });
    }

    std::shared_ptr<KitLabel> title = KitLabel::init();
    std::shared_ptr<ArtworkImageView> shield = ArtworkImageView::init();
    std::shared_ptr<TransitInfoLabelView> row =
        TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
            nullptr, 7, 7, 5, TransitInfoLabelViewNoMaximumWidth);
};

class Lines final : public UITableViewDataSource {
public:
    std::shared_ptr<ArtworkDataSourceCache> cache;

    std::int64_t tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                 std::int64_t) override {
        return 5;
    }
    std::shared_ptr<UITableViewCell>
    tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& table,
                                    const std::shared_ptr<NSIndexPath>& path) override {
        const auto cell = std::dynamic_pointer_cast<LineCell>(
            table->dequeueReusableCellWithIdentifier_forIndexPath("line", path));
        const auto name = std::to_string(path->row());
        cell->title->setText("Line " + name);
        cell->shield->setImageSource(SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
            testing::shieldArtwork(name), 3, cache));
        cell->row->setArtworkCache(cache);
        cell->row->setLabelItems(NSArray::arrayOf({testing::shieldArtwork(name),
                                                   testing::shieldArtwork("a"),
                                                   testing::shieldArtwork("b"),
                                                   testing::shieldArtwork("c")}));
        return cell;
    }
};

class KitTableTest : public testing::KitViewTest {
protected:
    KitTableTest() {
        lines->cache = cache;
        card->addSubview(table);
        table->registerClass_forCellReuseIdentifier(
            [](UITableViewCellStyle, const std::string& identifier) {
                return LineCell::make(identifier);
            },
            "line");
        table->setDataSource(lines);
    }

    std::shared_ptr<Lines> lines = std::make_shared<Lines>();
    std::shared_ptr<UIView> card = root(300, 600);
    std::shared_ptr<UITableView> table =
        UITableView::initWithFrame_style({{0, 0}, {300, 600}}, UITableViewStyle::Plain);
};

TEST_F(KitTableTest, UnchangedTableAsksForNoArtworkAndMeasuresNoText) {
    draw(card);
    const auto asked = cache->asked.size();
    const auto measured = measurer->measured;
    card->layoutIfNeeded();
    EXPECT_FALSE(card->_needsDisplay());
    EXPECT_EQ(cache->asked.size(), asked);
    EXPECT_EQ(measurer->measured, measured);
}

TEST_F(KitTableTest, ReloadOfTheSameRowsAsksForNoArtworkAndMeasuresNoText) {
    draw(card);
    const auto asked = cache->asked.size();
    const auto measured = measurer->measured;
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    EXPECT_FALSE(card->_needsDisplay());
    EXPECT_EQ(cache->asked.size(), asked);
    EXPECT_EQ(measurer->measured, measured);
    EXPECT_TRUE(log.messages().empty());
}

} // namespace
} // namespace orvo
