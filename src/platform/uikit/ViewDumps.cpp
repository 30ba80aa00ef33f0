#include "platform/uikit/ViewDumps.h"

#include "platform/uikit/_LayoutEngine.h"

#include <cstdio>
#include <map>

namespace orvo {

namespace {

std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.6g", value == 0 ? 0 : value);
    return text;
}

/// Names by class and order in the tree, so that they are the same in every run.
class Names {
public:
    explicit Names(const UIView& root) { add(root); }

    [[nodiscard]] std::string operator()(const UILayoutItem& item) const {
        const auto found = _names.find(item._creationNumber());
        return found == _names.end() ? item.className() : found->second;
    }

private:
    void add(const UIView& view) {
        name(view);
        for (const auto& guide : view.layoutGuides())
            name(*guide);
        for (const auto& subview : view.subviews())
            add(*subview);
    }
    void name(const UILayoutItem& item) {
        const auto count = ++_counts[item.className()];
        _names[item._creationNumber()] = item.identifier().empty()
                                             ? item.className() + std::to_string(count)
                                             : item.identifier();
    }

    std::map<std::string, int> _counts;
    std::map<std::uint64_t, std::string> _names;
};

std::string placeOf(const CGRect& rect) {
    return " " + number(rect.origin.x) + " " + number(rect.origin.y) + " " +
           number(rect.size.width) + " " + number(rect.size.height);
}

void dump(const UIView& view,
          const UIView& root,
          const Names& names,
          const std::string& indent,
          std::string& into) {
    into += indent + names(view) + placeOf(view.convertRect_toView(view.bounds(), root));
    if (view.isHidden())
        into += " hidden";
    if (view.alpha() != 1)
        into += " alpha " + number(view.alpha());
    if (const auto shown = view._dumpedContent(); !shown.empty())
        into += " " + shown;
    into += "\n";
    for (const auto& guide : view.layoutGuides()) {
        auto frame = guide->layoutFrame();
        frame.origin = view.convertPoint_toView(frame.origin, root);
        into += indent + "  (" + names(*guide) + placeOf(frame) + ")\n";
    }
    for (const auto& subview : view.subviews())
        dump(*subview, root, names, indent + "  ", into);
}

void dumpConstraintsOf(UIView& view, const Names& names, std::string& into) {
    for (const auto& constraint : view._layoutEngine().constraints())
        into += constraint->_equation(names) + "\n";
}

/// The constraints of `view`, then those of each layout root inside.
void dumpRoots(UIView& view, const Names& names, std::string& into) {
    for (const auto& subview : view.subviews()) {
        if (subview->_isLayoutRoot())
            dumpConstraintsOf(*subview, names, into);
        dumpRoots(*subview, names, into);
    }
}

} // namespace

std::string dumpViews(const UIView& root) {
    std::string text;
    dump(root, root, Names(root), "", text);
    return text;
}

std::string dumpConstraints(UIView& root) {
    const Names names(root);
    std::string text;
    dumpConstraintsOf(root, names, text);
    dumpRoots(root, names, text);
    return text;
}

} // namespace orvo
