#pragma once

#include "orvo/HandOff.h"
#include "platform/feeds/schedule/ScheduleStore.h"

#include <memory>
#include <optional>
#include <string>

namespace orvo {

/// What was handed over last, for scripts.
struct HandOffJson {
    /// Nothing where nothing was handed over, or what was kept cannot be read.
    std::optional<HandOff::Content> content;
    std::optional<double> receivedAt; ///< seconds since 1970
    std::shared_ptr<NSError> error;   ///< why it cannot be told
    /// Tells where a line comes from that does not say so itself; may be nil.
    const ScheduleStore* schedules = nullptr;

    /// The form that scripts rely on: `received`, `kind`, `line`, `incidents` and `error`, always
    /// all of them.
    [[nodiscard]] std::string text() const;
};

} // namespace orvo
