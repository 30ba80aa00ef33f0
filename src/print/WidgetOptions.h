#pragma once

#include "orvo/console/Arguments.h"
#include "orvo/console/HelpText.h"
#include "platform/extension/WidgetHost.h"

#include <cstdint>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace orvo {

/// What the command line of the widget's program asks for.
struct WidgetOptions {
    static constexpr const char* ProgramName = "orvo-transit-widget";

    enum class Form { Text, Json, Waybar };
    /// What the program can show windows on.
    enum class Display { None, Present };
    enum class Dump { Views, Constraints, Archive };

    bool showsWindow = false; ///< instead of printing: nothing else was asked for
    Form form = Form::Text;
    bool withPayloads = false;
    bool follows = false;
    std::optional<std::uint64_t> open;   ///< the row to tap, from 0
    std::optional<std::string> snapshot; ///< the file for a picture
    std::optional<Dump> dump;
    std::optional<std::string> pictures; ///< the folder for pictures beside what is printed
    /// Of the row to tap, the picture and the dump, where nothing is the largest that there is; and
    /// of the window, where nothing is the last one chosen.
    std::optional<NCWidgetDisplayMode> mode;
    std::optional<std::uint64_t> maxRows; ///< 0 is no limit; nothing is what a screen has room for
    double width = WidgetHostSettings::StandardWidth; ///< in points
    UITraitCollection traits = {};                    ///< without the language's direction
    std::optional<double> at;                         ///< seconds since 1970
    std::optional<std::string> language;
    bool usesDemonstration = false;
    bool wantsHelp = false;
    bool wantsVersion = false;
    std::optional<std::string> completion; ///< the shell whose completion script is asked for

    /// Whether a picture or a dump is asked for.
    [[nodiscard]] bool draws() const noexcept { return snapshot.has_value() || dump.has_value(); }

    /// The words of the command line without the program's name.
    [[nodiscard]] static std::variant<WidgetOptions, UsageError>
    parse(const std::vector<std::string>& words, Display display = Display::None);
    /// What `--help` prints, at most `width` columns wide.
    [[nodiscard]] static std::string help(std::size_t width);
    /// What `--completion` prints for one of the shells.
    [[nodiscard]] static std::string completionScript(const std::string& shell);
};

} // namespace orvo
