#include "orvo/console/Completion.h"

#include "orvo/console/CompletionParts.h"

namespace orvo::Completion {

const std::vector<std::string>& shells() {
    static const std::vector<std::string> shells = {"bash", "zsh", "fish"};
    return shells;
}

std::string script(const ProgramSpec& program, const std::string& shell) {
    if (shell == "zsh")
        return zsh(program);
    return shell == "fish" ? fish(program) : bash(program);
}

} // namespace orvo::Completion
