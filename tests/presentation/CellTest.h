#pragma once

#include "platform/foundation/NSNotificationCenter.h"
#include "platform/uikit/UIContentSizeCategory.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/ViewDumps.h"
#include "platform/uikit/table/UITableViewCell.h"
#include "support/FixedTextMeasurer.h"
#include "support/LogCapture.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <vector>

namespace orvo::testing {

/// Cells with texts of fixed numbers: at 10 points, characters are 5 wide, lines 10 high with the
/// baseline at 8, and capitals 7 high. A pixel is a point, until the test says otherwise.
class CellTest : public ::testing::Test {
protected:
    using Names = std::vector<std::string>;

    CellTest() { useTraits({}); }

    /// The system's traits from now on; tells nobody.
    void useTraits(const UITraitCollection& traits) {
        _traits.reset();
        _traits.emplace(UITraitCollection::system().overrideWith(traits));
    }
    void useSize(UIContentSizeCategory category) {
        useTraits({.preferredContentSizeCategory = category});
    }
    /// The same while widgets are on screen.
    void changeSize(UIContentSizeCategory category) {
        useSize(category);
        NSNotificationCenter::defaultCenter()->postNotificationName_object(
            UIContentSizeCategoryDidChangeNotification, nullptr);
    }

    /// The view or guide of that name inside; nil for none.
    static std::shared_ptr<UILayoutItem> find(const std::shared_ptr<UIView>& view,
                                              const std::string& name) {
        if (view->identifier() == name)
            return view;
        for (const auto& guide : view->layoutGuides())
            if (guide->identifier() == name)
                return guide;
        for (const auto& subview : view->subviews())
            if (auto found = find(subview, name))
                return found;
        return nullptr;
    }
    template <class Item>
    static std::shared_ptr<Item> find(const std::shared_ptr<UIView>& view,
                                      const std::string& name) {
        return std::dynamic_pointer_cast<Item>(find(view, name));
    }
    /// The active constraint of that name; nil for none.
    static std::shared_ptr<NSLayoutConstraint> active(const std::shared_ptr<UITableViewCell>& cell,
                                                      const std::string& name) {
        for (const auto& view : {std::shared_ptr<UIView>(cell), cell->contentView()})
            for (const auto& constraint : view->constraints())
                if (constraint->identifier() == name)
                    return constraint;
        return nullptr;
    }
    static std::string textOf(const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints) {
        std::string text = "\n";
        for (const auto& constraint : constraints)
            text += constraint->description() + "\n";
        return text;
    }
    /// The tree of a cell of this size once it is laid out.
    static std::string
    layout(const std::shared_ptr<UITableViewCell>& cell, CGFloat width, CGFloat height) {
        cell->setFrame({{0, 0}, {width, height}});
        cell->layoutIfNeeded();
        return "\n" + dumpViews(*cell);
    }
    /// The lines of a label as they are shown.
    static Names linesOf(const std::shared_ptr<UILabel>& label) {
        Names lines;
        for (const auto& line : label->_visibleLines().lines)
            lines.push_back(line.text);
        return lines;
    }
    /// Of its first line, in the cell.
    static CGFloat firstBaselineOf(const std::shared_ptr<UILabel>& label,
                                   const std::shared_ptr<UITableViewCell>& cell) {
        return label->convertPoint_toView({0, label->_firstBaselineFromTop().value()}, *cell).y;
    }

    LogCapture log;

private:
    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override _measurer =
        TextMeasurer::shared().overrideWith(std::make_shared<FixedTextMeasurer>());
    std::optional<EnvironmentSlot<UITraitCollection>::Override> _traits;
};

} // namespace orvo::testing
