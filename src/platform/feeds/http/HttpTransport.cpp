#include "platform/feeds/http/HttpTransport.h"

#include <algorithm>

namespace orvo {

std::string_view HttpAnswer::header(std::string_view nameInSmallLetters) const {
    const auto found = std::ranges::find(
        headers, nameInSmallLetters, [](const auto& pair) { return std::string_view(pair.first); });
    return found == headers.end() ? std::string_view() : found->second;
}

} // namespace orvo
