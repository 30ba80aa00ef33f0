#include "handoff/OrvoActivity.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"

#include <cstdlib>

namespace orvo {
namespace {

/// What is read can be written, is read again as the same, and is written again to the same bytes.
template <class Message>
void readAndWrite(std::span<const std::uint8_t> bytes) {
    const auto message = protoMessageWithBytes<Message>(bytes);
    if (!message)
        return;
    const auto written = message->data();
    const auto again = protoMessageWithBytes<Message>(written->bytes());
    // Presence and bytes, not values: a number that is none does not equal itself.
    if (!again || !again->data()->isEqual(written.get()))
        std::abort();
    (void)message->dictionaryRepresentation();
    (void)message->hash();
    (void)message->copy();
    again->mergeFrom(*message);
    (void)again->data();
}

} // namespace
} // namespace orvo

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace orvo;
    if (size == 0)
        return 0;
    const std::span<const std::uint8_t> bytes(data + 1, size - 1);
    switch (data[0] % 5) { // which message the rest is
    case 0:
        readAndWrite<OrvoActivity>(bytes);
        break;
    case 1:
        readAndWrite<DirectionsPlan>(bytes);
        break;
    case 2:
        readAndWrite<DirectionsPlanTransitPreferences>(bytes);
        break;
    case 3:
        readAndWrite<TransitStorageLineItem>(bytes);
        break;
    default:
        readAndWrite<TransitStorageIncident>(bytes);
        break;
    }
    return 0;
}
