#pragma once

#include "orvo/console/Arguments.h"
#include "orvo/console/CommandSpec.h"

#include <string>
#include <vector>

namespace orvo {

/// The program as its help and its completions know it.
struct ProgramSpec {
    std::string name;
    std::string summary;
    std::vector<CommandSpec> commands; ///< in the order of the help

    /// The command with exactly that path, or nil.
    [[nodiscard]] const CommandSpec* command(const std::vector<std::string>& path) const;
    /// The commands whose path begins so, in order.
    [[nodiscard]] std::vector<const CommandSpec*>
    commandsBelow(const std::vector<std::string>& path) const;
    /// What to say of a word that is no command below the path: the one that was meant, or where to
    /// look.
    [[nodiscard]] UsageError noSuchCommand(const std::vector<std::string>& path,
                                           const std::string& word) const;
};

/// What `--help` prints, at most `width` columns wide.
namespace HelpText {

[[nodiscard]] std::string program(const ProgramSpec& program, std::size_t width);
/// Of the commands below a word, as `feeds`.
[[nodiscard]] std::string
group(const ProgramSpec& program, const std::vector<std::string>& path, std::size_t width);
[[nodiscard]] std::string
command(const ProgramSpec& program, const CommandSpec& command, std::size_t width);

} // namespace HelpText

} // namespace orvo
