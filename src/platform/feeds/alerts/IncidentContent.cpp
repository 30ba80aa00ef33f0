#include "platform/feeds/alerts/IncidentContent.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/TextCleaner.h"
#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace orvo {

namespace {

constexpr std::string_view NoBreakSpace = "\u00A0";
constexpr std::string_view NarrowNoBreakSpace = "\u202F";
constexpr std::string_view Separator("\0", 1);

using Lanes = std::array<std::uint64_t, HashLanes>;

std::string withPlainBlanks(std::string_view line) {
    std::string plain;
    plain.reserve(line.size());
    while (!line.empty()) {
        std::size_t length = 1;
        for (const std::string_view blank : {NoBreakSpace, NarrowNoBreakSpace})
            if (line.starts_with(blank))
                length = blank.size();
        plain += length == 1 ? line[0] : ' ';
        line.remove_prefix(length);
    }
    return plain;
}

/// Continues the hashes of some contents by one text of each. There may be fewer contents than
/// lanes.
void addTexts(Lanes& hashes,
              std::span<const IncidentContent> contents,
              std::string_view IncidentContent::*text) {
    std::array<std::string_view, HashLanes> texts;
    std::ranges::transform(contents, texts.begin(), text);
    hashes = stableHashes(texts, hashes);
    for (std::uint64_t& hash : hashes)
        hash = stableHash(Separator, hash);
}

} // namespace

std::vector<std::uint64_t> IncidentContent::numbersOf(std::span<const IncidentContent> contents,
                                                      std::string_view feed) {
    const std::uint64_t ofFeed = stableHash(Separator, stableHash(feed));
    std::vector<std::uint64_t> numbers;
    numbers.reserve(contents.size());
    while (!contents.empty()) {
        const auto some = contents.first(std::min(HashLanes, contents.size()));
        Lanes hashes{};
        hashes.fill(ofFeed);
        addTexts(hashes, some, &IncidentContent::header);
        addTexts(hashes, some, &IncidentContent::description);
        for (std::size_t lane = 0; lane < some.size(); ++lane)
            numbers.push_back(stableHash(std::to_string(some[lane].effect), hashes[lane]));
        contents = contents.subspan(some.size());
    }
    return numbers;
}

std::string_view IncidentContent::normalised(std::string_view text, std::string& room) {
    const std::string_view line = TextCleaner::cleanLine(text, room);
    if (ByteScan::isASCII(line))
        return line;
    return room = withPlainBlanks(line);
}

} // namespace orvo
