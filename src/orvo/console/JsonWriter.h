#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// Writes one JSON document, members in the order given. Bytes that are not
/// UTF-8 become U+FFFD, so that the document can always be read.
///
///     JsonWriter json;
///     json.beginObject().key("name").value("M1").endObject();
class JsonWriter {
public:
    /// `Lines`: a line a member, two blanks a level. `OneLine`: for readers that take lines.
    enum class Layout { Lines, OneLine };

    explicit JsonWriter(Layout layout = Layout::Lines)
        : _layout(layout) {}

    JsonWriter& beginObject();
    JsonWriter& endObject();
    JsonWriter& beginArray();
    JsonWriter& endArray();
    JsonWriter& key(std::string_view name);

    JsonWriter& value(std::string_view text);
    JsonWriter& value(const std::string& text) { return value(std::string_view(text)); }
    JsonWriter& value(const char* text) { return value(std::string_view(text)); }
    JsonWriter& value(bool truth);
    JsonWriter& value(std::int64_t number);
    /// The shortest text that reads as the same number; null for what is no number.
    JsonWriter& value(double number);
    JsonWriter& null();
    /// The text, or null.
    JsonWriter& value(const std::optional<std::string>& text);

    /// The document with a final line break, once every object and array has ended.
    [[nodiscard]] std::string text() const { return _text + "\n"; }

private:
    void beginValue();
    void begin(char bracket);
    void end(char bracket);
    void newLine();
    void quote(std::string_view text);

    Layout _layout;
    std::string _text;
    std::vector<bool> _levelHasElements;
    bool _afterKey = false;
};

} // namespace orvo
