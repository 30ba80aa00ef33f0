#include "orvo/ReceiveCommand.h"

#include "orvo/HandOffService.h"
#include "platform/mapuikit/DesktopSystemController.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fmt/format.h>
#include <unistd.h>

namespace orvo {

namespace {

/// Everything up to the end of standard input. Nil for more than a hand-off may have, which is then
/// not read, or for an input that cannot be read.
std::shared_ptr<NSData> standardInput(std::string& problem) {
    std::vector<std::uint8_t> bytes;
    while (bytes.size() <= HandOff::MaximumBytes) {
        constexpr std::size_t Piece = 65536;
        const auto length = bytes.size();
        bytes.resize(length + Piece);
        const auto count = read(STDIN_FILENO, bytes.data() + length, Piece);
        bytes.resize(length + static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
        if (count == 0)
            return NSData::dataWithVector(std::move(bytes));
        if (count < 0 && errno != EINTR) {
            problem = fmt::format("The standard input cannot be read: {}.", std::strerror(errno));
            return nullptr;
        }
    }
    problem = fmt::format("The standard input has more than {} bytes; nothing that is handed over "
                          "is that large.",
                          HandOff::MaximumBytes);
    return nullptr;
}

} // namespace

CommandSpec ReceiveCommand::spec() const {
    return {.path = {"receive"},
            .summary = "Take what another program hands over",
            .description =
                "For programs on a desktop without a session bus: the activity comes on the "
                "standard input, as a binary property list. It is told, on a display in a window, "
                "and kept for: orvo show.",
            .operands = {{.name = "ACTION",
                          .help = "what to do with it",
                          .count = OperandSpec::Count::One,
                          .completes = Completes::Word,
                          .words = {DesktopSystemController::Action}}},
            .examples = {
                {"orvo receive ContinueUserActivity < activity.plist", "show what it is about"}}};
}

ExitCode ReceiveCommand::run(const Arguments& arguments, CommandContext& context) {
    std::string problem;
    const auto bytes = standardInput(problem);
    if (!bytes)
        return context.fail(problem);
    std::shared_ptr<NSError> error;
    const auto handOff = handOffOfAction(arguments.operand(0).value_or(""), bytes, &error);
    return handOff ? HandOffReceiver::takeForCommand(*handOff, context) : context.fail(*error);
}

} // namespace orvo
