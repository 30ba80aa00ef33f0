#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace orvo {

/// One language's texts by key, from a file of entries `"key" = "text";` or, with plural forms,
/// `"key" = { one = "%lu line"; other = "%lu lines"; };`, comments between `/*` and `*/`, escapes
/// `\"`, `\\`, `\n`.
class StringsTable {
public:
    /// Nothing for a text that is not such a file; `problem` then says the line and what is wrong.
    [[nodiscard]] static std::optional<StringsTable> parse(std::string_view text,
                                                           std::string* problem);

    /// Nothing when the key is missing. A text with plural forms is packed: only `LocalizedFormat`
    /// reads it.
    [[nodiscard]] std::optional<std::string> text(const std::string& key) const;
    [[nodiscard]] const std::map<std::string, std::string>& texts() const noexcept {
        return _texts;
    }

private:
    std::map<std::string, std::string> _texts;
};

/// A text that has several plural forms, as one string.
namespace PluralForms {

using Forms =
    std::map<std::string, std::string>; ///< by CLDR category: zero, one, two, few, many, other

[[nodiscard]] std::string packed(const Forms& forms);
/// Nothing for a plain text.
[[nodiscard]] std::optional<Forms> unpacked(std::string_view text);

} // namespace PluralForms

} // namespace orvo
