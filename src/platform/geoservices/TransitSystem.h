#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

class TransitArtworkDataSource;

/// The operator's network that a line belongs to.
class TransitSystem : public virtual NSObject {
public:
    [[nodiscard]] virtual std::optional<std::string> name() const = 0;
    /// The system's own mark; nil when it has none.
    [[nodiscard]] virtual std::shared_ptr<TransitArtworkDataSource> artwork() const = 0;
};

} // namespace orvo
