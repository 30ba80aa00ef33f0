#pragma once

#include "orvo/console/JsonWriter.h"
#include "print/WidgetPrinter.h"

namespace orvo {

/// For scripts:
///
///     {"summary": ROW, "expanded": [ROW…]}
///
/// with ROW
///
///     {"kind": "item" | "summary", "primaryText": TEXT | null, "secondaryText": TEXT | null,
///      "artwork": null | {"image": NAME, "alpha": NUMBER} | {"shields": [TEXT…], "alpha": NUMBER},
///      "artworkHidden": BOOL,
///      "opens": null | {"url": URL} | {"activityType": TYPE, "incidentMuids": [TEXT…]}
///                    | {"activityType": TYPE, "lineMuid": TEXT}}
///
/// Numbers of incidents and lines are text: they have 64 bits, and JSON's readers fewer.
class JsonPrinter final : public WidgetPrinter {
public:
    /// `WithUserInfo`: an activity has a member `userInfo` besides, data in it as base64.
    enum class Payloads { LeftOut, WithUserInfo };

    JsonPrinter(JsonWriter::Layout layout, Payloads payloads)
        : _layout(layout)
        , _payloads(payloads) {}

    [[nodiscard]] std::string text(const PrintedWidget& widget) const override;

private:
    void addRow(JsonWriter& json, const PrintedRow& row) const;
    void addTarget(JsonWriter& json, const std::optional<PrintedTarget>& target) const;

    JsonWriter::Layout _layout;
    Payloads _payloads;
};

} // namespace orvo
