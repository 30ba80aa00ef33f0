#pragma once

#include "orvo/CommandContext.h"
#include "orvo/console/Arguments.h"
#include "orvo/console/CommandSpec.h"
#include "orvo/console/ExitCode.h"

namespace orvo {

/// One command of the program.
class Command {
public:
    Command() = default;
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;
    virtual ~Command() = default;

    /// The same at every call.
    [[nodiscard]] virtual CommandSpec spec() const = 0;
    /// Does what was asked. What fails is said on the terminal before it answers.
    [[nodiscard]] virtual ExitCode run(const Arguments& arguments, CommandContext& context) = 0;
    /// Whether the command, with these arguments, changes what is kept on this machine. Such a
    /// command is refused with `--at`, which keeps nothing.
    [[nodiscard]] virtual bool changesWhatIsKept(const Arguments& /*arguments*/) const {
        return false;
    }
    /// Whether the command shows windows where there is a display.
    [[nodiscard]] virtual bool showsWindows() const { return false; }
    /// Whether the command makes the demonstration city itself, instead of finding it made by
    /// `--demo`.
    [[nodiscard]] virtual bool writesDemonstration() const { return false; }
};

} // namespace orvo
