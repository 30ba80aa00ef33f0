#pragma once

#include "orvo/Command.h"
#include "platform/feeds/FeedConfiguration.h"

#include <variant>

namespace orvo {

/// `orvo feeds add`: imports a schedule, tries its alerts and remembers both.
class FeedsAddCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }

private:
    [[nodiscard]] static std::variant<FeedConfiguration, UsageError>
    configurationFrom(const Arguments& arguments);
    /// Says which alert sources cannot be read now; servers come back, so that is no failure.
    static void tryAlerts(const FeedConfiguration& feed, CommandContext& context);
};

} // namespace orvo
