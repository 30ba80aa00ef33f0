#pragma once

#include "platform/extension/Extension.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <functional>
#include <string>
#include <vector>

namespace orvo {

/// Runs an extension in a host until the host is done with it; answers the exit code of the
/// process. `arguments` are those of the process without the program's name.
using ExtensionHostProgram =
    std::function<int(const Extension& extension, const std::vector<std::string>& arguments)>;

/// The host that the program's `main` has chosen. Default: none.
EnvironmentSlot<ExtensionHostProgram>& extensionHostProgram();

/// The entry point of a program that is an extension: finds out from the description in the main
/// bundle what it is, says so to the process's bundle proxy, and hands it to the host with the
/// arguments given to `main`. Answers the exit code: what the host answers, or 1 with the reason on
/// standard error where there is no description, principal class or host.
[[nodiscard]] int NSExtensionMain(int argc, char** argv);

} // namespace orvo
