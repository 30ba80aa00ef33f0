#include "shared/NSString_OrvoSharedExtras.h"

#include "platform/foundation/NSValue.h"
#include "platform/foundation/Text.h"

#include <algorithm>

namespace orvo::OrvoSharedExtras {

std::shared_ptr<NSArray> _orvo_prefixMatchesForSearchString(std::string_view self,
                                                            std::string_view searchString) {
    const auto words = Text::words(self);
    NSArray::Elements matches;
    for (const auto& searchWord : Text::words(searchString)) {
        const auto match = std::ranges::find_if(words, [&](const Text::Word& word) {
            const auto found = Text::localizedStandardRange(word.text, searchWord.text);
            return found && found->location == 0;
        });
        if (match == words.end())
            return nullptr;
        matches.push_back(
            NSValue::valueWithRange({match->range.location, searchWord.range.length}));
    }
    return NSArray::arrayWithObjects(std::move(matches));
}

} // namespace orvo::OrvoSharedExtras
