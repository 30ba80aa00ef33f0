#include "platform/feeds/alerts/SelectorShapes.h"

#include "platform/feeds/alerts/WireCursor.h"

#include <algorithm>
#include <string>
#include <utility>

namespace orvo {

namespace {

constexpr WireCursor::Key Agency = WireCursor::bytes(1);
constexpr WireCursor::Key Route = WireCursor::bytes(2);
constexpr WireCursor::Key RouteType = WireCursor::number(3);
constexpr WireCursor::Key Stop = WireCursor::bytes(5);

/// Calls `visit(key, begin, value)` for each field of a usual selector: where its key lies, and its
/// length or number. False for a selector of another form; `visit` may have been called then.
template <class Visit>
bool walk(std::string_view selector, const Visit& visit) {
    std::size_t i = 0;
    while (i + 2 <= selector.size()) {
        const WireCursor::Key key = static_cast<unsigned char>(selector[i]);
        const std::size_t value = static_cast<unsigned char>(selector[i + 1]);
        if (value >= 0x80 || (key != Agency && key != Route && key != RouteType && key != Stop))
            return false;
        visit(key, i, value);
        i += 2;
        if (key == RouteType)
            continue;
        if (value > selector.size() - i)
            return false;
        i += value;
    }
    return i == selector.size();
}

/// Empty where the selector is of another form.
std::string_view readRoute(std::string_view selector) {
    std::string_view route;
    std::size_t routes = 0;
    const bool isUsual =
        walk(selector, [&](WireCursor::Key key, std::size_t begin, std::size_t value) {
            if (key != Route)
                return;
            ++routes;
            route = selector.substr(begin + 2, value);
        });
    return isUsual && routes == 1 && ByteScan::isASCII(selector) ? route : std::string_view();
}

/// The word at the end of which the text stands, with nothing before it.
std::uint64_t wordEndingWith(std::string_view text, char before) {
    std::array<char, ByteScan::Word> bytes{};
    bytes.fill(before);
    std::copy(text.begin(), text.end(), bytes.end() - static_cast<std::ptrdiff_t>(text.size()));
    return ByteScan::wordAt(bytes.data());
}

constexpr std::uint64_t Ones = 0x0101010101010101ULL;

/// Not 0 if one of eight ASCII characters is a blank or a control character. May be so wrongly.
constexpr std::uint64_t blanksOf(std::uint64_t characters) {
    return (characters - Ones * (' ' + 1)) & (Ones << 7U);
}

} // namespace

void SelectorShapes::want(std::string_view route) {
    if (route.size() <= ByteScan::Word)
        _wanted[slotOf(wordEndingWith(route, '\0'))] = true;
}

std::string_view SelectorShapes::routeOf(std::string_view selector) {
    const std::string_view route = readRoute(selector);
    if (!route.empty())
        learn(selector, route);
    return route;
}

// Without a branch for each word: selectors of unequal lengths follow one another.
inline bool SelectorShapes::isUnwanted(const Shape& shape, const char* selector) const noexcept {
    std::uint64_t differences = 0;
    for (std::size_t word = 0; word < Words; ++word)
        differences |= (ByteScan::wordAt(selector + word * ByteScan::Word) & shape.mask[word]) ^
                       shape.value[word];
    const std::uint64_t route = ByteScan::wordAt(selector + shape.routeWord) & shape.routeMask;
    // Blanks around a route do not count for the schedule.
    return (differences | blanksOf(route | shape.besidesRoute)) == 0 && !_wanted[slotOf(route)];
}

std::array<char, SelectorShapes::Longest> SelectorShapes::padded(std::string_view bytes) noexcept {
    std::array<char, Longest> padded{};
    std::copy(bytes.begin(), bytes.end(), padded.begin());
    return padded;
}

const char*
SelectorShapes::skim(const char* position, const char* end, std::size_t& left) const noexcept {
    constexpr unsigned char SelectorKey = WireCursor::bytes(5);
    std::size_t mayPass = left; // beside the loop: what it points to might be the bytes themselves
    while (mayPass > 0 && end - position >= 2 &&
           static_cast<unsigned char>(position[0]) == SelectorKey) {
        const std::size_t size = static_cast<unsigned char>(position[1]);
        const char* const selector = position + 2;
        const auto bytesLeft = static_cast<std::size_t>(end - selector);
        if (size > Longest || size > bytesLeft)
            break;
        const bool isPassedOver = bytesLeft >= Longest
                                      ? isUnwanted(_known[size], selector)
                                      : isUnwanted(_known[size], padded({selector, size}).data());
        if (!isPassedOver)
            break;
        position = selector + size;
        --mayPass;
    }
    left = mayPass;
    return position;
}

/// The shape takes the place of the older one of the same length.
void SelectorShapes::learn(std::string_view selector, std::string_view route) {
    const auto routeEnd = static_cast<std::size_t>(route.data() - selector.data()) + route.size();
    if (selector.size() > Longest || route.size() > ByteScan::Word || routeEnd < ByteScan::Word)
        return;
    std::array<char, Longest> mask{};
    std::fill_n(mask.begin(), selector.size(), static_cast<char>(0x80));
    walk(selector, [&](WireCursor::Key key, std::size_t begin, std::size_t) {
        mask[begin] = static_cast<char>(0xFF);
        if (key != RouteType) // any number of one byte fits
            mask[begin + 1] = static_cast<char>(0xFF);
    });
    Shape shape;
    const std::array<char, Longest> value = padded(selector);
    for (std::size_t word = 0; word < Words; ++word) {
        shape.mask[word] = ByteScan::wordAt(mask.data() + word * ByteScan::Word);
        shape.value[word] =
            ByteScan::wordAt(value.data() + word * ByteScan::Word) & shape.mask[word];
    }
    shape.routeWord = routeEnd - ByteScan::Word;
    shape.routeMask = wordEndingWith(std::string(route.size(), '\xFF'), '\0');
    shape.besidesRoute = wordEndingWith(std::string(route.size(), '\0'), '~');
    Known& known = _known[selector.size()];
    if (shape != known.newer)
        known.older = std::exchange(known.newer, shape);
}

} // namespace orvo
