#pragma once

#include "platform/foundation/NSObject.h"

#include <memory>
#include <string>

namespace orvo {

class WidgetScene;

/// What stands behind a widget's picture, as text for people and tests. Main thread.
namespace WidgetDump {

/// The tree of views of the card, all rows of the present mode included.
[[nodiscard]] std::string views(const WidgetScene& scene);
/// The constraints of the card, then those of each row, which is laid out by itself.
[[nodiscard]] std::string constraints(const WidgetScene& scene);
/// The saved state as it lies in the group's defaults, an object a line. Empty where nothing is
/// saved.
[[nodiscard]] std::string archive();

/// A property list: texts in quotation marks, data as its length, dictionaries by key.
[[nodiscard]] std::string propertyList(const std::shared_ptr<NSObject>& root);

} // namespace WidgetDump

} // namespace orvo
