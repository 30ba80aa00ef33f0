#include "platform/foundation/NSURL.h"

#include "platform/foundation/Hashing.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}
constexpr bool isSchemeCharacter(char c) {
    return isLetter(c) || (c >= '0' && c <= '9') || c == '+' || c == '-' || c == '.';
}

} // namespace

std::shared_ptr<NSURL> NSURL::URLWithString(std::string text) {
    const auto colon = text.find(':');
    if (colon == std::string::npos || colon == 0 || !isLetter(text.front()) ||
        !std::all_of(
            text.begin(), text.begin() + static_cast<std::ptrdiff_t>(colon), isSchemeCharacter))
        return nullptr;
    if (std::ranges::any_of(
            text, [](char c) { return static_cast<unsigned char>(c) <= 0x20 || c == 0x7f; }))
        return nullptr;
    auto url = std::make_shared<NSURL>();
    url->_text = std::move(text);
    return url;
}

std::string NSURL::scheme() const {
    auto scheme = _text.substr(0, _text.find(':'));
    std::ranges::transform(scheme, scheme.begin(), [](char c) {
        return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    });
    return scheme;
}

bool NSURL::isEqual(const NSObject* other) const {
    const auto* url = dynamic_cast<const NSURL*>(other);
    return url && url->_text == _text;
}

std::uint64_t NSURL::hash() const {
    return stableHash(_text);
}

std::string NSURL::description() const {
    return _text;
}

std::shared_ptr<NSObject> NSURL::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
