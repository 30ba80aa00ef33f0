#pragma once

#include "platform/foundation/NSData.h"

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// Starts a program in a session of its own that outlives this one, with `input` (nil: nothing) as
/// its standard input, and waits for its end on the side, so that none is left over. Answers 0, or
/// the `errno` for which it could not be started.
[[nodiscard]] int startProgram(const std::filesystem::path& program,
                               const std::vector<std::string>& arguments,
                               const std::shared_ptr<NSData>& input);

} // namespace orvo
