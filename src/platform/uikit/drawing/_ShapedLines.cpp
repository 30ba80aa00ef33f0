#include "platform/uikit/drawing/_ShapedLines.h"

#include "platform/uikit/text/private/ToolkitFonts.h"

#include <map>
#include <memory>
#include <tuple>

namespace orvo::_ShapedLines {

namespace {

// Twice what the largest screen of rows shows.
constexpr std::size_t MostLines = 256;

using Key = std::tuple<std::string, std::vector<std::tuple<std::size_t, FontFace>>, bool>;

std::uint64_t shapedLines = 0;

Key keyOf(const TextLine& line) {
    std::vector<std::tuple<std::size_t, FontFace>> faces;
    faces.reserve(line.runs.size());
    for (const auto& run : line.runs)
        faces.emplace_back(run.end, run.face);
    return {line.text, std::move(faces), line.rightToLeft};
}

} // namespace

const QTextLayout* shapeOf(const TextLine& line) {
    if (!ToolkitFonts::areAvailable())
        return nullptr;
    // Never destroyed: at the end of the process the fonts would be gone before them.
    static auto* const lines = new std::map<Key, std::unique_ptr<QTextLayout>>();
    auto key = keyOf(line);
    if (const auto found = lines->find(key); found != lines->end())
        return found->second.get();
    if (lines->size() >= MostLines)
        lines->clear();
    auto layout = std::make_unique<QTextLayout>();
    ToolkitFonts::layOut(*layout, line.text, line.runs, line.rightToLeft);
    ++shapedLines;
    return lines->emplace(std::move(key), std::move(layout)).first->second.get();
}

std::uint64_t shaped() noexcept {
    return shapedLines;
}

} // namespace orvo::_ShapedLines
