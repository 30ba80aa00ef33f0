#pragma once

#include "orvo/Command.h"
#include "orvo/IncidentReport.h"

namespace orvo {

/// `orvo incidents`: what is known now of the favourite lines, or of all.
class IncidentsCommand final : public Command {
public:
    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;

private:
    /// The way the widget goes.
    [[nodiscard]] static IncidentReport ofFavorites(CommandContext& context);
    [[nodiscard]] static IncidentReport ofAllLines(CommandContext& context);
    /// Once a day, after the answer, since nobody else may do it on this machine.
    static void lookForNewerSchedules(const CommandContext& context);
};

} // namespace orvo
