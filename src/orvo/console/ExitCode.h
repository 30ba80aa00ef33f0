#pragma once

namespace orvo {

/// What a program ends with.
enum class ExitCode {
    Answered = 0,
    Failed = 1, ///< the reason is on the error output
    WrongUsage = 2,
};

} // namespace orvo
