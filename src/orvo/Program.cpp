#include "orvo/Program.h"

#include "orvo/AnalyticsCommand.h"
#include "orvo/CompletionCommand.h"
#include "orvo/DamageWatch.h"
#include "orvo/DefaultsDeleteCommand.h"
#include "orvo/DefaultsReadCommand.h"
#include "orvo/DefaultsWriteCommand.h"
#include "orvo/DemoCommand.h"
#include "orvo/FavoritesAddCommand.h"
#include "orvo/FavoritesEditCommand.h"
#include "orvo/FavoritesListCommand.h"
#include "orvo/FavoritesMoveCommand.h"
#include "orvo/FavoritesRemoveCommand.h"
#include "orvo/FeedsAddCommand.h"
#include "orvo/FeedsCheckCommand.h"
#include "orvo/FeedsListCommand.h"
#include "orvo/FeedsRemoveCommand.h"
#include "orvo/FeedsUpdateCommand.h"
#include "orvo/HelpCommand.h"
#include "orvo/IncidentsCommand.h"
#include "orvo/LinesCommand.h"
#include "orvo/OpenCommand.h"
#include "orvo/ReceiveCommand.h"
#include "orvo/ServiceCommand.h"
#include "orvo/SettingsCommand.h"
#include "orvo/ShowCommand.h"
#include "orvo/Version.h"
#include "orvo/console/LanguageTag.h"
#include "orvo/window/WindowApplication.h"
#include "platform/demo/DemoVisit.h"
#include "platform/foundation/ISO8601.h"
#include "platform/foundation/NSDate.h"

#include <algorithm>
#include <fmt/format.h>
#include <ostream>
#include <utility>

