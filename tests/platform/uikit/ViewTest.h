#pragma once

#include "platform/uikit/NSAttributedString.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIStackView.h"
#include "platform/uikit/ViewDumps.h"
#include "support/FixedTextMeasurer.h"
#include "support/LogCapture.h"

#include <gtest/gtest.h>

namespace orvo::testing {

/// Views with texts of fixed numbers: at 10 points, characters are 5 wide and lines 10 high with
/// the baseline at 8. The system's traits are those of the default, at scale 1.
class ViewTest : public ::testing::Test {
protected:
    static std::shared_ptr<UIView> root(CGFloat width, CGFloat height) {
        return UIView::initWithFrame({{0, 0}, {width, height}});
    }
    static std::shared_ptr<UIView> child(const std::shared_ptr<UIView>& parent,
                                         const std::string& name) {
        return constrained(UIView::init(), parent, name);
    }
    static std::shared_ptr<UILabel> label(const std::shared_ptr<UIView>& parent,
                                          const std::string& name,
                                          const std::string& text,
                                          double size = 10) {
        auto made = constrained(UILabel::init(), parent, name);
        made->setFont(UIFont::systemFontOfSize_weight(size, 400));
        made->setText(text);
        return made;
    }
    template <class View>
    static std::shared_ptr<View> constrained(std::shared_ptr<View> view,
                                             const std::shared_ptr<UIView>& parent,
                                             const std::string& name) {
        view->setIdentifier(name);
        view->setTranslatesAutoresizingMaskIntoConstraints(false);
        if (parent)
            parent->addSubview(view);
        return view;
    }
    static void activate(const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints) {
        NSLayoutConstraint::activateConstraints(constraints);
    }
    /// Against the same edges of `other`.
    static void pin(const std::shared_ptr<UIView>& view, const std::shared_ptr<UIView>& other) {
        activate({view->leadingAnchor().constraintEqualToAnchor(other->leadingAnchor()),
                  view->trailingAnchor().constraintEqualToAnchor(other->trailingAnchor()),
                  view->topAnchor().constraintEqualToAnchor(other->topAnchor()),
                  view->bottomAnchor().constraintEqualToAnchor(other->bottomAnchor())});
    }
    static void place(const std::shared_ptr<UIView>& view, CGFloat leading, CGFloat top) {
        const auto above = view->superview();
        activate({view->leadingAnchor().constraintEqualToAnchor_constant(above->leadingAnchor(),
                                                                         leading),
                  view->topAnchor().constraintEqualToAnchor_constant(above->topAnchor(), top)});
    }
    static void size(const std::shared_ptr<UIView>& view, CGFloat width, CGFloat height) {
        activate({view->widthAnchor().constraintEqualToConstant(width),
                  view->heightAnchor().constraintEqualToConstant(height)});
    }
    static std::shared_ptr<NSLayoutConstraint> with(std::shared_ptr<NSLayoutConstraint> constraint,
                                                    UILayoutPriority priority) {
        constraint->setPriority(priority);
        return constraint;
    }
    /// The tree after a layout pass.
    static std::string layout(const std::shared_ptr<UIView>& view) {
        view->layoutIfNeeded();
        return "\n" + dumpViews(*view);
    }
    static CGRect frameOf(const std::shared_ptr<UIView>& view) { return view->frame(); }

    std::shared_ptr<FixedTextMeasurer> measurer = std::make_shared<FixedTextMeasurer>();
    LogCapture log;

private:
    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override _measurer =
        TextMeasurer::shared().overrideWith(measurer);
    EnvironmentSlot<UITraitCollection>::Override _traits =
        UITraitCollection::system().overrideWith(UITraitCollection());
};

} // namespace orvo::testing
