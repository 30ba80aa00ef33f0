#include "print/WidgetOptions.h"

#include "orvo/console/Completion.h"
#include "orvo/console/LanguageTag.h"
#include "platform/foundation/ISO8601.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <fmt/format.h>
#include <functional>

namespace orvo {

namespace {

constexpr double MinimumWidth = 160;
constexpr double MaximumWidth = 2000;
/// What is done once, of which there can be one. Without any of them the widget opens a window.
constexpr std::array Tasks{"open", "snapshot", "dump", "print"};
/// Options that say how a picture looks; a window looks as the desktop does.
constexpr std::array Looks{"scale", "text-size", "dark", "contrast"};

std::vector<std::string> textSizes() {
    std::vector<std::string> names;
    names.reserve(std::size(AllContentSizeCategories));
    for (const auto category : AllContentSizeCategories)
        names.emplace_back(nameOf(category));
    return names;
}

std::vector<OptionSpec> optionSpecs() {
    return {{.name = "print",
             .value = "FORM",
             .help = "text, json (for scripts), or waybar (one object for a desktop bar)",
             .completes = Completes::Word,
             .words = {"text", "json", "waybar"}},
            {"payloads", "", "with --print json: what is handed over, data in base64"},
            {"follow", "", "go on until Ctrl-C, and print again when something has changed"},
            {"open", "ROW", "tap that row, from 0: the map application opens what it is about"},
            {.name = "snapshot",
             .value = "FILE",
             .help = "draw the widget's card, all its rows, into a PNG file",
             .completes = Completes::File},
            {"pictures",
             "FOLDER",
             "when printing: draw the widget in both modes besides, into files in that folder"},
            {.name = "dump",
             .value = "WHAT",
             .help = "what the picture is made of: views, constraints, or the archive that is "
                     "kept between starts",
             .completes = Completes::Word,
             .words = {"views", "constraints", "archive"}},
            {.name = "mode",
             .value = "MODE",
             .help = "of the tapped row, the picture or the dump: compact or expanded; if you say "
                     "nothing, expanded where there is more to show; of the window at its start, "
                     "the one you chose last if you say nothing",
             .completes = Completes::Word,
             .words = {"compact", "expanded"}},
            {"width",
             "POINTS",
             fmt::format("of the window or the picture, {} to {}, {} if you say nothing",
                         MinimumWidth,
                         MaximumWidth,
                         WidgetHostSettings::StandardWidth)},
            {.name = "scale",
             .value = "N",
             .help = "pixels a point: 1, 2 or 3",
             .completes = Completes::Word,
             .words = {"1", "2", "3"}},
            {.name = "text-size",
             .value = "SIZE",
             .help = "XS to XXXL, and AX1 to AX5; L if you say nothing",
             .completes = Completes::Word,
             .words = textSizes()},
            {"dark", "", "as on a dark desktop"},
            {"contrast", "", "with more contrast"},
            {"max-rows",
             "N",
             "expanded rows at most, 0 for all; if you say nothing, five, and in a window what the "
             "screen has room for; what is too many becomes one row"},
            {.name = "completion",
             .value = "SHELL",
             .help = "print a shell's completion script: bash, zsh or fish",
             .completes = Completes::Word,
             .words = Completion::shells()},
            {"version", "", "show the version"}};
}

CommandSpec spec() {
    return {
        .path = {},
        .summary = "Shows whether your favourite transit lines run normally",
        .description =
            "Opens the widget in a window: a card that follows the looks of your desktop, and goes "
            "when you close it (Escape, Ctrl-W). Without a display, or with --print, it prints its "
            "rows: the one of its compact mode, and those of its expanded mode, with the numbers "
            "that --open takes. On your own profile printing writes nothing.",
        .options = optionSpecs(),
        .examples = {{"orvo-transit-widget --demo", "the demonstration city in a window"},
                     {"orvo-transit-widget --demo --print text", "its rows as text"},
                     {"orvo-transit-widget --print json --max-rows 0", "every row, for a script"},
                     {"orvo-transit-widget --print waybar --follow", "for a bar that reads lines"},
                     {"orvo-transit-widget --open 0", "what the first row is about"},
                     {"orvo-transit-widget --snapshot card.png --scale 2 --dark", "a picture"}}};
}

ProgramSpec programSpec() {
    return {WidgetOptions::ProgramName, "", {spec()}};
}

std::optional<std::uint64_t> number(const std::string& text) {
    std::uint64_t value = 0;
    const char* end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, value);
    return read.ec == std::errc() && read.ptr == end ? std::optional(value) : std::nullopt;
}

/// Reads a number into `target`, where the option is given.
std::optional<UsageError> readNumber(const Arguments& arguments,
                                     const char* option,
                                     const std::function<void(std::uint64_t)>& take) {
    const auto given = arguments.value(option);
    if (!given)
        return std::nullopt;
    const auto value = number(*given);
    if (!value)
        return UsageError{fmt::format("--{}: \"{}\" is no number of rows", option, *given),
                          "Write a whole number, from 0."};
    take(*value);
    return std::nullopt;
}

std::optional<UsageError> readEnvironment(const Arguments& arguments, WidgetOptions& options) {
    options.usesDemonstration = arguments.has("demo");
    options.language = arguments.value("language");
    if (options.language && !isLanguageTag(*options.language))
        return UsageError{fmt::format("--language: \"{}\" is no language", *options.language),
                          "Write it as de or pt-BR."};
    if (options.language)
        std::ranges::replace(*options.language, '_', '-');
    if (const auto at = arguments.value("at")) {
        options.at = ISO8601::parse(*at);
        if (!options.at)
            return UsageError{fmt::format("--at: \"{}\" is no time", *at),
                              "Write it as 2024-07-24T01:28:40Z."};
    }
    return std::nullopt;
}

std::optional<UsageError> readLooks(const Arguments& arguments, WidgetOptions& options) {
    auto& traits = options.traits;
    traits.reducesMotion = true; // pictures stand still
    traits.displayScale = arguments.has("scale") ? std::stod(*arguments.value("scale")) : 1;
    if (arguments.has("dark"))
        traits.userInterfaceStyle = UIUserInterfaceStyle::Dark;
    if (arguments.has("contrast"))
        traits.accessibilityContrast = UIAccessibilityContrast::High;
    if (const auto size = arguments.value("text-size"))
        traits.preferredContentSizeCategory = *contentSizeCategoryNamed(*size);
    if (const auto given = arguments.value("width")) {
        const auto width = number(*given);
        if (!width || static_cast<double>(*width) < MinimumWidth ||
            static_cast<double>(*width) > MaximumWidth)
            return UsageError{fmt::format("--width: \"{}\" is no width", *given),
                              fmt::format("Write a whole number of points from {} to {}.",
                                          MinimumWidth,
                                          MaximumWidth)};
        options.width = static_cast<double>(*width);
    }
    return std::nullopt;
}

bool hasTask(const Arguments& arguments) {
    return std::ranges::any_of(Tasks, [&](const char* task) { return arguments.has(task); }) ||
           arguments.has("follow");
}

/// What makes no sense together.
std::optional<UsageError> findContradiction(const Arguments& arguments, bool showsWindow) {
    for (std::size_t one = 0; one < Tasks.size(); ++one)
        for (std::size_t other = one + 1; other < Tasks.size(); ++other)
            if (arguments.has(Tasks[one]) && arguments.has(Tasks[other]))
                return UsageError{
                    fmt::format("--{} does not go with --{}", Tasks[one], Tasks[other]),
                    "Leave one of them out."};
    for (const char* task : {"open", "snapshot", "dump"})
        if (arguments.has(task) && arguments.has("follow"))
            return UsageError{fmt::format("--{} does not go with --follow", task),
                              "Leave one of them out."};
    for (const char* task : {"open", "snapshot", "dump", "follow"})
        if (arguments.has(task) && arguments.has("pictures"))
            return UsageError{fmt::format("--pictures does not go with --{}", task),
                              "Leave one of them out."};
    const bool draws =
        arguments.has("snapshot") || arguments.has("dump") || arguments.has("pictures");
    const bool isAlone =
        arguments.has("open") || arguments.has("snapshot") || arguments.has("dump");
    if (arguments.has("mode") && !isAlone && !showsWindow)
        return UsageError{"--mode belongs to --open, --snapshot, --dump or a window",
                          "Both modes are printed."};
    if (arguments.has("width") && !draws && !showsWindow)
        return UsageError{"--width belongs to --snapshot, --pictures, --dump or a window", ""};
    for (const char* look : Looks)
        if (arguments.has(look) && !draws)
            return UsageError{fmt::format("--{} belongs to --snapshot, --pictures or --dump", look),
                              showsWindow ? "A window looks as the desktop does." : ""};
    if (arguments.has("payloads") && arguments.value("print") != "json")
        return UsageError{"--payloads belongs to --print json", ""};
    return std::nullopt;
}

std::optional<WidgetOptions::Dump> dumpNamed(const std::optional<std::string>& name) {
    if (!name)
        return std::nullopt;
    if (*name == "views")
        return WidgetOptions::Dump::Views;
    return *name == "archive" ? WidgetOptions::Dump::Archive : WidgetOptions::Dump::Constraints;
}

WidgetOptions::Form formNamed(const std::string& name) {
    if (name == "json")
        return WidgetOptions::Form::Json;
    return name == "waybar" ? WidgetOptions::Form::Waybar : WidgetOptions::Form::Text;
}

} // namespace

