#pragma once

#include "platform/foundation/NSObject.h"

#include <cstdint>

namespace orvo {

/// A row of a table. Immutable.
class NSIndexPath final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSIndexPath>
    indexPathForRow_inSection(std::int64_t row, std::int64_t section);

    [[nodiscard]] std::int64_t row() const noexcept { return _row; }
    [[nodiscard]] std::int64_t section() const noexcept { return _section; }

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::int64_t _row = 0;
    std::int64_t _section = 0;
};

} // namespace orvo
