#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo feeds list`: the feeds with their schedules and sources.
class FeedsListCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
