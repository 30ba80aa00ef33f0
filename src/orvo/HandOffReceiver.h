#pragma once

#include "orvo/CommandContext.h"
#include "orvo/HandOff.h"

#include <functional>

/// Takes what is handed over: reads it, keeps it as the last one of the profile in use, and tells
/// it.
namespace orvo::HandOffReceiver {

/// The map application's name on the bus and of its desktop file.
inline constexpr const char* ApplicationIdentifier = "com.zentu.Orvo";

enum class Audience { Terminal, Nobody };

/// Shows what was taken, beside telling it.
using Showing = std::function<void(const HandOff::Content& content)>;

/// Keeps it, shows it (`showing` may be empty), and tells it to the terminal unless nobody looks.
/// Nil, or why not; what cannot be read is neither kept nor told.
[[nodiscard]] std::shared_ptr<NSError> take(const HandOff& handOff,
                                            CommandContext& context,
                                            Audience audience,
                                            const Showing& showing = {});

/// For a command that a person, or a program without a bus, gave: the instance that serves the
/// application, where there is one, takes it too, and then keeps it in this one's place. Where
/// there is none, a process that can have windows becomes that instance and answers when the person
/// has closed them; a terminal is told as well, anything else that takes the output is not. What
/// went wrong is said on the terminal.
[[nodiscard]] ExitCode takeForCommand(const HandOff& handOff,
                                      CommandContext& context,
                                      Audience audience = Audience::Terminal);

} // namespace orvo::HandOffReceiver
