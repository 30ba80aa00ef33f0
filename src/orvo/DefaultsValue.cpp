#include "orvo/DefaultsValue.h"

#include "fetching/FakeIncidentKeys.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <charconv>
#include <cmath>
#include <fmt/format.h>

namespace orvo::DefaultsValue {

namespace {

template <class Number>
std::optional<Number> number(const std::string& text) {
    Number value{};
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, value);
    return result.ec == std::errc() && result.ptr == end ? std::optional(value) : std::nullopt;
}

std::shared_ptr<NSObject> boolean(const std::string& text) {
    if (text == "true" || text == "yes")
        return NSNumber::numberWithBool(true);
    return text == "false" || text == "no" ? NSNumber::numberWithBool(false) : nullptr;
}

std::shared_ptr<NSObject> integer(const std::string& text) {
    const auto value = number<std::int64_t>(text);
    return value ? NSNumber::numberWithInteger(*value) : nullptr;
}

std::shared_ptr<NSObject> real(const std::string& text) {
    const auto value = number<double>(text);
    return value && std::isfinite(*value) ? NSNumber::numberWithDouble(*value) : nullptr;
}

} // namespace

const std::vector<std::string>& kinds() {
    static const std::vector<std::string> kinds = {"bool", "integer", "real", "string"};
    return kinds;
}

const std::vector<std::string>& knownKeys() {
    static const std::vector<std::string> keys = {injectFakeIncidentsKey, randomNumberIncidentsKey};
    return keys;
}

std::shared_ptr<NSObject> parse(const std::string& text, const std::string& kind) {
    if (kind == "bool")
        return boolean(text);
    if (kind == "integer")
        return integer(text);
    if (kind == "real")
        return real(text);
    if (kind.empty()) {
        for (auto* const read : {boolean, integer, real}) {
            if (auto value = read(text))
                return value;
        }
    }
    return NSString::string(text);
}

std::string text(const NSObject& value) {
    if (const auto string = stringValue(&value))
        return *string;
    if (const auto* data = dynamic_cast<const NSData*>(&value))
        return fmt::format("{} bytes", data->length());
    if (const auto* number = dynamic_cast<const NSNumber*>(&value)) {
        if (const auto* truth = std::get_if<bool>(&number->value()))
            return *truth ? "true" : "false";
    }
    return value.description();
}

void add(JsonWriter& json, const NSObject& value) {
    if (const auto* array = dynamic_cast<const NSArray*>(&value)) {
        json.beginArray();
        for (const auto& element : array->elements())
            add(json, *element);
        json.endArray();
        return;
    }
    const auto* boxed = dynamic_cast<const NSNumber*>(&value);
    if (!boxed)
        json.value(text(value));
    else if (const auto* truth = std::get_if<bool>(&boxed->value()))
        json.value(*truth);
    else if (const auto* real = std::get_if<double>(&boxed->value()))
        json.value(*real);
    else
        json.value(boxed->integerValue());
}

} // namespace orvo::DefaultsValue
