#pragma once

#include "platform/extension/WidgetPresenter.h"
#include "platform/uikit/UITraitCollection.h"

#include <functional>
#include <memory>

namespace orvo {

class WidgetCard;

/// A window of the desktop with a widget's card in it, and nothing else: no frame, and corners that
/// one looks through. The card grows and shrinks to what the host says, in a quarter of a second
/// or, with reduced motion or where nobody sees it, at once, and stays on the screen. The person
/// moves it by its header. The window is as large as the card; where the desktop makes it larger,
/// the card stands at its top in the middle, and where smaller, the card is as small, and scrolls.
///
/// The widget is shown to its host once its first frame stands, so that what it kept is seen before
/// anything is fetched; it is not shown while the window is hidden, minimised or covered by a
/// desktop that tells so. Nothing is drawn unless something changed. Needs a graphical application
/// object. Main thread.
class WidgetWindow final : public WidgetPresenter {
public:
    static constexpr double TransitionSeconds = 0.25;

    /// Becomes the presenter of the host.
    [[nodiscard]] static std::shared_ptr<WidgetWindow>
    windowWithHost(const std::shared_ptr<WidgetHost>& host);
    WidgetWindow();
    /// Closes it.
    ~WidgetWindow() override;

    /// How the desktop looks now. The scale is that of the window's screen, whatever is given.
    void setTraits(const UITraitCollection& traits);
    /// Called when the person has closed the window.
    void setClosed(std::function<void()> closed);
    /// Called once, when the first frame has been handed to the desktop, before the widget appears.
    void setFirstFrameShown(std::function<void()> shown);

    void show();
    /// Does not count as closed by the person.
    void hide();
    /// To the front, with the keyboard where the desktop permits that.
    void activate();

    /// In points of the desktop, the whole window's; a change of size under way needs room for
    /// both.
    [[nodiscard]] CGRect frame() const;
    [[nodiscard]] bool isChangingSize() const;
    [[nodiscard]] const std::shared_ptr<WidgetCard>& card() const noexcept;
    /// Lays out and shows what has changed, without waiting for the next frame.
    void displayIfNeeded();
    /// How often anything was drawn.
    [[nodiscard]] std::uint64_t framesShown() const noexcept;

    void widgetHost_transitionToContentSize(WidgetHost& host,
                                            CGSize size,
                                            std::function<void()> alongside,
                                            std::function<void()> completion) override;
    void widgetHostDidChangeDisplayMode(WidgetHost& host) override;
    void widgetHostDidChangeView(WidgetHost& host) override;

private:
    struct Private;

    void _initWithHost(const std::shared_ptr<WidgetHost>& host);

    std::unique_ptr<Private> _private;
};

} // namespace orvo
