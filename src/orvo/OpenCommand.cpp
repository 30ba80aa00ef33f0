#include "orvo/OpenCommand.h"

#include "orvo/HandOffReceiver.h"

namespace orvo {

CommandSpec OpenCommand::spec() const {
    return {.path = {"open"},
            .summary = "Open a URL of the map application",
            .description =
                "Tells what the URL asks for, on a display in a window, and keeps it for: orvo "
                "show. An orvo that runs already takes it over.\n"
                "orvo://?t=r is the map, orvo://?favorites=2&t=r the favourite lines.",
            .operands = {{.name = "URL",
                          .help = "as orvo://?favorites=2&t=r; the map if you name none",
                          .count = OperandSpec::Count::Any}},
            .examples = {{"orvo open 'orvo://?favorites=2&t=r'", "your favourite lines"}}};
}

ExitCode OpenCommand::run(const Arguments& arguments, CommandContext& context) {
    auto urls = arguments.operands();
    if (urls.empty()) // as a desktop's menu starts it
        urls.emplace_back("orvo://?t=r");
    for (const auto& url : urls) {
        const auto code = HandOffReceiver::takeForCommand(HandOff::ofURL(url), context);
        if (code != ExitCode::Answered)
            return code;
    }
    return ExitCode::Answered;
}

} // namespace orvo
