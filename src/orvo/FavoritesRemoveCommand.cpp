#include "orvo/FavoritesRemoveCommand.h"

#include "orvo/FavoriteReference.h"

#include <algorithm>
#include <ostream>

namespace orvo {

CommandSpec FavoritesRemoveCommand::spec() const {
    return {
        .path = {"favorites", "remove"},
        .summary = "Remove favourites",
        .description = "Either all that are named are found, or none is removed.",
        .operands = {{.name = "FAVORITE",
                      .help =
                          "its number in the list, FEED:ROUTE_ID, or its name, also the one that "
                          "it had when it was added",
                      .count = OperandSpec::Count::OneOrMore,
                      .completes = Completes::Favorite}},
        .examples = {{"orvo favorites remove city:T4 Home", "a line and a place"}}};
}

ExitCode FavoritesRemoveCommand::run(const Arguments& arguments, CommandContext& context) {
    std::shared_ptr<NSError> error;
    const auto store = CommandContext::favorites(FavoritesStore::Access::Write, error);
    if (!store)
        return context.fail(*error);
    const auto entries = store->entries(&error);
    if (error)
        return context.fail(*error);
    const auto schedules = context.schedulesIfReadable();
    std::vector<std::size_t> chosen;
    for (const auto& name : arguments.operands()) {
        const auto answer = FavoriteReference::resolve(entries, name, schedules.get());
        if (!answer.index)
            return context.fail(answer.message, answer.cure);
        if (std::ranges::count(chosen, *answer.index) == 0)
            chosen.push_back(*answer.index);
    }
    for (const std::size_t index : chosen) {
        if ((error = store->remove(entries[index].number)))
            return context.fail(*error);
        context.terminal().output()
            << "Removed " << FavoriteReference::nameOf(*entries[index].favorite, schedules.get())
            << '\n';
    }
    return ExitCode::Answered;
}

} // namespace orvo
