#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo open`: takes a URL of the map application.
class OpenCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }
    [[nodiscard]] bool showsWindows() const override { return true; }
};

} // namespace orvo
