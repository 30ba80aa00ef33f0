#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo show`: what was handed over last.
class ShowCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;

private:
    [[nodiscard]] static ExitCode printJson(CommandContext& context);
};

} // namespace orvo
