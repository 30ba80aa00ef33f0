#pragma once

#include "platform/favorites/FavoriteTransitLine.h"

namespace orvo {

/// A favourite line as a plain immutable value.
class FavoriteTransitLineRecord final : public virtual FavoriteTransitLine {
public:
    /// `line` may be nil.
    [[nodiscard]] static std::shared_ptr<FavoriteTransitLineRecord>
    initWithTransitLine(std::shared_ptr<TransitLine> line);

    [[nodiscard]] std::shared_ptr<TransitLine> transitLine() const override { return _line; }

    /// The line's number.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// The line's name.
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<TransitLine> _line;
};

} // namespace orvo
