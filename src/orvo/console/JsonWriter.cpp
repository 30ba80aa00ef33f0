#include "orvo/console/JsonWriter.h"

#include <unicode/utf8.h>

#include <cmath>
#include <fmt/format.h>

namespace orvo {

JsonWriter& JsonWriter::beginObject() {
    begin('{');
    return *this;
}

JsonWriter& JsonWriter::endObject() {
    end('}');
    return *this;
}

JsonWriter& JsonWriter::beginArray() {
    begin('[');
    return *this;
}

JsonWriter& JsonWriter::endArray() {
    end(']');
    return *this;
}

JsonWriter& JsonWriter::key(std::string_view name) {
    beginValue();
    quote(name);
    _text += ": ";
    _afterKey = true;
    return *this;
}

JsonWriter& JsonWriter::value(std::string_view text) {
    beginValue();
    quote(text);
    return *this;
}

JsonWriter& JsonWriter::value(bool truth) {
    beginValue();
    _text += truth ? "true" : "false";
    return *this;
}

JsonWriter& JsonWriter::value(std::int64_t number) {
    beginValue();
    _text += fmt::format("{}", number);
    return *this;
}

JsonWriter& JsonWriter::value(double number) {
    if (!std::isfinite(number))
        return null();
    beginValue();
    _text += fmt::format("{}", number);
    return *this;
}

JsonWriter& JsonWriter::null() {
    beginValue();
    _text += "null";
    return *this;
}

JsonWriter& JsonWriter::value(const std::optional<std::string>& text) {
    return text ? value(std::string_view(*text)) : null();
}

void JsonWriter::beginValue() {
    if (_afterKey) {
        _afterKey = false;
        return;
    }
    if (_levelHasElements.empty())
        return;
    if (_levelHasElements.back())
        _text += _layout == Layout::OneLine ? ", " : ",";
    _levelHasElements.back() = true;
    newLine();
}

void JsonWriter::begin(char bracket) {
    beginValue();
    _text += bracket;
    _levelHasElements.push_back(false);
}

void JsonWriter::end(char bracket) {
    const bool hasElements = _levelHasElements.back();
    _levelHasElements.pop_back();
    if (hasElements)
        newLine();
    _text += bracket;
}

void JsonWriter::newLine() {
    if (_layout == Layout::OneLine)
        return;
    _text += '\n';
    _text.append(2 * _levelHasElements.size(), ' ');
}

void JsonWriter::quote(std::string_view text) {
    _text += '"';
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(text.data());
    const auto length = static_cast<std::int32_t>(text.size());
    for (std::int32_t at = 0; at < length;) {
        const std::int32_t start = at;
        UChar32 c = 0;
        U8_NEXT(bytes, at, length, c);
        if (c < 0)
            _text += "\xEF\xBF\xBD";
        else if (c == '"' || c == '\\')
            (_text += '\\') += static_cast<char>(c);
        else if (c == '\n')
            _text += "\\n";
        else if (c < 0x20 || c == 0x7F || c == 0x2028 || c == 0x2029)
            _text += fmt::format("\\u{:04x}", static_cast<unsigned>(c));
        else
            _text +=
                text.substr(static_cast<std::size_t>(start), static_cast<std::size_t>(at - start));
    }
    _text += '"';
}

} // namespace orvo
