#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo defaults read`.
class DefaultsReadCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
