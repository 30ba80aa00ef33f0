#include "platform/foundation/StringsTable.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

// Control characters that no text holds: they cannot be typed into a table by mistake.
constexpr char PluralMark = '\x01';
constexpr char FieldEnd = '\x1f';

class Parser {
public:
    explicit Parser(std::string_view text)
        : _text(text) {}

    [[nodiscard]] bool atEnd() {
        skipBlanksAndComments();
        return _position >= _text.size();
    }
    bool accept(char c) {
        skipBlanksAndComments();
        if (_position >= _text.size() || _text[_position] != c)
            return false;
        ++_position;
        return true;
    }
    std::optional<std::string> quoted() {
        if (!accept('"'))
            return std::nullopt;
        std::string value;
        while (_position < _text.size() && _text[_position] != '"') {
            char c = _text[_position++];
            if (c == '\\' && _position < _text.size()) {
                c = _text[_position++];
                if (c == 'n')
                    c = '\n';
            }
            value += c;
        }
        if (_position >= _text.size())
            return std::nullopt;
        ++_position;
        return value;
    }
    std::string word() {
        skipBlanksAndComments();
        const auto start = _position;
        while (_position < _text.size() && _text[_position] >= 'a' && _text[_position] <= 'z')
            ++_position;
        return std::string(_text.substr(start, _position - start));
    }
    [[nodiscard]] std::ptrdiff_t line() const {
        return 1 + std::count(
                       _text.begin(), _text.begin() + static_cast<std::ptrdiff_t>(_position), '\n');
    }

private:
    void skipBlanksAndComments() {
        while (_position < _text.size()) {
            if (_text.compare(_position, 2, "/*") == 0) {
                const auto end = _text.find("*/", _position + 2);
                _position = end == std::string_view::npos ? _text.size() : end + 2;
            } else if (_text[_position] == ' ' ||
                       (_text[_position] >= '\t' && _text[_position] <= '\r')) {
                ++_position;
            } else {
                return;
            }
        }
    }

    std::string_view _text;
    std::size_t _position = 0;
};

std::optional<std::string> parsePluralForms(Parser& parser) {
    PluralForms::Forms forms;
    while (!parser.accept('}')) {
        const auto category = parser.word();
        if (category.empty() || !parser.accept('='))
            return std::nullopt;
        const auto form = parser.quoted();
        if (!form || !parser.accept(';'))
            return std::nullopt;
        forms[category] = *form;
    }
    return forms.contains("other") ? std::optional(PluralForms::packed(forms)) : std::nullopt;
}

} // namespace

std::optional<StringsTable> StringsTable::parse(std::string_view text, std::string* problem) {
    StringsTable table;
    Parser parser(text);
    while (!parser.atEnd()) {
        const auto key = parser.quoted();
        const bool hasEquals = key && parser.accept('=');
        const auto value = !hasEquals           ? std::nullopt
                           : parser.accept('{') ? parsePluralForms(parser)
                                                : parser.quoted();
        if (!value || !parser.accept(';')) {
            if (problem)
                *problem = fmt::format("line {}: expected an entry \"key\" = \"text\"; or \"key\" "
                                       "= {{ other = \"text\"; }};",
                                       parser.line());
            return std::nullopt;
        }
        table._texts[*key] = *value;
    }
    return table;
}

std::optional<std::string> StringsTable::text(const std::string& key) const {
    const auto found = _texts.find(key);
    return found == _texts.end() ? std::nullopt : std::optional(found->second);
}

std::string PluralForms::packed(const Forms& forms) {
    std::string text(1, PluralMark);
    for (const auto& [category, form] : forms)
        text += category + FieldEnd + form + FieldEnd;
    return text;
}

std::optional<PluralForms::Forms> PluralForms::unpacked(std::string_view text) {
    if (text.empty() || text.front() != PluralMark)
        return std::nullopt;
    Forms forms;
    text.remove_prefix(1);
    const auto nextField = [&] {
        const auto end = std::min(text.find(FieldEnd), text.size());
        std::string field(text.substr(0, end));
        text.remove_prefix(std::min(end + 1, text.size()));
        return field;
    };
    while (!text.empty()) {
        auto category = nextField();
        forms[std::move(category)] = nextField();
    }
    return forms;
}

} // namespace orvo
