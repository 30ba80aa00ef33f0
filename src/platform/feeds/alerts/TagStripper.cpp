#include "platform/feeds/alerts/TagStripper.h"

#include <algorithm>
#include <array>

namespace orvo {

namespace {

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool isNameCharacter(char c) {
    return isLetter(c) || (c >= '0' && c <= '9');
}

std::string lowerCase(std::string_view text) {
    std::string result(text);
    for (char& c : result)
        if (c >= 'A' && c <= 'Z')
            c = static_cast<char>(c - 'A' + 'a');
    return result;
}

template <std::size_t Size>
bool isOneOf(std::string_view name, const std::array<std::string_view, Size>& names) {
    return std::find(names.begin(), names.end(), name) != names.end();
}

/// What stands in the place of a tag.
std::string_view replacementOf(std::string_view name) {
    static constexpr std::array<std::string_view, 12> Paragraphs = {
        "p", "h1", "h2", "h3", "h4", "h5", "h6", "ul", "ol", "table", "blockquote", "hr"};
    static constexpr std::array<std::string_view, 6> Lines = {
        "br", "div", "li", "tr", "section", "article"};
    static constexpr std::array<std::string_view, 2> Cells = {"td", "th"};
    if (isOneOf(name, Paragraphs))
        return "\n\n";
    if (isOneOf(name, Lines))
        return "\n";
    return isOneOf(name, Cells) ? " " : "";
}

/// Takes one text apart from left to right. What a search did not find once is not searched again,
/// so that the time is linear in the text.
class Stripper {
public:
    explicit Stripper(std::string_view text)
        : _rest(text) {
        _result.reserve(text.size());
    }

    std::string run() {
        while (!_rest.empty()) {
            const std::size_t bracket = std::min(_rest.find('<'), _rest.size());
            _result += _rest.substr(0, bracket);
            _rest.remove_prefix(bracket);
            if (!_rest.empty() && !takeComment() && !takeTag()) {
                _result += '<';
                _rest.remove_prefix(1);
            }
        }
        return std::move(_result);
    }

private:
    bool takeComment() {
        if (!_rest.starts_with("<!--") || _hasNoComment)
            return false;
        const std::size_t end = _rest.find("-->", 4);
        if (end == std::string_view::npos) {
            _hasNoComment = true;
            return false;
        }
        _rest.remove_prefix(end + 3);
        return true;
    }

    bool takeTag() {
        const std::size_t mark = _rest.size() > 1 && _rest[1] == '/' ? 2 : 1;
        if (_rest.size() <= mark || _hasNoTag)
            return false;
        const char first = _rest[mark];
        if (!isLetter(first) && (mark == 2 || (first != '!' && first != '?')))
            return false;
        const std::size_t end = _rest.find('>');
        if (end == std::string_view::npos) {
            _hasNoTag = true;
            return false;
        }
        std::size_t nameEnd = mark;
        while (isNameCharacter(_rest[nameEnd]))
            ++nameEnd;
        const std::string name = lowerCase(_rest.substr(mark, nameEnd - mark));
        _result += replacementOf(name);
        _rest.remove_prefix(end + 1);
        if (mark == 1 && (name == "script" || name == "style"))
            takeUpToEndOf(name);
        return true;
    }

    void takeUpToEndOf(std::string_view name) {
        std::size_t end = _rest.find("</");
        while (end != std::string_view::npos &&
               lowerCase(_rest.substr(end + 2, name.size())) != name)
            end = _rest.find("</", end + 2);
        _rest.remove_prefix(std::min(end, _rest.size()));
    }

    std::string_view _rest;
    std::string _result;
    bool _hasNoComment = false;
    bool _hasNoTag = false;
};

} // namespace

std::string TagStripper::stripped(std::string_view text) {
    return Stripper(text).run();
}

} // namespace orvo
