#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo analytics`: what the widget recorded of its own use.
class AnalyticsCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