namespace orvo {

/// Where the words lead: a command (its index) or a group of commands, and what is left of the
/// words.
struct Program::Choice {
    std::optional<std::size_t> command;
    std::vector<std::string> path;
    std::vector<std::string> rest;
    std::optional<std::string> unknownWord;
};

Program::Program(Terminal terminal)
    : _terminal(std::move(terminal)) {
    const auto add = [this](auto command) {
        _commands.push_back(std::move(command));
    };
    add(std::make_unique<IncidentsCommand>());
    add(std::make_unique<LinesCommand>());
    add(std::make_unique<FavoritesAddCommand>());
    add(std::make_unique<FavoritesListCommand>());
    add(std::make_unique<FavoritesEditCommand>());
    add(std::make_unique<FavoritesMoveCommand>());
    add(std::make_unique<FavoritesRemoveCommand>());
    add(std::make_unique<FeedsAddCommand>());
    add(std::make_unique<FeedsListCommand>());
    add(std::make_unique<FeedsUpdateCommand>());
    add(std::make_unique<FeedsCheckCommand>());
    add(std::make_unique<FeedsRemoveCommand>());
    add(std::make_unique<OpenCommand>());
    add(std::make_unique<ShowCommand>());
    add(std::make_unique<ReceiveCommand>());
    add(std::make_unique<ServiceCommand>());
    add(std::make_unique<AnalyticsCommand>());
    add(std::make_unique<SettingsCommand>());
    add(std::make_unique<DefaultsReadCommand>());
    add(std::make_unique<DefaultsWriteCommand>());
    add(std::make_unique<DefaultsDeleteCommand>());
    add(std::make_unique<DemoCommand>());
    add(std::make_unique<CompletionCommand>(_spec));
    add(std::make_unique<HelpCommand>(_spec));
    _spec.name = "orvo";
    _spec.summary = "Keeps what the transit widget shows: feeds, favourite lines and their "
                    "incidents on this machine.";
    for (const auto& command : _commands)
        _spec.commands.push_back(command->spec());
}

Program::~Program() = default;

ExitCode Program::run(const std::vector<std::string>& words) {
    const auto has = [&](const char* option) {
        return std::ranges::count(words, option) > 0;
    };
    const Choice choice = choose(words);
    const std::size_t width = _terminal.settings().width;
    if (choice.command)
        return runCommand(*choice.command, choice.rest);
    if (choice.unknownWord) {
        const auto error = _spec.noSuchCommand(choice.path, *choice.unknownWord);
        _terminal.error(error.message, error.cure);
        return ExitCode::WrongUsage;
    }
    if (choice.path.empty() && has("--version")) {
        _terminal.output() << "orvo " << Version << '\n';
        return ExitCode::Answered;
    }
    const std::string help = choice.path.empty() ? HelpText::program(_spec, width)
                                                 : HelpText::group(_spec, choice.path, width);
    if (has("--help") || has("-h")) {
        _terminal.output() << help;
        return ExitCode::Answered;
    }
    const auto options = ArgumentParser({.path = choice.path}).parse(choice.rest);
    if (const auto* error = std::get_if<UsageError>(&options)) {
        _terminal.error(error->message, error->cure);
        return ExitCode::WrongUsage;
    }
    std::string given = "orvo";
    for (const auto& word : choice.path)
        given += " " + word;
    _terminal.error("which command?", fmt::format("See: {} --help", given));
    return ExitCode::WrongUsage;
}

Program::Choice Program::choose(const std::vector<std::string>& words) const {
    Choice choice;
    for (std::size_t i = 0; i < words.size(); ++i) {
        const std::string& word = words[i];
        // An option may stand before its command; the value of the two that have one is not the
        // command's name.
        if (!word.empty() && word.front() == '-') {
            choice.rest.push_back(word);
            if ((word == "--at" || word == "--language") && i + 1 < words.size())
                choice.rest.push_back(words[++i]);
            continue;
        }
        auto path = choice.path;
        path.push_back(word);
        const auto* command = _spec.command(path);
        if (command) {
            choice.command = static_cast<std::size_t>(command - _spec.commands.data());
            choice.rest.insert(
                choice.rest.end(), words.begin() + static_cast<long>(i) + 1, words.end());
            return choice;
        }
        if (_spec.commandsBelow(path).empty()) {
            choice.unknownWord = word;
            return choice;
        }
        choice.path = std::move(path);
    }
    return choice;
}

ExitCode Program::runCommand(std::size_t index, const std::vector<std::string>& words) {
    const CommandSpec& spec = _spec.commands[index];
    const auto parsed = ArgumentParser(spec).parse(words);
    if (const auto* error = std::get_if<UsageError>(&parsed)) {
        _terminal.error(error->message, error->cure);
        return ExitCode::WrongUsage;
    }
    const auto& arguments = std::get<Arguments>(parsed);
    if (arguments.has("help")) {
        _terminal.output() << HelpText::command(_spec, spec, _terminal.settings().width);
        return ExitCode::Answered;
    }
    Command& command = *_commands[index];
    // First of all: what the options ask for may need an application object, and would make one
    // that can have no windows.
    if (command.showsWindows())
        WindowApplication::make();
    if (const auto code = applyGlobalOptions(arguments, command))
        return *code;
    CommandContext context(_terminal);
    const DamageWatch watch;
    ExitCode code = command.run(arguments, context);
    _terminal.endProgress();
    _terminal.output().flush();
    for (const auto& damage : watch.found()) {
        _terminal.error(damage.message, damage.cure);
        if (code == ExitCode::Answered)
            code = ExitCode::Failed;
    }
    return code;
}

std::optional<ExitCode> Program::applyGlobalOptions(const Arguments& arguments,
                                                    const Command& command) {
    if (const auto language = arguments.value("language")) {
        if (!isLanguageTag(*language)) {
            _terminal.error(fmt::format("--language: \"{}\" is no language", *language),
                            "Write it as de or pt-BR.");
            return ExitCode::WrongUsage;
        }
        _language.emplace(Text::locale().overrideWith(*language));
    }
    if (const auto at = arguments.value("at")) {
        const auto time = ISO8601::parse(*at);
        if (!time) {
            _terminal.error(fmt::format("--at: \"{}\" is no time", *at),
                            "Write it as 2024-07-24T01:28:40Z.");
            return ExitCode::WrongUsage;
        }
        if (command.changesWhatIsKept(arguments)) {
            _terminal.error(
                fmt::format("--at writes nothing, so it cannot go with {}", command.spec().name()),
                "Leave --at out.");
            return ExitCode::WrongUsage;
        }
        _clock.emplace(Environment::wallClock().overrideWith(
            WallClock::standingAt(*time - NSTimeIntervalSince1970)));
        _keepsWritesInMemory.emplace(Environment::keepsWritesInMemory().overrideWith(true));
    }
    if (arguments.has("demo") && !command.writesDemonstration()) {
        std::shared_ptr<NSError> error;
        _demonstration =
            DemoVisit::begin(command.changesWhatIsKept(arguments) ? DemoVisit::Purpose::Change
                                                                  : DemoVisit::Purpose::Look,
                             &error);
        if (!_demonstration) {
            _terminal.error(error->localizedDescription());
            return ExitCode::Failed;
        }
    }
    return std::nullopt;
}

} // namespace orvo
