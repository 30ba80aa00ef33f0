#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo feeds check`: reads the alerts now and says what they hold.
class FeedsCheckCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
