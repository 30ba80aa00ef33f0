#include "orvo/HelpCommand.h"

#include <ostream>

namespace orvo {

CommandSpec HelpCommand::spec() const {
    return {.path = {"help"},
            .summary = "Explain a command",
            .description = "",
            .operands = {{.name = "COMMAND",
                          .help = "its words; without them all commands are listed",
                          .count = OperandSpec::Count::Any,
                          .completes = Completes::Command}},
            .examples = {{"orvo help feeds add", "the same as orvo feeds add --help"}}};
}

ExitCode HelpCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto& terminal = context.terminal();
    const std::size_t width = terminal.settings().width;
    std::vector<std::string> path;
    for (const auto& word : arguments.operands()) {
        auto longer = path;
        longer.push_back(word);
        if (!_program.command(longer) && _program.commandsBelow(longer).empty()) {
            const auto error = _program.noSuchCommand(path, word);
            return context.wrongUsage(error.message, error.cure);
        }
        path = std::move(longer);
    }
    if (const auto* command = _program.command(path))
        terminal.output() << HelpText::command(_program, *command, width);
    else
        terminal.output() << (path.empty() ? HelpText::program(_program, width)
                                           : HelpText::group(_program, path, width));
    return ExitCode::Answered;
}

} // namespace orvo
