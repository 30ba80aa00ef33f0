#pragma once

#include "orvo/console/JsonWriter.h"
#include "platform/foundation/NSObject.h"

#include <memory>
#include <string>
#include <vector>

/// Keys and values of the user defaults as a person writes and reads them.
namespace orvo::DefaultsValue {

/// The kinds that a person can write.
[[nodiscard]] const std::vector<std::string>& kinds();

/// The keys that mean something to the widget, and which no other command sets. Others are
/// permitted.
[[nodiscard]] const std::vector<std::string>& knownKeys();

/// The value that `text` stands for: a truth value for `true`, `false`, `yes`, `no`, a number for a
/// number, else the text. With a kind of `kinds()` only that kind: nil when the text is none.
[[nodiscard]] std::shared_ptr<NSObject> parse(const std::string& text, const std::string& kind);

/// `true`, `42`, the text itself, bytes by their number, collections by their description.
[[nodiscard]] std::string text(const NSObject& value);
/// The same as JSON's own kinds where it has them.
void add(JsonWriter& json, const NSObject& value);

} // namespace orvo::DefaultsValue
