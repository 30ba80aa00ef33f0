#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo lines SEARCH`: finds lines in the schedules.
class LinesCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
