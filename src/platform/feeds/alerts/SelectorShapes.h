#pragma once

#include "platform/feeds/alerts/ByteScan.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace orvo {

/// Passes quickly over selectors that name none of some routes. The selectors of a feed mostly have
/// the same form: the same fields, with texts of the same lengths. A form once seen is recognised
/// by comparing a few words instead of walking field by field.
///
/// Only usual selectors are understood: one route, agency, stop and route type besides, all short
/// and ASCII. All others are left to `EntityReader`.
class SelectorShapes {
public:
    /// Selectors with this route are not to be passed over.
    void want(std::string_view route);

    /// The route that a usual selector names; empty for any other selector, good or bad. Its form
    /// is remembered.
    [[nodiscard]] std::string_view routeOf(std::string_view selector);

    /// From `position`, where a field of an alert begins, over all selectors whose form is known
    /// and whose route is not wanted, to the first field that is anything else, or to `end`.
    /// @param left how many selectors may be passed over; lowered by those that were
    [[nodiscard]] const char*
    skim(const char* position, const char* end, std::size_t& left) const noexcept;

private:
    static constexpr std::size_t Words = 4;
    static constexpr std::size_t Longest = ByteScan::Word * Words;
    static constexpr std::size_t Slots = 4096;

    /// What the selectors of one length have in common: where `mask` has bits, they have those of
    /// `value`. The masks cover the keys and lengths, and the high bits of all bytes; of what lies
    /// behind the selector, nothing. Nothing fits a shape of which no selector was seen yet.
    struct Shape {
        std::array<std::uint64_t, Words> mask{};
        std::array<std::uint64_t, Words> value{1, 1, 1, 1};
        std::size_t routeWord = 0;      ///< where the word that ends with the route begins
        std::uint64_t routeMask = 0;    ///< the route's bytes in it
        std::uint64_t besidesRoute = 0; ///< visible characters in the place of all others

        friend bool operator==(const Shape&, const Shape&) = default;
    };
    /// What was learnt of the selectors of one length: a route may be shorter by what a stop is
    /// longer.
    struct Known {
        Shape newer;
        Shape older;
    };

    /// Whether a selector that begins here has the shape, and a route that is not wanted. `Longest`
    /// bytes can be read.
    [[nodiscard]] bool isUnwanted(const Shape& shape, const char* selector) const noexcept;
    [[nodiscard]] bool isUnwanted(const Known& known, const char* selector) const noexcept {
        return isUnwanted(known.newer, selector) || isUnwanted(known.older, selector);
    }
    [[nodiscard]] static std::array<char, Longest> padded(std::string_view bytes) noexcept;
    [[nodiscard]] static std::size_t slotOf(std::uint64_t routeWord) noexcept {
        return (routeWord * 0x9E3779B97F4A7C15ULL) >> 52U;
    }
    void learn(std::string_view selector, std::string_view route);

    std::array<Known, Longest + 1> _known; // by length of the selector
    std::array<bool, Slots> _wanted{};     // by the slot of a wanted route's word
};

} // namespace orvo
