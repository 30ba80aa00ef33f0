#pragma once

#include "platform/foundation/Environment.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIVisualEffectView.h"
#include "platform/uikit/ViewAnimator.h"
#include "platform/uikit/ViewDrawing.h"
#include "platform/uikit/ViewTest.h"
#include "platform/uikit/table/TableDump.h"
#include "platform/uikit/table/UITableView.h"
#include "support/RecordingCanvas.h"
#include "support/TestClock.h"

namespace orvo::testing {

/// A cell with one text that wraps and fills it.
class TextCell final : public UITableViewCell {
public:
    static std::shared_ptr<TextCell> initWithIdentifier(const std::string& identifier) {
        auto cell = std::make_shared<TextCell>();
        cell->_initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, identifier);
        cell->label = UILabel::init();
        cell->label->setFont(UIFont::systemFontOfSize_weight(10, 400));
        cell->label->setNumberOfLines(0);
        cell->label->setTranslatesAutoresizingMaskIntoConstraints(false);
        const auto content = cell->contentView();
        content->addSubview(cell->label);
        const auto& label = cell->label;
        cell->bottom = content->bottomAnchor().constraintEqualToAnchor(label->bottomAnchor());
        NSLayoutConstraint::activateConstraints(
            {label->leadingAnchor().constraintEqualToAnchor(content->leadingAnchor()),
             label->trailingAnchor().constraintEqualToAnchor(content->trailingAnchor()),
             label->topAnchor().constraintEqualToAnchor(content->topAnchor()),
             cell->bottom});
        return cell;
    }
    void prepareForReuse() override {
        UITableViewCell::prepareForReuse();
        ++reuses;
    }
    std::string className() const override { return "TextCell"; }

    std::shared_ptr<UILabel> label;
    std::shared_ptr<NSLayoutConstraint> bottom;
    int reuses = 0;
};

/// Texts by section. Writes down what it is asked.
class TextSource final : public UITableViewDataSource, public UITableViewDelegate {
public:
    std::vector<std::vector<std::string>> sections;
    std::vector<std::string> asked;
    std::optional<CGFloat> estimate;
    std::map<std::int64_t, CGFloat> heights;
    std::set<std::int64_t> dead; ///< rows that do not highlight
    std::set<std::int64_t> bare; ///< rows without a separator
    bool deselects = false;

    std::optional<std::int64_t>
    numberOfSectionsInTableView(const std::shared_ptr<UITableView>&) override {
        return static_cast<std::int64_t>(sections.size());
    }
    std::int64_t tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                 std::int64_t section) override {
        return static_cast<std::int64_t>(sections.at(static_cast<std::size_t>(section)).size());
    }
    std::shared_ptr<UITableViewCell>
    tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& table,
                                    const std::shared_ptr<NSIndexPath>& path) override {
        asked.push_back("cell " + name(*path));
        const auto cell = std::dynamic_pointer_cast<TextCell>(
            table->dequeueReusableCellWithIdentifier_forIndexPath("text", path));
        cell->label->setText(sections.at(static_cast<std::size_t>(path->section()))
                                 .at(static_cast<std::size_t>(path->row())));
        cell->setSeparatorStyleOverride(bare.contains(path->row())
                                            ? UITableViewCellSeparatorStyle::None
                                            : UITableViewCellSeparatorStyle::SingleLine);
        return cell;
    }
    std::optional<CGFloat>
    tableView_heightForRowAtIndexPath(const std::shared_ptr<UITableView>&,
                                      const std::shared_ptr<NSIndexPath>& path) override {
        const auto found = heights.find(path->row());
        return found == heights.end() ? std::nullopt : std::optional(found->second);
    }
    std::optional<CGFloat>
    tableView_estimatedHeightForRowAtIndexPath(const std::shared_ptr<UITableView>&,
                                               const std::shared_ptr<NSIndexPath>&) override {
        return estimate;
    }
    std::optional<bool>
    tableView_shouldHighlightRowAtIndexPath(const std::shared_ptr<UITableView>&,
                                            const std::shared_ptr<NSIndexPath>& path) override {
        return !dead.contains(path->row());
    }
    void tableView_didSelectRowAtIndexPath(const std::shared_ptr<UITableView>& table,
                                           const std::shared_ptr<NSIndexPath>& path) override {
        asked.push_back("select " + name(*path));
        if (deselects)
            table->deselectRowAtIndexPath_animated(path, true);
    }

    static std::string name(const NSIndexPath& path) {
        return std::to_string(path.section()) + "-" + std::to_string(path.row());
    }
};

/// A table 100 wide whose rows are 10 high for each line of 20 characters.
class TableTest : public ViewTest {
protected:
    explicit TableTest(CGFloat height = 50)
        : table(
              UITableView::initWithFrame_style({{0, 0}, {100, height}}, UITableViewStyle::Plain)) {
        card->addSubview(table);
        table->registerClass_forCellReuseIdentifier(
            [this](UITableViewCellStyle, const std::string& identifier) {
                ++made;
                return TextCell::initWithIdentifier(identifier);
            },
            "text");
        table->setDataSource(source);
        table->setDelegate(source);
        table->setTableFooterView(UIView::init());
    }

    static std::vector<std::string> rows(std::size_t count) {
        std::vector<std::string> texts;
        for (std::size_t i = 0; i < count; ++i)
            texts.push_back("row " + std::to_string(i));
        return texts;
    }
    static std::shared_ptr<NSIndexPath> path(std::int64_t row, std::int64_t section = 0) {
        return NSIndexPath::indexPathForRow_inSection(row, section);
    }
    std::string shown() {
        card->layoutIfNeeded();
        return "\n" + dumpTable(*table);
    }
    std::vector<std::string> texts() {
        card->layoutIfNeeded();
        std::vector<std::string> all;
        for (const auto& cell : table->visibleCells())
            all.push_back(dynamic_cast<const TextCell&>(*cell).label->text().value_or("(nil)"));
        return all;
    }
    std::vector<std::string> draw(double scale = 1) {
        card->layoutIfNeeded();
        RecordingCanvas canvas(scale);
        drawViewHierarchy(*card, canvas);
        return canvas.drawn;
    }
    /// Frames come when the test says so.
    void withFrames() {
        animator->setFrameRequest([] {});
    }
    void advance(double seconds) {
        clock->advance(seconds);
        animator->advance();
    }

    std::shared_ptr<TextSource> source = std::make_shared<TextSource>();
    std::shared_ptr<UIView> card = root(100, 200);
    std::shared_ptr<UITableView> table;
    int made = 0;

private:
    std::shared_ptr<ManualMonotonicClock> clock = std::make_shared<ManualMonotonicClock>();
    std::shared_ptr<ViewAnimator> animator = std::make_shared<ViewAnimator>();
    EnvironmentSlot<std::shared_ptr<MonotonicClock>>::Override _clock =
        Environment::monotonicClock().overrideWith(clock);
    EnvironmentSlot<std::shared_ptr<ViewAnimator>>::Override _animator =
        ViewAnimator::shared().overrideWith(animator);
};

} // namespace orvo::testing
