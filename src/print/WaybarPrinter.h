#pragma once

#include "print/WidgetPrinter.h"

namespace orvo {

/// For desktop bars that read JSON, one object a line:
///
///     {"text": …, "alt": STATE, "tooltip": …, "class": STATE, "percentage": 0…100}
///
/// `text` is the compact row's title, `tooltip` all that the widget shows, both in Pango markup, as
/// such bars take it: what stands in a feed is escaped and cannot add any. STATE is `good`,
/// `advisories`, `no-favorites` or `unavailable`; `percentage` the favourite lines without a
/// current incident.
class WaybarPrinter final : public WidgetPrinter {
public:
    [[nodiscard]] std::string text(const PrintedWidget& widget) const override;
};

} // namespace orvo
