#include "orvo/FavoritesEditCommand.h"

#include "orvo/HandOffReceiver.h"
#include "orvo/window/WindowApplication.h"

namespace orvo {

CommandSpec FavoritesEditCommand::spec() const {
    return {.path = {"favorites", "edit"},
            .summary = "Edit the favourites in a window",
            .description =
                "Finds and adds lines, changes the order and removes. What is changed is kept at "
                "once. An orvo that runs already shows it; else this one does, until its last "
                "window is closed.",
            .examples = {{"orvo favorites edit", "on a display"}}};
}

ExitCode FavoritesEditCommand::run(const Arguments&, CommandContext& context) {
    if (!WindowApplication::isMade())
        return context.fail("there is no display to show a window on",
                            "Use: orvo favorites add, list, move and remove");
    return HandOffReceiver::takeForCommand(
        HandOff::ofURL("orvo://?favorites=2&t=r"), context, HandOffReceiver::Audience::Nobody);
}

} // namespace orvo
