#include "platform/feeds/alerts/HeaderFingerprint.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/IncidentContent.h"

#include <algorithm>
#include <string>

namespace orvo {

namespace {

/// So many bytes of the normalised text count.
constexpr std::size_t Counted = ByteScan::Block;
/// So many bytes of a text without markup are mostly enough to have them.
constexpr std::size_t Enough = 48;

std::uint64_t hashOf(std::string_view begin) {
    return ByteScan::quickHash(begin.substr(0, Counted));
}

/// Whether the text begins with what counts, just as it would be normalised.
bool beginsPlainly(std::string_view text) {
    return text.size() > Counted && text[0] != ' ' && text[Counted - 1] != ' ' &&
           ByteScan::isPlainText(text.data());
}

/// The beginning of the text, up to the end of a character.
std::string_view beginningOf(std::string_view text) {
    std::size_t end = std::min(Enough, text.size());
    while (end > 0 && end < text.size() && (static_cast<unsigned char>(text[end]) & 0xC0U) == 0x80U)
        --end;
    return text.substr(0, end);
}

} // namespace

std::uint64_t headerFingerprint(std::string_view text) {
    if (beginsPlainly(text))
        return hashOf(text);
    std::string room;
    const std::string_view begin = beginningOf(text);
    if (begin.find_first_of("<&") == std::string_view::npos) {
        // A blank at the cut is dropped here, but not in the middle of the whole text.
        const std::string_view normalised = IncidentContent::normalised(begin, room);
        if (normalised.size() >= Counted)
            return hashOf(normalised);
    }
    return hashOf(IncidentContent::normalised(text, room));
}

} // namespace orvo
