#pragma once

#include <string_view>

namespace orvo {

/// Whether the text has the form of a BCP-47 tag of a language, as `de`, `pt-BR` or `zh-Hant-TW`.
/// `_` may stand for `-`. Whether anybody speaks it is not asked.
[[nodiscard]] bool isLanguageTag(std::string_view text);

} // namespace orvo
