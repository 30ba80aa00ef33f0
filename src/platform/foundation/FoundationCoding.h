#pragma once

#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedArchiver.h"

#include <optional>
#include <string>
#include <vector>

/// How foundation's own objects stand in keyed archives.
namespace orvo::FoundationCoding {

/// Whether the object is a text, number, data, date, error, URL or collection of foundation's.
[[nodiscard]] bool isKnown(const NSObject& object);

/// Texts, numbers and data stand in the list of objects as they are. What tells one from all that
/// are not equal to it; nothing for any other object.
[[nodiscard]] std::optional<std::string> scalarContent(const NSObject& object);
/// The class of such an object; nothing for any other.
[[nodiscard]] std::optional<std::string> scalarClass(const NSObject& object);

/// Encodes any other of them. The names of its classes; empty for an object that is none.
[[nodiscard]] std::vector<std::string> encode(const NSObject& object, NSKeyedArchiver& archiver);

/// The classes that property lists have.
[[nodiscard]] const std::vector<std::string>& propertyListClasses();

[[nodiscard]] const std::vector<CodingClass>& classes();

} // namespace orvo::FoundationCoding
