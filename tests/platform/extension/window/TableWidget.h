#pragma once

#include "platform/extension/WidgetCard.h"
#include "platform/extension/WidgetHost.h"
#include "platform/foundation/RunLoop.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIViewController.h"
#include "platform/uikit/table/UITableView.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo::testing {

using Mode = NCWidgetDisplayMode;

/// A widget with a table of rows, each 110 points high: the first one, or all where it is expanded.
/// It notes what is pressed.
class TableWidget final : public UIViewController,
                          public NCWidgetProviding,
                          public UITableViewDataSource,
                          public UITableViewDelegate {
public:
    static constexpr CGFloat RowHeight = 110;

    void viewDidLoad() override {
        table = UITableView::initWithFrame_style(view()->bounds(), UITableViewStyle::Plain);
        table->registerClass_forCellReuseIdentifier(
            [](UITableViewCellStyle style, const std::string& identifier) {
                return UITableViewCell::initWithStyle_reuseIdentifier(style, identifier);
            },
            "row");
        table->setRowHeight(RowHeight);
        table->setTableFooterView(UIView::init());
        const auto self = strong(this);
        table->setDataSource(self);
        table->setDelegate(self);
        view()->addSubview(table);
        table->setTranslatesAutoresizingMaskIntoConstraints(false);
        for (const auto& constraint :
             {table->topAnchor().constraintEqualToAnchor(view()->topAnchor()),
              table->bottomAnchor().constraintEqualToAnchor(view()->bottomAnchor()),
              table->leftAnchor().constraintEqualToAnchor(view()->leftAnchor()),
              table->rightAnchor().constraintEqualToAnchor(view()->rightAnchor())})
            constraint->setActive(true);
        prefer();
    }
    void viewWillAppear(bool) override {
        appearances += 1;
        offer();
    }
    void viewWillDisappear(bool) override { disappearances += 1; }
    void didReceiveMemoryWarning() override { memoryWarnings += 1; }
    void widgetPerformUpdateWithCompletionHandler(UpdateHandler handler) override {
        handlers.push_back(std::move(handler));
    }
    void widgetActiveDisplayModeDidChange_withMaximumSize(Mode, CGSize) override { reload(); }

    void show(std::vector<std::string> titles) {
        rows = std::move(titles);
        if (isViewLoaded())
            reload();
    }
    void reload() {
        table->reloadData();
        offer();
        prefer();
    }
    void offer() {
        extensionContext()->setWidgetLargestAvailableDisplayMode(rows.size() > 1 ? Mode::Expanded
                                                                                 : Mode::Compact);
    }
    void prefer() {
        setPreferredContentSize(
            {view()->frame().size.width, RowHeight * static_cast<CGFloat>(rowCount())});
    }
    std::int64_t rowCount() const {
        const bool expanded = extensionContext()->widgetActiveDisplayMode() == Mode::Expanded;
        return expanded || rows.empty() ? static_cast<std::int64_t>(rows.size()) : 1;
    }

    std::int64_t tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                 std::int64_t) override {
        return rowCount();
    }
    std::shared_ptr<UITableViewCell>
    tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                    const std::shared_ptr<NSIndexPath>& path) override {
        auto cell = tableView->dequeueReusableCellWithIdentifier_forIndexPath("row", path);
        const auto& title = rows.at(static_cast<std::size_t>(path->row()));
        cell->setAccessibilityLabel(title + " spoken");
        const auto label = UILabel::initWithFrame({{16, 40}, {300, 20}});
        label->setText(title);
        cell->contentView()->addSubview(label);
        return cell;
    }
    std::optional<bool>
    tableView_shouldHighlightRowAtIndexPath(const std::shared_ptr<UITableView>&,
                                            const std::shared_ptr<NSIndexPath>& path) override {
        return rows.at(static_cast<std::size_t>(path->row())) != "dead";
    }
    void tableView_didSelectRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                           const std::shared_ptr<NSIndexPath>& path) override {
        pressed.push_back(rows.at(static_cast<std::size_t>(path->row())));
        tableView->deselectRowAtIndexPath_animated(path, false);
    }

    std::shared_ptr<UITableView> table;
    std::vector<std::string> rows{"red", "green", "blue"};
    std::vector<std::string> pressed;
    std::vector<UpdateHandler> handlers;
    int appearances = 0;
    int disappearances = 0;
    int memoryWarnings = 0;
};

/// A profile, stopped clocks, and a host with a table.
struct TableWorld {
    explicit TableWorld(const WidgetHostSettings& settings = {})
        : host(
              WidgetHost::hostWithExtension_settings(Extension({.bundleIdentifier = "a.widget",
                                                                .containingApplication = "a.map",
                                                                .displayName = "A Widget",
                                                                .principalClass = "TableWidget",
                                                                .iconName = "WidgetGenericTransit"},
                                                               [this] { return widget; }),
                                                     settings)) {}

    static void turn() { RunLoop::main().runOnce(); }

    TemporaryProfile profile;
    StoppedClock clock;
    std::shared_ptr<ManualMonotonicClock> monotonic = std::make_shared<ManualMonotonicClock>();
    EnvironmentSlot<std::shared_ptr<MonotonicClock>>::Override monotonicClock =
        Environment::monotonicClock().overrideWith(monotonic);
    EnvironmentSlot<UITraitCollection>::Override traits =
        UITraitCollection::system().overrideWith({});
    std::shared_ptr<TableWidget> widget = std::make_shared<TableWidget>();
    std::shared_ptr<WidgetHost> host;
};

} // namespace orvo::testing
