#include "platform/extension/window/DesktopWidget.h"

#include "platform/extension/WidgetCard.h"
#include "platform/extension/window/WidgetWindow.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"
#include "platform/foundation/Text.h"

#include <QGuiApplication>
#include <QScreen>

namespace orvo {

namespace {

std::shared_ptr<WidgetHost> hostWithLooks(const Extension& extension,
                                          const WidgetHostSettings& settings,
                                          const DesktopAppearance& appearance) {
    UITraitCollection::setSystem(appearance.appliedTo(UITraitCollection::system().get()));
    auto onScreen = settings;
    // The first frame has as many rows as the screen has room for, not fewer.
    if (const auto* const screen = QGuiApplication::primaryScreen())
        onScreen.freeHeight = screen->availableGeometry().height() - WidgetCard::HeaderHeight;
    return WidgetHost::hostWithExtension_settings(extension, onScreen);
}

} // namespace

DesktopWidget::DesktopWidget(const Extension& extension,
                             const WidgetHostSettings& settings,
                             std::function<void()> closed)
    : _followsLanguage(settings.followsLanguage)
    , _host(hostWithLooks(extension, settings, _appearance))
    , _window(WidgetWindow::windowWithHost(_host))
    , _events(SystemEvents::factory().get()()) {
    _window->setClosed(std::move(closed));
    _window->setFirstFrameShown([this, alive = std::weak_ptr<WidgetWindow>(_window)] {
        DispatchQueue::mainQueue()->async([this, alive] {
            if (alive.lock())
                followDesktop();
        });
    });
    _window->show();
}

DesktopWidget::~DesktopWidget() {
    _events->stop();
    _settings.stop();
    _language.stop();
}

void DesktopWidget::followDesktop() {
    _settings.start([this](const DesktopAppearance& appearance) { takeAppearance(appearance); });
    _events->start({.lockDidChange = [this](bool locked) { _host->setLocked(locked); },
                    .machineDidWake = [this] { _host->machineDidWake(); },
                    .networkDidChange = [this] { _host->networkDidChange(); },
                    .memoryIsScarce =
                        [this] {
                            _host->didReceiveMemoryWarning();
                        }});
    if (_followsLanguage)
        _language.start([this](const std::string& language) { takeLanguage(language); });
}

void DesktopWidget::takeAppearance(const DesktopAppearance& appearance) {
    if (appearance == _appearance)
        return;
    _appearance = appearance;
    _window->setTraits(appearance.appliedTo(UITraitCollection::system().get()));
    appearance.remember();
}

void DesktopWidget::takeLanguage(const std::string& language) {
    Text::locale().set(language);
    auto traits = UITraitCollection::system().get();
    traits.layoutDirection = Text::isRightToLeft(language)
                                 ? UIUserInterfaceLayoutDirection::RightToLeft
                                 : UIUserInterfaceLayoutDirection::LeftToRight;
    _window->setTraits(traits);
    _host->startWidgetAnew();
}

int runDesktopWidget(const Extension& extension,
                     const WidgetHostSettings& settings,
                     const std::function<void(const std::shared_ptr<WidgetHost>& host)>& began) {
    const DesktopWidget widget(extension, settings, [] { RunLoop::main().stop(); });
    if (began)
        began(widget.host());
    return RunLoop::main().run();
}

} // namespace orvo
