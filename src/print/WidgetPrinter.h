#pragma once

#include "print/PrintedWidget.h"

#include <string>

namespace orvo {

/// A form in which the widget is printed.
class WidgetPrinter {
public:
    WidgetPrinter() = default;
    WidgetPrinter(const WidgetPrinter&) = delete;
    WidgetPrinter& operator=(const WidgetPrinter&) = delete;
    virtual ~WidgetPrinter() = default;

    /// Ends with a line break.
    [[nodiscard]] virtual std::string text(const PrintedWidget& widget) const = 0;
};

} // namespace orvo
