#pragma once

#include "platform/foundation/LocalizedFormat.h"
#include "platform/foundation/NSBundle.h"

#include <optional>
#include <string>
#include <vector>

namespace orvo {

class TransitLine;

/// The words of the rows, looked up in the main bundle's default table. The spelling of the keys is
/// not regular; the tables are written for them as they are.
namespace WidgetTexts {

/// `localized string not found` for a key that is missing.
[[nodiscard]] std::string localized(const std::string& key);
/// The text as a format, filled.
[[nodiscard]] std::string localized(const std::string& key,
                                    const std::vector<FormatArgument>& arguments);

[[nodiscard]] std::string noFavoritesTitle();
[[nodiscard]] std::string noFavoritesSecondaryText();
[[nodiscard]] std::string goodServiceTitle();
/// For all favourites, when nothing disturbs any of them.
[[nodiscard]] std::string goodServiceSecondaryText(std::size_t favoriteLines);
/// For the lines without advisories, below those with.
[[nodiscard]] std::string clearServiceSecondaryText(std::size_t clearLines);
[[nodiscard]] std::string summaryText(std::size_t incidents);
[[nodiscard]] std::string overflowTitle(std::size_t hiddenIncidents);
[[nodiscard]] std::string overflowSecondaryText(std::size_t lines);

/// The text of an advisory that several lines share, with their names before it: a line's own name,
/// else its system's; each name once, in the order given. Without a text, the names alone; without
/// any name, the text unchanged.
[[nodiscard]] std::optional<std::string>
_prependLineNames_toText(const std::vector<std::shared_ptr<TransitLine>>& lines,
                         const std::optional<std::string>& text);

} // namespace WidgetTexts

} // namespace orvo
