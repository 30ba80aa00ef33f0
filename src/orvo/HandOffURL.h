#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace orvo {

/// What a URL of the map application asks for: `orvo://?t=r` the map, `orvo://?favorites=2&t=r` the
/// favourite lines with the map behind them.
struct HandOffURL {
    /// A longer one is refused.
    static constexpr std::size_t MaximumLength = 8192;
    static constexpr std::int32_t TransitLineFavorites = 2;

    std::optional<std::int32_t> favoritesType;
    std::optional<std::int32_t> mapType; ///< 3 is the transit map

    /// Names and values may be percent-encoded. Parameters of other names are passed over; of two
    /// of one name the later counts. Nothing, with an error of `HandOffErrorDomain`, for a text
    /// that is no URL of this application
    /// (`NotOurs`), or one that asks for what there is not (`Unknown`).
    [[nodiscard]] static std::optional<HandOffURL> parse(const std::string& text,
                                                         std::shared_ptr<NSError>* error);
};

} // namespace orvo
