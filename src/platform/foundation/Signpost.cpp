#include "platform/foundation/Signpost.h"

#define _SDT_HAS_SEMAPHORES 1 // NOLINT(bugprone-reserved-identifier): the header asks for it
#include <sys/sdt.h>

/// Tracing tools count themselves here when they attach; the name is how they find it.
// NOLINTNEXTLINE(cppcoreguidelines-avoid-non-const-global-variables)
extern "C" volatile unsigned short orvo_signpost_event_semaphore
    __attribute__((section(".probes"), visibility("hidden")));
volatile unsigned short orvo_signpost_event_semaphore = 0;

namespace orvo {

EnvironmentSlot<Signpost::Sink>& Signpost::sink() {
    static EnvironmentSlot<Sink> slot([] { return Sink(); });
    return slot;
}

bool Signpost::isEnabled(const Log&) {
    return orvo_signpost_event_semaphore != 0 || sink().get() != nullptr;
}

void Signpost::emitEvent(const Log& log, const char* name, const char* message) {
    if (!isEnabled(log))
        return;
    STAP_PROBE4(
        orvo, signpost_event, log.subsystem().c_str(), log.category().c_str(), name, message);
    if (const auto extra = sink().get())
        extra({log.subsystem(), log.category(), name, message});
}

} // namespace orvo
