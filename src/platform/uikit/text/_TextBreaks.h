#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace orvo {

/// Where a text may be parted. Offsets are bytes of its UTF-8.
struct _TextBreaks {
    /// Where each character that a reader sees begins.
    std::vector<std::size_t> clusters;
    /// Where a line may end, in rising order, the end of the text among them.
    std::vector<std::size_t> opportunities;

    [[nodiscard]] static _TextBreaks of(const std::string& text);
};

/// Whether the character at `offset` takes no room at the end of a line.
[[nodiscard]] bool _isSpaceAt(const std::string& text, std::size_t offset);
/// Whether it ends its paragraph.
[[nodiscard]] bool _isParagraphEndAt(const std::string& text, std::size_t offset);
/// Whether the paragraph's first letter with a direction is read from right to left; `otherwise`
/// without such a letter.
[[nodiscard]] bool
_isRightToLeft(const std::string& text, std::size_t begin, std::size_t end, bool otherwise);

} // namespace orvo
