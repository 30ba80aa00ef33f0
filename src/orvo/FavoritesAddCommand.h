#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo favorites add`: lines by feed and route or by name, and places.
class FavoritesAddCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }

private:
    [[nodiscard]] static ExitCode addPlace(const std::string& name,
                                           const std::optional<std::string>& location,
                                           const CommandContext& context);
    [[nodiscard]] static ExitCode addLines(const std::vector<std::string>& names,
                                           CommandContext& context);
};

} // namespace orvo
