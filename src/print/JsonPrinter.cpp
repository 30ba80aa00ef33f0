#include "print/JsonPrinter.h"

#include "platform/foundation/NSData.h"
#include "platform/foundation/NSString.h"

#include <fmt/format.h>
#include <span>

namespace orvo {

namespace {

std::string base64(std::span<const std::uint8_t> bytes) {
    static constexpr std::string_view Digits =
        "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    for (std::size_t at = 0; at < bytes.size(); at += 3) {
        const auto byte = [&](std::size_t index) {
            return index < bytes.size() ? std::uint32_t{bytes[index]} : 0U;
        };
        const std::uint32_t group = byte(at) << 16U | byte(at + 1) << 8U | byte(at + 2);
        text += Digits[group >> 18U];
        text += Digits[group >> 12U & 63U];
        text += at + 1 < bytes.size() ? Digits[group >> 6U & 63U] : '=';
        text += at + 2 < bytes.size() ? Digits[group & 63U] : '=';
    }
    return text;
}

void addArtwork(JsonWriter& json, const std::optional<PrintedArtwork>& artwork) {
    json.key("artwork");
    if (!artwork) {
        json.null();
        return;
    }
    json.beginObject();
    if (artwork->image) {
        json.key("image").value(*artwork->image);
    } else {
        json.key("shields").beginArray();
        for (const auto& shield : artwork->shields)
            json.value(shield.text);
        json.endArray();
    }
    json.key("alpha").value(artwork->alpha).endObject();
}

void addUserInfo(JsonWriter& json, const std::shared_ptr<NSDictionary>& userInfo) {
    json.key("userInfo");
    if (!userInfo) {
        json.null();
        return;
    }
    json.beginObject();
    for (const auto& [key, value] : userInfo->entries()) {
        json.key(stringValue(key.get()).value_or(descriptionOf(key)));
        if (const auto data = std::dynamic_pointer_cast<NSData>(value))
            json.value(base64(data->bytes()));
        else
            json.value(stringValue(value.get()).value_or(descriptionOf(value)));
    }
    json.endObject();
}

} // namespace

std::string JsonPrinter::text(const PrintedWidget& widget) const {
    JsonWriter json(_layout);
    json.beginObject().key("summary");
    addRow(json, widget.summary);
    json.key("expanded").beginArray();
    for (const auto& row : widget.expanded)
        addRow(json, row);
    json.endArray().endObject();
    return json.text();
}

void JsonPrinter::addRow(JsonWriter& json, const PrintedRow& row) const {
    json.beginObject();
    json.key("kind").value(row.kind == PrintedRow::Kind::Summary ? "summary" : "item");
    json.key("primaryText").value(row.primaryText);
    json.key("secondaryText").value(row.secondaryText);
    addArtwork(json, row.artwork);
    json.key("artworkHidden").value(row.artworkHidden);
    addTarget(json, row.opens);
    json.endObject();
}

void JsonPrinter::addTarget(JsonWriter& json, const std::optional<PrintedTarget>& target) const {
    json.key("opens");
    if (!target) {
        json.null();
        return;
    }
    json.beginObject();
    if (target->url) {
        json.key("url").value(*target->url);
    } else {
        json.key("activityType").value(target->activityType);
        if (target->incidentMuids) {
            json.key("incidentMuids").beginArray();
            for (const auto muid : *target->incidentMuids)
                json.value(fmt::format("{}", muid));
            json.endArray();
        }
        if (target->lineMuid)
            json.key("lineMuid").value(fmt::format("{}", *target->lineMuid));
        if (_payloads == Payloads::WithUserInfo)
            addUserInfo(json, target->userInfo);
    }
    json.endObject();
}

} // namespace orvo
