#pragma once

#include "platform/foundation/NSBundle.h"
#include "platform/mapuikit/TransitInfoLabelView.h"
#include "platform/uikit/UIImage.h"
#include "presentation/OWTransitSummaryCell.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace orvo::testing {

/// Notes what happens while it is made and laid out.
class RecordingSummaryCell final : public OWTransitSummaryCell {
public:
    static std::shared_ptr<RecordingSummaryCell> make() {
        auto cell = std::make_shared<RecordingSummaryCell>();
        cell->setIdentifier("cell");
        return cell->_initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "id") ? cell
                                                                                         : nullptr;
    }
    void _createSubviews() override {
        steps.push_back(contentView() ? "create after super" : "create");
        OWTransitSummaryCell::_createSubviews();
        for (const auto& constraint : initial)
            if (!constraint->isActive())
                steps.push_back("inactive after all");
        steps.push_back("created");
    }
    std::vector<std::shared_ptr<NSLayoutConstraint>> _initialConstraints() override {
        initial = OWTransitSummaryCell::_initialConstraints();
        for (const auto& constraint : initial)
            if (constraint->isActive())
                steps.push_back("active before its time");
        steps.push_back("constraints");
        return initial;
    }
    void _updateLayout() override {
        OWTransitSummaryCell::_updateLayout();
        ++updates;
    }
    void layoutSubviews() override {
        OWTransitSummaryCell::layoutSubviews();
        widths.push_back(artworksLabel()->maxWidth());
    }
    std::vector<std::string> steps;
    std::vector<std::shared_ptr<NSLayoutConstraint>> initial;
    int updates = 0;
    std::vector<CGFloat> widths; ///< that the shields were cut to, one a layout pass
};

class FixedShields final : public ArtworkDataSourceCache {
public:
    std::shared_ptr<UIImage> imageForArtwork_shieldSize_scale_nightMode(
        const std::shared_ptr<TransitArtworkDataSource>&, std::int64_t, double, bool) override {
        return UIImage::imageWithPixels_size_scale(
            std::vector<std::uint32_t>(40 * 28), {40, 28}, 1);
    }
};

/// Answers one text for everything, and notes what it was asked for.
class OneText final : public NSBundle {
public:
    std::string
    localizedStringForKey_value_table(const std::string& key,
                                      const std::optional<std::string>& value,
                                      const std::optional<std::string>& table) const override {
        asked.push_back(key + "|" + value.value_or("nil") + "|" + table.value_or("nil"));
        if (whenAsked)
            whenAsked();
        return text;
    }
    std::string text = "+%lu";
    mutable std::vector<std::string> asked;
    std::function<void()> whenAsked;
};

inline std::shared_ptr<NSArray> artworks(int count) {
    std::vector<std::shared_ptr<TransitArtworkDataSource>> made;
    for (int i = 0; i < count; ++i)
        made.push_back(TransitArtworkDataSource::initWithFields(
            {.artworkSourceType = 1,
             .shieldDataSource = TransitShieldDataSource::initWithFields(
                 {.shieldType = 1, .shieldText = "U" + std::to_string(i)})}));
    return NSArray::arrayOf(made);
}

inline std::shared_ptr<OWTransitSummaryItem> summaryItem(const std::optional<std::string>& text,
                                                         const std::shared_ptr<NSArray>& shields) {
    return OWTransitSummaryItem::initWithText_artworks_userActivityData(text, shields, nullptr);
}

} // namespace orvo::testing
