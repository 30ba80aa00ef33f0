#pragma once

#include "platform/feeds/schedule/ScheduleLine.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// Finds lines by what a person types. Texts are compared by the locale's primary strength: case
/// and accents do not count. One thread at a time.
class LineSearch {
public:
    /// `locale` is a BCP-47 tag.
    explicit LineSearch(const std::string& locale);
    LineSearch(const LineSearch&) = delete;
    LineSearch& operator=(const LineSearch&) = delete;
    ~LineSearch();

    /// The best `limit` lines in which each word of `text` stands, best first: the very short name,
    /// the very long name, the beginning of either name (the shorter name first),
    /// beginnings of words in the names, in
    /// the agency's name too, any place. Equally good ones keep their order. Empty for a text
    /// without letters and digits.
    [[nodiscard]] std::vector<ScheduleLine>
    best(std::vector<ScheduleLine> lines, std::string_view text, std::size_t limit);

    /// The lines whose short or long name is `name`, in their order.
    [[nodiscard]] std::vector<ScheduleLine> named(std::vector<ScheduleLine> lines,
                                                  std::string_view name);

    /// At most `limit` lines that were probably meant by a `text` that finds none: each of its
    /// words begins one of the names or the agency's, or is one of the names' misspelt. The nearest
    /// come first, then those whose names have fewer words; equally good ones keep their order.
    ///
    /// Of four letters one may be wrong, of eight two, of twelve and more three: left out, added,
    /// changed, or swapped with its neighbour. A shorter word is spelt right, and one with a digit
    /// is whole, too: another number is another line.
    [[nodiscard]] std::vector<ScheduleLine>
    near(std::vector<ScheduleLine> lines, std::string_view text, std::size_t limit);

private:
    struct Comparer;
    std::unique_ptr<Comparer> _comparer;
};

} // namespace orvo
