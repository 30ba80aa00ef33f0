#pragma once

#include "orvo/Command.h"
#include "orvo/console/HelpText.h"
#include "orvo/console/Terminal.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Text.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class DemoVisit;

/// The program `orvo`: finds the command that the words name, and runs it with what the options of
/// every command ask for. Those hold while the program lives.
class Program {
public:
    /// With all commands.
    explicit Program(Terminal terminal);
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;
    ~Program();

    /// The words of the command line without the program's name.
    [[nodiscard]] ExitCode run(const std::vector<std::string>& words);

    [[nodiscard]] const ProgramSpec& spec() const noexcept { return _spec; }

private:
    struct Choice;
    [[nodiscard]] Choice choose(const std::vector<std::string>& words) const;
    [[nodiscard]] ExitCode runCommand(std::size_t index, const std::vector<std::string>& words);
    /// Turns the environment; an exit code when that fails.
    [[nodiscard]] std::optional<ExitCode> applyGlobalOptions(const Arguments& arguments,
                                                             const Command& command);

    Terminal _terminal;
    std::vector<std::unique_ptr<Command>> _commands;
    ProgramSpec _spec; ///< its commands in the order of `_commands`
    std::optional<EnvironmentSlot<std::shared_ptr<WallClock>>::Override> _clock;
    std::optional<EnvironmentSlot<bool>::Override> _keepsWritesInMemory;
    std::optional<EnvironmentSlot<std::string>::Override> _language;
    std::unique_ptr<DemoVisit> _demonstration;
};

} // namespace orvo
