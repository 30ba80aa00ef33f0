#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo demo`: writes the demonstration city anew, and serves its live alerts.
class DemoCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }
    [[nodiscard]] bool writesDemonstration() const override { return true; }

private:
    /// Until somebody interrupts it.
    [[nodiscard]] static ExitCode serve(std::uint16_t port, const CommandContext& context);
};

} // namespace orvo
