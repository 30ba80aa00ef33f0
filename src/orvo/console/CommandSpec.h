#pragma once

#include <string>
#include <vector>

namespace orvo {

/// What a shell offers where a value stands. Only a `Word` must be one of those that are offered.
enum class Completes {
    Nothing,
    File,
    Feed,
    Line,
    Favorite,
    Command, ///< of an operand: the words of the program's commands, one after the other
    Word,
    Suggestion,
};

/// `--name VALUE` or the switch `--name`.
struct OptionSpec {
    std::string name;  ///< without dashes
    std::string value; ///< what stands for the value in the help; empty for a switch
    std::string help;  ///< one sentence without its full stop
    /// May be given several times, and takes every following word up to the next option.
    bool takesSeveral = false;
    Completes completes = Completes::Nothing;
    std::vector<std::string> words = {}; ///< with `Completes::Word`: all permitted values
    bool isRequired = false;
};

/// A word of the command line that is no option.
struct OperandSpec {
    enum class Count { One, Optional, OneOrMore, Any };

    std::string name; ///< in capitals, as the help shows it
    std::string help;
    Count count = Count::One;
    Completes completes = Completes::Nothing;
    std::vector<std::string> words = {}; ///< with `Completes::Word`: all permitted values
};

struct Example {
    std::string command;
    std::string explanation;
};

/// All that there is to know about one command: its parsing, its help and its completion come from
/// here.
struct CommandSpec {
    std::vector<std::string> path; ///< `{"feeds", "add"}`
    std::string summary;           ///< one line, without a full stop
    std::string description;       ///< paragraphs for `--help`; may be empty
    std::vector<OperandSpec> operands = {};
    std::vector<OptionSpec> options = {};
    std::vector<Example> examples = {};
    std::string synopsis = {}; ///< what `usage` says after the name; empty: made from the above

    /// `feeds add`.
    [[nodiscard]] std::string name() const;
    /// `feeds add NAME --static PATH|URL [OPTION]…`: all but the options that may be left out.
    [[nodiscard]] std::string usage() const;
};

/// The options that every command takes.
[[nodiscard]] const std::vector<OptionSpec>& globalOptions();

} // namespace orvo
