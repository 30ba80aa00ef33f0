#include "orvo/window/ApplicationWindows.h"

#include "orvo/window/private/FavoritesView.h"
#include "orvo/window/private/IncidentView.h"
#include "platform/foundation/Text.h"
#include "platform/settings/DesktopSettings.h"

#include <QApplication>
#include <QDesktopServices>
#include <QEvent>
#include <QUrl>

namespace orvo {

namespace {

void bringToFront(QWidget& window, const std::string& activationToken) {
    if (!activationToken.empty())
        qputenv("XDG_ACTIVATION_TOKEN", QByteArray::fromStdString(activationToken));
    if (window.isMinimized())
        window.showNormal();
    else
        window.show();
    window.raise();
    window.activateWindow();
}

} // namespace

struct ApplicationWindows::Private {
    /// Tells when a window was closed.
    class CloseWatch final : public QObject {
    public:
        explicit CloseWatch(std::function<void()> closed)
            : _closed(std::move(closed)) {}

        bool eventFilter(QObject* watched, QEvent* event) override {
            if (event->type() == QEvent::Close)
                QMetaObject::invokeMethod(this, _closed, Qt::QueuedConnection);
            return QObject::eventFilter(watched, event);
        }

    private:
        std::function<void()> _closed;
    };

    Private()
        : watch([this] {
            if (allClosed && !isAnyOpen())
                allClosed();
        })
        , incidents([](const QString& url) { QDesktopServices::openUrl(QUrl(url)); }) {
        incidents.setObjectName("incidents");
        favorites.setObjectName("favorites");
        for (QWidget* const window :
             {static_cast<QWidget*>(&incidents), static_cast<QWidget*>(&favorites)})
            window->installEventFilter(&watch);
    }

    [[nodiscard]] bool isAnyOpen() const { return incidents.isVisible() || favorites.isVisible(); }

    void setAppearance(const DesktopAppearance& appearance) {
        looks = WindowLooks::of(appearance);
        looks.applyToApplication();
        if (page)
            incidents.show(*page, looks);
        favorites.setLooks(looks);
    }

    std::function<void()> allClosed;
    CloseWatch watch;
    WindowLooks looks;
    IncidentView incidents;
    FavoritesView favorites;
    std::optional<IncidentPage> page; ///< the one that is shown
    DesktopSettings settings;
};

ApplicationWindows::ApplicationWindows() {
    QGuiApplication::setLayoutDirection(
        Text::isRightToLeft(Text::locale().get()) ? Qt::RightToLeft : Qt::LeftToRight);
    // Before the first widget is made: a change of style costs them all.
    const auto remembered = DesktopAppearance::remembered();
    WindowLooks::of(remembered).applyToApplication();
    _private = std::make_unique<Private>();
    _private->setAppearance(remembered);
    _private->settings.start(
        [this](const DesktopAppearance& appearance) { _private->setAppearance(appearance); });
}

ApplicationWindows::~ApplicationWindows() = default;

void ApplicationWindows::show(const IncidentPage& page, const std::string& activationToken) {
    _private->page = page;
    _private->incidents.show(page, _private->looks);
    if (!_private->incidents.isVisible())
        _private->incidents.resize(_private->incidents.sizeHint());
    bringToFront(_private->incidents, activationToken);
}

void ApplicationWindows::show(std::shared_ptr<FavoritesEditor> favorites,
                              const std::string& activationToken) {
    _private->favorites.edit(std::move(favorites));
    if (!_private->favorites.isVisible())
        _private->favorites.resize(_private->favorites.sizeHint());
    bringToFront(_private->favorites, activationToken);
}

bool ApplicationWindows::isAnyOpen() const {
    return _private->isAnyOpen();
}

void ApplicationWindows::setAllClosed(std::function<void()> allClosed) {
    _private->allClosed = std::move(allClosed);
}

} // namespace orvo
