#include "platform/uikit/NSAttributedString.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Hashing.h"

#include <algorithm>

namespace orvo {

namespace {

bool sameAttributes(const NSAttributedString::Attributes& a,
                    const NSAttributedString::Attributes& b) {
    return std::ranges::equal(a, b, [](const auto& left, const auto& right) {
        return left.first == right.first && equal(left.second, right.second);
    });
}

} // namespace

std::shared_ptr<NSAttributedString> NSAttributedString::initWithString(std::string string) {
    return initWithString_attributes(std::move(string), {});
}

std::shared_ptr<NSAttributedString>
NSAttributedString::initWithString_attributes(std::string string, Attributes attributes) {
    auto made = std::make_shared<NSAttributedString>();
    if (!string.empty())
        made->_runs.push_back({{0, string.size()}, std::move(attributes)});
    made->_string = std::move(string);
    return made;
}

std::shared_ptr<NSObject> NSAttributedString::attribute_atIndex_effectiveRange(
    const std::string& name, std::size_t index, NSRange* effectiveRange) const {
    const auto run =
        std::ranges::find_if(_runs, [index](const Run& each) { return index < each.range.end(); });
    if (run == _runs.end())
        throw NSInvalidArgumentException("an attribute was asked for past the end of the text");
    if (effectiveRange)
        *effectiveRange = run->range;
    const auto found = run->attributes.find(name);
    return found == run->attributes.end() ? nullptr : found->second;
}

std::shared_ptr<NSObject> NSAttributedString::copy() const {
    auto made = std::make_shared<NSAttributedString>();
    made->_string = _string;
    made->_runs = _runs;
    return made;
}

std::shared_ptr<NSMutableAttributedString> NSAttributedString::mutableCopy() const {
    auto made = std::make_shared<NSMutableAttributedString>();
    made->_string = _string;
    made->_runs = _runs;
    return made;
}

bool NSAttributedString::isEqual(const NSObject* other) const {
    const auto* text = dynamic_cast<const NSAttributedString*>(other);
    return text && text->_string == _string &&
           std::ranges::equal(_runs, text->_runs, [](const Run& a, const Run& b) {
               return a.range == b.range && sameAttributes(a.attributes, b.attributes);
           });
}

std::uint64_t NSAttributedString::hash() const {
    return stableHash(_string);
}

std::string NSAttributedString::description() const {
    return rootDescription() + " " + _string;
}

void NSMutableAttributedString::addAttribute_value_range(const std::string& name,
                                                         const std::shared_ptr<NSObject>& value,
                                                         NSRange range) {
    if (!value)
        throw NSInvalidArgumentException("an attribute may not be nil");
    if (range.location > length() || range.length > length() - range.location)
        throw NSInvalidArgumentException("an attribute was set past the end of the text");
    splitAt(range.location);
    splitAt(range.end());
    for (auto& run : _runs) {
        if (run.range.location >= range.location && run.range.end() <= range.end())
            run.attributes[name] = value;
    }
    // Neighbours that have become alike are one run again.
    for (std::size_t i = 1; i < _runs.size();) {
        auto& before = _runs[i - 1];
        if (!sameAttributes(before.attributes, _runs[i].attributes)) {
            ++i;
            continue;
        }
        before.range.length += _runs[i].range.length;
        _runs.erase(_runs.begin() + static_cast<std::ptrdiff_t>(i));
    }
}

void NSMutableAttributedString::splitAt(std::size_t index) {
    const auto run = std::ranges::find_if(_runs, [index](const Run& each) {
        return each.range.location < index && index < each.range.end();
    });
    if (run == _runs.end())
        return;
    Run rest{{index, run->range.end() - index}, run->attributes};
    run->range.length = index - run->range.location;
    _runs.insert(run + 1, std::move(rest));
}

} // namespace orvo
