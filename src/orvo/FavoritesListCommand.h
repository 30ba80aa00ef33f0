#pragma once

#include "orvo/Command.h"

namespace orvo {

/// `orvo favorites list`.
class FavoritesListCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;
};

} // namespace orvo
