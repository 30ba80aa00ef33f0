#pragma once

#include "platform/extension/Extension.h"
#include "platform/foundation/CodingClass.h"

namespace orvo {

/// The classes that this program makes by their name: what its archives may hold,
[[nodiscard]] std::shared_ptr<const CodingClassTable> codingClasses();
/// and what its bundle description may name.
[[nodiscard]] PrincipalClassTable widgetPrincipalClasses();

} // namespace orvo
