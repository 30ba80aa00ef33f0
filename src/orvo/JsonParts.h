#pragma once

#include "orvo/console/JsonWriter.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <optional>

/// What several commands' JSON has in common.
namespace orvo::JsonParts {

/// `"error": null | {"domain", "code", "message"}` as the next member.
void addError(JsonWriter& json, const std::shared_ptr<NSError>& error);
/// `"KEY": "2024-07-24T01:28:40Z"`, or null, of seconds since 1970.
void addTime(JsonWriter& json, std::string_view key, std::optional<double> time);

} // namespace orvo::JsonParts
