#pragma once

#include "orvo/Command.h"
#include "orvo/console/HelpText.h"

namespace orvo {

/// `orvo help`: what `--help` prints, of the program, a group of commands or one of them.
class HelpCommand final : public Command {
public:
    /// The program must outlive the command.
    explicit HelpCommand(const ProgramSpec& program)
        : _program(program) {}

    [[nodiscard]] CommandSpec spec() const override;
    [[nodiscard]] ExitCode run(const Arguments& arguments, CommandContext& context) override;

private:
    const ProgramSpec& _program;
};

} // namespace orvo
