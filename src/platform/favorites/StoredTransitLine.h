#pragma once

#include "platform/foundation/NSData.h"
#include "platform/geoservices/FeedTransitLine.h"

#include <optional>
#include <span>

/// The form in which a line outlives its schedule: names, system, artworks and origin. It is a
/// message whose fields are numbered, so that later versions read earlier ones' and the other way
/// round.
namespace orvo::StoredTransitLine {

/// What a line answers about itself, without its service.
[[nodiscard]] TransitLineRecord::Fields fieldsOf(const TransitLine& line);

/// Nothing for a line that came from no feed.
[[nodiscard]] std::optional<FeedLineOrigin> originOf(const TransitLine& line);

/// The incidents of a line item are not kept.
[[nodiscard]] std::shared_ptr<NSData> encode(const TransitLine& line);

/// A `FeedTransitLine` where the line came from a feed. Nil when the bytes are no line.
[[nodiscard]] std::shared_ptr<TransitLine> decode(std::span<const std::uint8_t> bytes);

} // namespace orvo::StoredTransitLine
