#pragma once

#include "platform/foundation/CodingClass.h"

namespace orvo {

/// The classes that this program makes by their name: those in archives that it is handed.
[[nodiscard]] std::shared_ptr<const CodingClassTable> codingClasses();

} // namespace orvo
