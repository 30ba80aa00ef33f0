#include "print/PrintedRow.h"

#include "platform/foundation/Exceptions.h"
#include "platform/mapuikit/IconManager.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/uikit/UIImage.h"
#include "viewmodel/OWTransitItem.h"
#include "viewmodel/OWTransitSummaryItem.h"

#include <algorithm>
#include <charconv>

namespace orvo {

namespace {

constexpr std::size_t ColourDigits = 6;

std::optional<unsigned> colour(std::string_view digits) {
    unsigned number = 0;
    const auto* end = digits.data() + digits.size();
    const auto read = std::from_chars(digits.data(), end, number, 16);
    const bool isWhole = read.ec == std::errc() && read.ptr == end;
    return isWhole && digits.size() == ColourDigits ? std::optional(number) : std::nullopt;
}

/// Black or white, whichever can be read on it: by the weights of the eye.
const char* readableOn(unsigned background) {
    const unsigned brightness = 299 * ((background >> 16U) & 0xFFU) +
                                587 * ((background >> 8U) & 0xFFU) + 114 * (background & 0xFFU);
    return brightness > 1000 * 0x80U ? "000000" : "FFFFFF";
}

void appendShield(std::vector<PrintedShield>& shields,
                  const std::shared_ptr<TransitArtworkDataSource>& artwork) {
    const auto drawn = artwork ? IconManager::shieldOfArtwork(*artwork) : nullptr;
    if (!drawn)
        return;
    PrintedShield shield{drawn->shieldText().value_or(""), std::nullopt, ""};
    const auto colours = drawn->shieldColorString().value_or("");
    const auto comma = std::min(colours.find(','), colours.size());
    if (const auto background = colour(std::string_view(colours).substr(0, comma))) {
        shield.background = colours.substr(0, comma);
        const auto given = colours.substr(std::min(comma + 1, colours.size()));
        shield.foreground = colour(given) ? given : readableOn(*background);
    }
    // A colour alone says nothing in print.
    if (shield.text.empty() && shield.background)
        shield.text = artwork->accessibilityText().value_or("");
    if (shield.text.empty())
        return;
    shields.push_back(std::move(shield));
}

std::optional<PrintedArtwork> artworkOf(const std::shared_ptr<OWConfiguredArtwork>& configured) {
    if (!configured)
        return std::nullopt;
    PrintedArtwork artwork{.image = std::nullopt, .alpha = configured->alpha()};
    if (const auto image = std::dynamic_pointer_cast<UIImage>(configured->artworkSource()))
        artwork.image = image->name();
    else if (const auto sized =
                 std::dynamic_pointer_cast<SizedTransitArtwork>(configured->artworkSource()))
        appendShield(artwork.shields, sized->artwork());
    return artwork;
}

PrintedRow rowOf(const OWTransitItem& item, const PrintedTarget* before) {
    return {.kind = PrintedRow::Kind::Item,
            .primaryText = item.primaryText(),
            .secondaryText = item.secondaryText(),
            .artwork = artworkOf(item.artwork()),
            .artworkHidden = item.isArtworkHidden(),
            .opens = PrintedTarget::of(item.openable(), before)};
}

PrintedRow rowOf(const OWTransitSummaryItem& item) {
    PrintedArtwork artwork;
    for (const auto& one : typed<TransitArtworkDataSource>(item.artworks()))
        appendShield(artwork.shields, one);
    return {.kind = PrintedRow::Kind::Summary,
            .primaryText = item.primaryText(),
            .secondaryText = std::nullopt,
            .artwork = std::move(artwork),
            .artworkHidden = false,
            .opens = PrintedTarget::of(item.userActivityData())};
}

[[noreturn]] void raiseNoRow(const std::shared_ptr<NSObject>& item) {
    throw NSInvalidArgumentException("No row shows " + descriptionOf(item) + ".");
}

} // namespace

PrintedRow PrintedRow::of(const std::shared_ptr<NSObject>& item, const PrintedRow* before) {
    if (const auto row = std::dynamic_pointer_cast<OWTransitItem>(item))
        return rowOf(*row, before && before->opens ? &*before->opens : nullptr);
    if (const auto summary = std::dynamic_pointer_cast<OWTransitSummaryItem>(item))
        return rowOf(*summary);
    raiseNoRow(item);
}

std::shared_ptr<OWOpenable> openableOfItem(const std::shared_ptr<NSObject>& item) {
    if (const auto row = std::dynamic_pointer_cast<OWTransitItem>(item))
        return row->openable();
    if (const auto summary = std::dynamic_pointer_cast<OWTransitSummaryItem>(item))
        return summary->userActivityData();
    raiseNoRow(item);
}

} // namespace orvo
