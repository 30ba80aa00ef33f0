#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

class UIImageView;
class UILabel;
class WidgetHost;

/// The card that a widget is shown on: a header with the application's icon and name and, where
/// there is more to show, "Show More" or "Show Less"; under it the widget. It asks its host for all
/// that it shows when it is told to. Lays itself out by frames. Main thread.
class WidgetCard final : public UIView {
public:
    static constexpr CGFloat HeaderHeight = 36;
    static constexpr CGFloat CornerRadius = 14;

    /// Keeps the host, and takes its view in. `offersButton` false: the header never has one
    /// (pictures).
    [[nodiscard]] static std::shared_ptr<WidgetCard>
    cardWithHost_offersButton(const std::shared_ptr<WidgetHost>& host, bool offersButton);

    /// What the whole card measures with content of that size, in points.
    [[nodiscard]] static CGSize sizeForContentSize(CGSize contentSize) {
        return {contentSize.width, contentSize.height + HeaderHeight};
    }

    /// Shows the host's view and mode, and whether there is more, in the person's language.
    void update();

    /// Where a press counts for the button, in the card's coordinates: at least 44 × 36. Empty
    /// while there is no button.
    [[nodiscard]] CGRect buttonArea() const;
    /// Its words; what assistive tools say.
    [[nodiscard]] std::string buttonTitle() const;
    /// Changes to the other mode.
    void pressButton();
    void setButtonHighlighted(bool highlighted);
    void setButtonFocused(bool focused);

    void layoutSubviews() override;
    void drawRect(Canvas& canvas) override;
    void traitCollectionDidChange(const UITraitCollection& previous) override;
    [[nodiscard]] std::string className() const override { return "WidgetCard"; }

private:
    void _initWithHost_offersButton(const std::shared_ptr<WidgetHost>& host, bool offersButton);
    /// `leading` from the side where reading begins.
    void place(UIView& view, CGFloat leading, CGFloat top, CGSize size);

    std::shared_ptr<WidgetHost> _host;
    std::shared_ptr<UIImageView> _icon;
    std::shared_ptr<UILabel> _name;
    std::shared_ptr<UILabel> _button;
    std::shared_ptr<UIView> _content;
    bool _offersButton = false;
    bool _buttonFocused = false;
};

} // namespace orvo
