#include "orvo/FavoritesMoveCommand.h"

#include "orvo/FavoriteReference.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

CommandSpec FavoritesMoveCommand::spec() const {
    return {
        .path = {"favorites", "move"},
        .summary = "Give a favourite another place in the order",
        .description = "",
        .operands = {{.name = "FAVORITE",
                      .help =
                          "its number in the list, FEED:ROUTE_ID, or its name, also the one that "
                          "it had when it was added",
                      .completes = Completes::Favorite},
                     {.name = "POSITION",
                      .help = "the number that it will have; beyond the last is the last"}},
        .examples = {{"orvo favorites move city:T4 1", "to the top"}}};
}

ExitCode FavoritesMoveCommand::run(const Arguments& arguments, CommandContext& context) {
    const std::string position = arguments.operands()[1];
    std::size_t number = 0;
    const char* end = position.data() + position.size();
    const auto parsed = std::from_chars(position.data(), end, number);
    if (parsed.ec != std::errc() || parsed.ptr != end || number == 0)
        return context.wrongUsage(fmt::format("POSITION cannot be {}", position),
                                  "Write a number from 1.");
    std::shared_ptr<NSError> error;
    const auto store = CommandContext::favorites(FavoritesStore::Access::Write, error);
    if (!store)
        return context.fail(*error);
    const auto entries = store->entries(&error);
    if (error)
        return context.fail(*error);
    const auto schedules = context.schedulesIfReadable();
    const auto answer =
        FavoriteReference::resolve(entries, arguments.operands()[0], schedules.get());
    if (!answer.index)
        return context.fail(answer.message, answer.cure);
    const auto& entry = entries[*answer.index];
    if ((error = store->move(entry.number, number - 1)))
        return context.fail(*error);
    context.terminal().output() << fmt::format(
        "{} is number {} now\n",
        FavoriteReference::nameOf(*entry.favorite, schedules.get()),
        std::min(number, entries.size()));
    return ExitCode::Answered;
}

} // namespace orvo
