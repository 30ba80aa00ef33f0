#include "orvo/HandOffWindows.h"

#include "orvo/HandOffPage.h"
#include "orvo/window/WindowApplication.h"

namespace orvo {

namespace {

class DesktopWindows final : public HandOffWindows {
public:
    void show(const HandOff::Content& content,
              CommandContext& context,
              const std::string& activationToken) override {
        if (const auto page = incidentPageOf(content, context))
            _windows.show(*page, activationToken);
        else
            _windows.show(std::make_shared<FavoritesEditor>(CommandContext::favorites),
                          activationToken);
    }
    [[nodiscard]] bool isAnyOpen() const override { return _windows.isAnyOpen(); }
    void setAllClosed(std::function<void()> allClosed) override {
        _windows.setAllClosed(std::move(allClosed));
    }

private:
    ApplicationWindows _windows;
};

} // namespace

std::unique_ptr<HandOffWindows> HandOffWindows::make() {
    return WindowApplication::isMade() ? std::make_unique<DesktopWindows>() : nullptr;
}

} // namespace orvo
