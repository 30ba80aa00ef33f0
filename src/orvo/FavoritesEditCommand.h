#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo favorites edit`: the favourites in a window.
class FavoritesEditCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
    [[nodiscard]] bool changesWhatIsKept(const Arguments& /*arguments*/) const override {
        return true;
    }
    [[nodiscard]] bool showsWindows() const override { return true; }
};

} // namespace orvo
