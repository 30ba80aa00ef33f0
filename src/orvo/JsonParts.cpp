#include "orvo/JsonParts.h"

#include "platform/foundation/ISO8601.h"

namespace orvo::JsonParts {

void addError(JsonWriter& json, const std::shared_ptr<NSError>& error) {
    json.key("error");
    if (!error) {
        json.null();
        return;
    }
    json.beginObject();
    json.key("domain").value(error->domain());
    json.key("code").value(error->code());
    json.key("message").value(error->localizedDescription());
    json.endObject();
}

void addTime(JsonWriter& json, std::string_view key, std::optional<double> time) {
    json.key(key);
    if (time)
        json.value(ISO8601::string(*time));
    else
        json.null();
}

} // namespace orvo::JsonParts
