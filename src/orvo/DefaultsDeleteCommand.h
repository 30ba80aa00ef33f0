#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo defaults delete`.
class DefaultsDeleteCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }
};

} // namespace orvo
