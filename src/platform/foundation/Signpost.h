#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/Log.h"

#include <functional>
#include <string>

namespace orvo {

/// A moment that a tracing tool can see.
struct SignpostEvent {
    std::string subsystem;
    std::string category;
    std::string name;
    std::string message;
};

/// Marks moments for tracing tools: the probe `orvo:signpost_event` of the program's file, with
/// subsystem, category, name and message as its four arguments. `perf`, `bpftrace` and the like
/// attach to it; while nobody does, it costs one read. Any thread.
class Signpost {
public:
    /// Whether somebody looks.
    [[nodiscard]] static bool isEnabled(const Log& log);
    /// A moment by itself, part of no interval. Nothing while nobody looks.
    static void emitEvent(const Log& log, const char* name, const char* message);

    using Sink = std::function<void(const SignpostEvent&)>;
    /// Who looks besides. Default: nobody.
    static EnvironmentSlot<Sink>& sink();
};

} // namespace orvo
