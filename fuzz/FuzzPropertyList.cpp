#include "platform/foundation/PropertyList.h"

#include <cstdlib>

/// What reads must be written, and read as the same again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto list = orvo::PropertyList::read({data, size});
    if (!list)
        return 0;
    const auto written = orvo::PropertyList::write(*list);
    if (!written)
        std::abort();
    const auto again = orvo::PropertyList::read(written->bytes());
    if (!again || !written->isEqual(orvo::PropertyList::write(*again).get()))
        std::abort();
    return 0;
}
