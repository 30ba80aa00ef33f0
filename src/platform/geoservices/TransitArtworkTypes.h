#pragma once

#include <cstdint>

namespace orvo {

/// Which of an artwork's data sources is meant.
enum class TransitArtworkSourceType : std::int32_t { None = 0, Shield = 1, Icon = 2, Text = 3 };

/// The mode of transport, which gives a shield its shape: metro a disc, tram and bus a rounded
/// rectangle, rail a rectangle, ferry and cable a pill; neutral is a system's own mark.
enum class TransitShieldType : std::int32_t {
    Neutral = 0,
    Metro = 1,
    Tram = 2,
    Bus = 3,
    Rail = 4,
    Ferry = 5,
    Cable = 6
};

} // namespace orvo
