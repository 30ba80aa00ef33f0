#include "orvo/DemoCommand.h"

#include "platform/demo/DemoCity.h"
#include "platform/demo/DemoProfile.h"
#include "platform/demo/server/DemoAlertServer.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/ISO8601.h"
#include "platform/foundation/RunLoop.h"

#include <charconv>
#include <csignal>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

constexpr std::uint16_t StandardPort = 8471;

volatile std::sig_atomic_t interrupted = 0;

void interrupt(int) {
    interrupted = 1;
}

std::optional<std::uint16_t> portNumber(const std::string& text) {
    std::uint16_t port = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, port);
    return result.ec == std::errc() && result.ptr == end ? std::optional(port) : std::nullopt;
}

} // namespace

CommandSpec DemoCommand::spec() const {
    return {.path = {"demo"},
            .summary = "Write the demonstration city anew",
            .description =
                "A city that does not exist, in a profile of its own: a schedule, favourites, and "
                "incidents around the present moment, one of which ends and one of which begins "
                "within two minutes. Every command shows it with --demo. Your own feeds and "
                "favourites are never touched.\n"
                "With --serve its alerts come from a small server on this machine until you press "
                "Ctrl-C; there incidents begin, end and are withdrawn every few minutes.",
            .operands = {{.name = "PORT",
                          .help = fmt::format("with --serve: where; {} if you say nothing, 0 for "
                                              "any free port",
                                              StandardPort),
                          .count = OperandSpec::Count::Optional}},
            .options = {{"serve", "", "serve live alerts over HTTP, to this machine only"}},
            .examples = {{"orvo demo", "write it for the present moment"},
                         {"orvo demo --serve", "and let it live"},
                         {"orvo incidents --demo", "look at it"}},
            .synopsis = "[--serve [PORT]]"};
}

ExitCode DemoCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto given = arguments.operand(0);
    const auto port = given ? portNumber(*given) : StandardPort;
    if (given && !arguments.has("serve"))
        return context.wrongUsage(fmt::format("\"{}\" is one word too many", *given),
                                  "A port belongs to --serve.");
    if (!port)
        return context.wrongUsage(fmt::format("PORT cannot be {}", *given),
                                  "Write a number up to 65535.");
    const auto profile = Environment::profile().overrideWith(ProfileFolders::demonstration());
    if (arguments.has("serve"))
        return serve(*port, context);
    if (const auto error = DemoProfile::write())
        return context.fail(*error);
    context.terminal().output() << fmt::format(
        "The city has {} lines and is written for {}. Look at it with: orvo incidents --demo\n",
        DemoCity::lines().size(),
        ISO8601::string(context.now()));
    return ExitCode::Answered;
}

ExitCode DemoCommand::serve(std::uint16_t port, const CommandContext& context) {
    auto& output = context.terminal().output();
    auto& loop = RunLoop::main();
    std::shared_ptr<NSError> error;
    const auto server = DemoAlertServer::start(
        port,
        [&](const std::string& request, int status) {
            output << fmt::format("{} {} {}\n", ISO8601::string(context.now()), request, status)
                   << std::flush;
        },
        &error);
    if (!server)
        return context.fail(error->localizedDescription(),
                            "Choose another port: orvo demo --serve 0 takes any that is free.");
    const auto live = DemoProfile::writeLive(server->url(), &error);
    if (!live)
        return context.fail(*error);
    output << fmt::format("Serving {} until you press Ctrl-C. Look at it with: orvo incidents "
                          "--demo\n",
                          server->url())
           << std::flush;
    interrupted = 0;
    const auto onInterrupt = std::signal(SIGINT, interrupt);
    const auto onTerminate = std::signal(SIGTERM, interrupt);
    constexpr double LookAgain = 0.2;
    while (!interrupted)
        loop.runUntil([] { return interrupted != 0; }, LookAgain);
    std::signal(SIGINT, onInterrupt);
    std::signal(SIGTERM, onTerminate);
    // What stays must not depend on a server that is gone.
    if ((error = DemoProfile::write()))
        return context.fail(*error);
    return ExitCode::Answered;
}

} // namespace orvo