std::variant<WidgetOptions, UsageError> WidgetOptions::parse(const std::vector<std::string>& words,
                                                             Display display) {
    const auto command = spec();
    const auto parsed = ArgumentParser(command, ProgramName).parse(words);
    if (const auto* error = std::get_if<UsageError>(&parsed))
        return *error;
    const auto& arguments = std::get<Arguments>(parsed);
    WidgetOptions options;
    options.wantsHelp = arguments.has("help");
    options.wantsVersion = arguments.has("version");
    options.completion = arguments.value("completion");
    if (options.wantsHelp || options.wantsVersion || options.completion)
        return options;
    options.showsWindow = display == Display::Present && !hasTask(arguments);
    if (const auto error = findContradiction(arguments, options.showsWindow))
        return *error;
    if (const auto error = readEnvironment(arguments, options))
        return *error;
    if (const auto error = readLooks(arguments, options))
        return *error;
    if (const auto error =
            readNumber(arguments, "open", [&](std::uint64_t row) { options.open = row; }))
        return *error;
    if (const auto error =
            readNumber(arguments, "max-rows", [&](std::uint64_t rows) { options.maxRows = rows; }))
        return *error;
    options.form = formNamed(arguments.value("print").value_or("text"));
    options.snapshot = arguments.value("snapshot");
    options.pictures = arguments.value("pictures");
    options.dump = dumpNamed(arguments.value("dump"));
    options.withPayloads = arguments.has("payloads");
    options.follows = arguments.has("follow");
    if (const auto mode = arguments.value("mode"))
        options.mode =
            *mode == "compact" ? NCWidgetDisplayMode::Compact : NCWidgetDisplayMode::Expanded;
    return options;
}

std::string WidgetOptions::help(std::size_t width) {
    const auto program = programSpec();
    return HelpText::command(program, program.commands.front(), width) +
           "\nExit status: 0 answered, 1 could not, 2 wrong usage.\n";
}

std::string WidgetOptions::completionScript(const std::string& shell) {
    return Completion::script(programSpec(), shell);
}

} // namespace orvo
