/// Hands over as the widget does, and answers with the same exit codes: `hand_over open URL…`, or
/// `hand_over activity` with an activity's bytes on standard input. `--demo` before that uses the
/// demonstration city's profile.
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationLauncher.h"

#include <iostream>
#include <iterator>
#include <string>
#include <vector>

int main(int argc, char** argv) {
    std::vector<std::string> words(argv + 1, argv + argc);
    if (!words.empty() && words.front() == "--demo") {
        words.erase(words.begin());
        orvo::Environment::profile().set(orvo::ProfileFolders::demonstration());
    }
    if (words.empty())
        return 2;
    auto& loop = orvo::RunLoop::main();
    std::shared_ptr<orvo::NSError> error;
    bool isDone = false;
    const auto done = [&](const std::shared_ptr<orvo::NSError>& answer) {
        error = answer;
        isDone = true;
    };
    const auto launcher = orvo::ApplicationLauncher::sharedLauncher();
    if (words.front() == "open")
        launcher->openURLs("com.zentu.Orvo", {words.begin() + 1, words.end()}, done);
    else
        launcher->activateAction(
            "com.zentu.Orvo",
            "ContinueUserActivity",
            orvo::NSData::dataWithString(std::string(std::istreambuf_iterator<char>(std::cin), {})),
            done);
    constexpr orvo::NSTimeInterval Patience = 60;
    if (!loop.runUntil([&] { return isDone; }, Patience))
        std::cerr << "no answer\n";
    else if (error)
        std::cerr << error->localizedDescription() << '\n';
    return isDone && !error ? 0 : 1;
}
