#include "platform/feeds/schedule/ImportNotes.h"

#include <algorithm>
#include <string>

namespace orvo {

void ImportNotes::add(std::string_view file, std::string_view reason, std::uint64_t row) {
    const auto found = std::ranges::find_if(
        _notes, [&](const ImportNote& note) { return note.file == file && note.reason == reason; });
    if (found == _notes.end())
        _notes.push_back({std::string(file), std::string(reason), 1, row});
    else
        ++found->count;
}

} // namespace orvo
