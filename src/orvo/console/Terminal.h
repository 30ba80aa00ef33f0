#pragma once

#include <iosfwd>
#include <string>
#include <string_view>

namespace orvo {

/// Where a command writes: what was asked for on the output, everything else (errors, notes,
/// progress) on the error output. Colours and progress only where a person looks.
class Terminal {
public:
    struct Settings {
        bool outputIsTerminal = false;
        bool errorIsTerminal = false;
        bool usesStyles = false;
        std::size_t width = 80;       ///< columns, at least 20
        std::string program = "orvo"; ///< who speaks in errors
    };
    enum class Style { Plain, Bold, Faint, Good, Advisory };

    Terminal(std::ostream& output, std::ostream& error, Settings settings);

    /// The process's own: width from the terminal (or `COLUMNS`), no styles with `NO_COLOR` or a
    /// dumb terminal.
    [[nodiscard]] static Terminal standard(std::string program = "orvo");

    [[nodiscard]] const Settings& settings() const noexcept { return _settings; }
    [[nodiscard]] std::ostream& output() const noexcept { return *_output; }

    /// The text with its style, or bare where the output shows none.
    [[nodiscard]] std::string styled(std::string_view text, Style style) const;

    /// `PROGRAM: message`, then the cure on a line of its own when there is one.
    void error(std::string_view message, std::string_view cure = {}) const;
    /// `PROGRAM: warning: message`.
    void warning(std::string_view message, std::string_view cure = {}) const;
    /// What a person may want to know, on the error output, so that pipes stay clean.
    void note(std::string_view message) const;

    /// A line that the next one replaces; nothing unless a person looks at the error output.
    void progress(std::string_view message) const;
    /// Takes the last progress line away.
    void endProgress() const;

private:
    std::ostream* _output;
    std::ostream* _error;
    Settings _settings;
    mutable bool _showsProgress = false;
};

} // namespace orvo
