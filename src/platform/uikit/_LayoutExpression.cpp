#include "platform/uikit/_LayoutExpression.h"

namespace orvo {

namespace {

constexpr std::size_t UsualTerms = 8;

} // namespace

_LayoutExpression::_LayoutExpression(SolverVariable rootWidth, bool rightToLeft)
    : _rootWidth(rootWidth)
    , _rightToLeft(rightToLeft) {
    _terms.reserve(UsualTerms);
}

void _LayoutExpression::add(SolverVariable variable, double factor) {
    if (variable)
        _terms.push_back({variable, factor});
}

void _LayoutExpression::add(const _LayoutVariables& item,
                            NSLayoutAttribute attribute,
                            double factor) {
    switch (attribute) {
    case NSLayoutAttribute::Leading:
    case NSLayoutAttribute::Trailing:
        if (_rightToLeft) {
            add(_rootWidth, factor);
            add(item.left, -factor);
            if (attribute == NSLayoutAttribute::Leading)
                add(item.width, -factor);
            break;
        }
        add(item.left, factor);
        if (attribute == NSLayoutAttribute::Trailing)
            add(item.width, factor);
        break;
    case NSLayoutAttribute::Left:
        add(item.left, factor);
        break;
    case NSLayoutAttribute::Right:
        add(item.left, factor);
        add(item.width, factor);
        break;
    case NSLayoutAttribute::Top:
        add(item.top, factor);
        break;
    case NSLayoutAttribute::Bottom:
        add(item.top, factor);
        add(item.height, factor);
        break;
    case NSLayoutAttribute::Width:
        add(item.width, factor);
        break;
    case NSLayoutAttribute::Height:
        add(item.height, factor);
        break;
    case NSLayoutAttribute::CenterX:
        add(item.left, factor);
        add(item.width, factor / 2);
        break;
    case NSLayoutAttribute::CenterY:
        add(item.top, factor);
        add(item.height, factor / 2);
        break;
    case NSLayoutAttribute::FirstBaseline:
    case NSLayoutAttribute::LastBaseline:
    case NSLayoutAttribute::NotAnAttribute:
        break;
    }
}

NSLayoutAttribute _LayoutExpression::originOf(NSLayoutAttribute attribute) noexcept {
    switch (attribute) {
    case NSLayoutAttribute::Leading:
    case NSLayoutAttribute::Trailing:
        return NSLayoutAttribute::Leading;
    case NSLayoutAttribute::Left:
    case NSLayoutAttribute::Right:
    case NSLayoutAttribute::CenterX:
        return NSLayoutAttribute::Left;
    case NSLayoutAttribute::Width:
    case NSLayoutAttribute::Height:
    case NSLayoutAttribute::NotAnAttribute:
        return NSLayoutAttribute::NotAnAttribute;
    default:
        return NSLayoutAttribute::Top;
    }
}

} // namespace orvo
