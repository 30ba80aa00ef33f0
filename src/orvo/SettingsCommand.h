#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo settings`: what a person prefers.
class SettingsCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& arguments) const override {
        return arguments.operand(1).has_value();
    }
};

} // namespace orvo
