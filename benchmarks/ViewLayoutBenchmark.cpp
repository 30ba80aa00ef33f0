// Layout of rows like the widget's, texts of fixed sizes: built and laid out for the first time,
// at another width, and after one constant has changed. Rows are layout roots, so that time should
// be linear in their number.

#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIStackView.h"
#include "platform/uikit/_LayoutEngine.h"

#include <benchmark/benchmark.h>

namespace {

using namespace orvo;

class EvenText final : public TextMeasurer {
public:
    FontMetrics metricsOf(const FontFace& face) override {
        return {.ascender = 0.9 * face.pointSize,
                .descender = -0.3 * face.pointSize,
                .capHeight = 0.7 * face.pointSize};
    }
    std::vector<double> advances(const std::string&,
                                 std::span<const TextRun> runs,
                                 std::span<const std::size_t> clusters,
                                 bool) override {
        return std::vector<double>(clusters.size(), 0.5 * runs.front().face.pointSize);
    }
};

class Row final : public UIView {
public:
    static constexpr CGFloat Height = 110;

    bool _isLayoutRoot() const override { return true; }

    void build() {
        const auto stack = add(UIStackView::init());
        stack->setAxis(UILayoutConstraintAxis::Vertical);
        stack->setBaselineRelativeArrangement(true);
        stack->setSpacing(21);
        const auto title = text("Green Line D", 17);
        const auto body =
            text("Delays of up to fifteen minutes between Park Street and Kenmore", 15);
        stack->addArrangedSubview(title);
        stack->addArrangedSubview(body);
        const auto artwork = add(UIView::init());
        const auto guide = UILayoutGuide::init();
        addLayoutGuide(guide);
        column = artwork->widthAnchor().constraintEqualToConstant(73);
        const auto capTop =
            title->firstBaselineAnchor().constraintEqualToAnchor_constant(guide->topAnchor(), 12);
        capTop->setPriority(UILayoutPriorityDefaultHigh);
        NSLayoutConstraint::activateConstraints(
            {heightAnchor().constraintEqualToConstant(Height),
             guide->centerYAnchor().constraintEqualToAnchor(centerYAnchor()),
             guide->leadingAnchor().constraintEqualToAnchor(leadingAnchor()),
             guide->trailingAnchor().constraintEqualToAnchor(trailingAnchor()),
             guide->topAnchor().constraintGreaterThanOrEqualToAnchor(topAnchor()),
             guide->bottomAnchor().constraintLessThanOrEqualToAnchor(bottomAnchor()),
             title->topAnchor().constraintGreaterThanOrEqualToAnchor(topAnchor()),
             capTop,
             guide->bottomAnchor().constraintEqualToAnchor(stack->lastBaselineAnchor()),
             stack->leadingAnchor().constraintEqualToAnchor(guide->leadingAnchor()),
             stack->trailingAnchor().constraintEqualToAnchor(artwork->leadingAnchor()),
             artwork->trailingAnchor().constraintEqualToAnchor(guide->trailingAnchor()),
             artwork->centerYAnchor().constraintEqualToAnchor(guide->centerYAnchor()),
             artwork->heightAnchor().constraintEqualToConstant(28),
             column});
    }

    std::shared_ptr<NSLayoutConstraint> column;

private:
    template <class View>
    std::shared_ptr<View> add(std::shared_ptr<View> view) {
        view->setTranslatesAutoresizingMaskIntoConstraints(false);
        addSubview(view);
        return view;
    }
    static std::shared_ptr<UILabel> text(const char* content, double size) {
        auto label = UILabel::init();
        label->setFont(UIFont::systemFontOfSize_weight(size, 400));
        label->setNumberOfLines(0);
        label->setText(content);
        return label;
    }
};

std::vector<std::shared_ptr<Row>> makeRows(std::int64_t count) {
    std::vector<std::shared_ptr<Row>> rows;
    for (std::int64_t i = 0; i < count; ++i) {
        const auto& row = rows.emplace_back(std::make_shared<Row>());
        row->setFrame({{0, 0}, {327, Row::Height}});
        row->build();
    }
    return rows;
}

std::vector<std::shared_ptr<Row>> makeLaidOutRows(std::int64_t count) {
    auto rows = makeRows(count);
    for (const auto& row : rows)
        row->layoutIfNeeded();
    return rows;
}

void useEvenText() {
    TextMeasurer::shared().set(std::make_shared<EvenText>());
}

void perRow(benchmark::State& state) {
    state.counters["per_row"] =
        benchmark::Counter(static_cast<double>(state.iterations() * state.range(0)),
                           benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

void buildAndLayOut(benchmark::State& state) {
    useEvenText();
    for (auto _ : state) {
        for (const auto& row : makeRows(state.range(0)))
            row->layoutIfNeeded();
    }
    perRow(state);
}

void layOutAtAnotherWidth(benchmark::State& state) {
    useEvenText();
    const auto rows = makeLaidOutRows(state.range(0));
    CGFloat width = 300;
    for (auto _ : state) {
        width = width > 320 ? 300 : width + 1;
        for (const auto& row : rows) {
            row->setFrame({{0, 0}, {width, Row::Height}});
            row->layoutIfNeeded();
        }
    }
    perRow(state);
}

void changeOneConstant(benchmark::State& state) {
    useEvenText();
    const auto row = makeLaidOutRows(1).front();
    CGFloat width = 73;
    for (auto _ : state) {
        width = width > 73 ? 73 : 74;
        row->column->setConstant(width);
        row->_layoutEngine().solve();
    }
}

void layOutUnchanged(benchmark::State& state) {
    useEvenText();
    const auto rows = makeLaidOutRows(state.range(0));
    for (auto _ : state) {
        for (const auto& row : rows)
            row->layoutIfNeeded();
    }
    perRow(state);
}

BENCHMARK(buildAndLayOut)->Arg(1)->Arg(8)->Arg(100);
BENCHMARK(layOutAtAnotherWidth)->Arg(1)->Arg(8)->Arg(100);
BENCHMARK(layOutUnchanged)->Arg(8)->Arg(100);
BENCHMARK(changeOneConstant);

} // namespace
