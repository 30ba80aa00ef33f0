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
    enum class Dump { Views, Constraints, Archive };

    Form form = Form::Text;
    bool withPayloads = false;
    bool follows = false;
    std::optional<std::uint64_t> open;   ///< the row to tap, from 0
    std::optional<std::string> snapshot; ///< the file for a picture
    std::optional<Dump> dump;
    /// Of the row to tap, the picture and the dump; nothing is the largest that there is.
    std::optional<NCWidgetDisplayMode> mode;
    std::optional<std::uint64_t> maxRows; ///< 0 is no limit; nothing is what a screen has room for
    double width = WidgetHostSettings::StandardWidth; ///< in points
    UITraitCollection traits = {};                    ///< without the language's direction
    std::optional<double> at;                         ///< seconds since 1970
    std::optional<std::string> language;
    bool usesDemonstration = false;
    bool wantsHelp = false;
    bool wantsVersion = false;

    /// Whether a picture or a dump is asked for.
    [[nodiscard]] bool draws() const noexcept { return snapshot.has_value() || dump.has_value(); }

    /// The words of the command line without the program's name.
    [[nodiscard]] static std::variant<WidgetOptions, UsageError>
    parse(const std::vector<std::string>& words);
    /// What `--help` prints, at most `width` columns wide.
    [[nodiscard]] static std::string help(std::size_t width);
};

} // namespace orvo
