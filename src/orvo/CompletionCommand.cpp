#include "orvo/CompletionCommand.h"

#include "orvo/FavoriteReference.h"
#include "orvo/LineReference.h"
#include "orvo/console/Completion.h"

#include <algorithm>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

constexpr const char* Words = "words";

/// One word a line: a name that breaks the line cannot be told as one, and its pieces would be
/// names of nothing.
void printWord(std::ostream& output, const std::string& word) {
    if (word.find('\n') == std::string::npos)
        output << word << '\n';
}

} // namespace

CommandSpec CompletionCommand::spec() const {
    auto shells = Completion::shells();
    shells.emplace_back(Words);
    return {
        .path = {"completion"},
        .summary = "Print a shell's completion script",
        .description = "The scripts ask `orvo completion words` for the names that only this "
                       "machine has.",
        .operands = {{.name = "SHELL",
                      .help = "bash, zsh or fish",
                      .completes = Completes::Word,
                      .words = shells},
                     {.name = "KIND",
                      .help = "with words: feeds, lines or favorites",
                      .count = OperandSpec::Count::Optional,
                      .completes = Completes::Word,
                      .words = {"feeds", "lines", "favorites"}}},
        .examples = {
            {"orvo completion bash > ~/.local/share/bash-completion/completions/orvo", "for bash"},
            {"orvo completion zsh > ~/.zfunc/_orvo", "for zsh, with ~/.zfunc in its fpath"},
            {"orvo completion fish > ~/.config/fish/completions/orvo.fish", "for fish"}}};
}

ExitCode CompletionCommand::run(const Arguments& arguments, CommandContext& context) {
    const std::string& shell = arguments.operands().front();
    const auto kind = arguments.operand(1);
    if (shell == Words)
        return kind ? printWords(*kind, context)
                    : context.wrongUsage("KIND is missing", "Choose feeds, lines or favorites.");
    if (kind)
        return context.wrongUsage(fmt::format("\"{}\" is one word too many", *kind));
    context.terminal().output() << Completion::script(_program, shell);
    return ExitCode::Answered;
}

ExitCode CompletionCommand::printWords(const std::string& kind, CommandContext& context) {
    std::shared_ptr<NSError> error;
    auto& output = context.terminal().output();
    if (kind == "favorites") {
        const auto store = CommandContext::favorites(FavoritesStore::Access::Read, error);
        if (!store)
            return context.fail(*error);
        for (const auto& entry : store->entries(&error))
            printWord(output,
                      FavoriteReference::lineNameOf(*entry.favorite)
                          .value_or(FavoriteReference::nameOf(*entry.favorite, nullptr)));
        return error ? context.fail(*error) : ExitCode::Answered;
    }
    const auto schedules = context.schedules(error);
    if (!schedules)
        return context.fail(*error);
    for (const auto& feed : schedules->feeds(&error)) {
        if (kind == "feeds") {
            output << feed << '\n';
            continue;
        }
        for (const auto& line : schedules->lines(feed, &error))
            printWord(output, LineReference::nameOf(feed, line.routeId));
    }
    return error ? context.fail(*error) : ExitCode::Answered;
}

} // namespace orvo
