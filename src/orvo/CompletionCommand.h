#pragma once

#include "orvo/Command.h"
#include "orvo/console/HelpText.h"

namespace orvo {

/// `orvo completion`: scripts for shells, and the words that those ask for.
class CompletionCommand final : public Command {
public:
    /// The program is read when the command runs, and must outlive it.
    explicit CompletionCommand(const ProgramSpec& program)
        : _program(program) {}

    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;

private:
    /// A line each.
    [[nodiscard]] static ExitCode printWords(const std::string& kind, CommandContext& context);

    const ProgramSpec& _program;
};

} // namespace orvo
