#pragma once

#include "orvo/HandOff.h"

#include <optional>

/// What was handed over last, kept in the state folder of the profile in use: `hand-off.plist`,
/// with the time at which it came. Any process.
namespace orvo::HandOffStore {

struct Kept {
    HandOff handOff;
    double receivedAt = 0; ///< seconds since 1970
};

/// In place of the one before, now by the environment's clock. Nothing is written while the
/// process keeps its writes in memory. Nil, or why it failed; then the one before is still there.
[[nodiscard]] std::shared_ptr<NSError> keep(const HandOff& handOff);

/// Nothing without an error where nothing was ever handed over; nothing with one for a file that
/// cannot be read.
[[nodiscard]] std::optional<Kept> last(std::shared_ptr<NSError>* error);

} // namespace orvo::HandOffStore
