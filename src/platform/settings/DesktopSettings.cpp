#include "platform/settings/DesktopSettings.h"

#include "platform/foundation/RunLoop.h"
#include "platform/settings/private/SettingsListener.h"

#include <QDBusArgument>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusServiceWatcher>
#include <QDBusVariant>

namespace orvo {

namespace {

constexpr const char* Service = "org.freedesktop.portal.Desktop";
constexpr const char* Path = "/org/freedesktop/portal/desktop";
constexpr const char* Interface = "org.freedesktop.portal.Settings";

// What desktops agree on, and what one of them says besides.
constexpr const char* Common = "org.freedesktop.appearance";
constexpr const char* Gnome = "org.gnome.desktop.interface";
constexpr const char* GnomeTools = "org.gnome.desktop.a11y.interface";

constexpr uint PrefersDark = 1;
constexpr uint NoPreference = 0;
constexpr uint PrefersMore = 1;

} // namespace

DesktopAppearance appearanceOf(const SettingsByNamespace& settings) {
    const auto common = settings.value(Common);
    const auto gnome = settings.value(Gnome);
    DesktopAppearance appearance;
    const auto scheme = common.value("color-scheme", NoPreference).toUInt();
    appearance.isDark = scheme == PrefersDark ||
                        (scheme == NoPreference && gnome.value("color-scheme") == "prefer-dark");
    appearance.hasHighContrast = common.value("contrast").toUInt() == PrefersMore ||
                                 settings.value(GnomeTools).value("high-contrast").toBool();
    appearance.reducesMotion = common.value("reduced-motion").toUInt() == PrefersMore ||
                               !gnome.value("enable-animations", true).toBool();
    const auto scale = gnome.value("text-scaling-factor", 1.0).toDouble();
    appearance.textScale = scale > 0 ? scale : 1;
    return appearance;
}

SettingsListener::SettingsListener(std::function<void(const DesktopAppearance&)> changed)
    : _changed(std::move(changed))
    , _connectionName(
          QString("orvo-desktop-settings-%1").arg(reinterpret_cast<quintptr>(this), 0, 16))
    , _bus(QDBusConnection::connectToBus(QDBusConnection::SessionBus, _connectionName)) {
    if (!_bus.isConnected())
        return;
    _bus.connect(
        Service, Path, Interface, "SettingChanged", this, SLOT(settingChanged(QDBusMessage)));
    auto* const watcher =
        new QDBusServiceWatcher(Service, _bus, QDBusServiceWatcher::WatchForRegistration, this);
    connect(watcher, &QDBusServiceWatcher::serviceRegistered, this, [this] { askAll(); });
    askAll();
}

SettingsListener::~SettingsListener() {
    QDBusConnection::disconnectFromBus(_connectionName);
}

void SettingsListener::askAll() {
    auto call = QDBusMessage::createMethodCall(Service, Path, Interface, "ReadAll");
    call << QStringList{Common, Gnome, GnomeTools};
    auto* const watcher = new QDBusPendingCallWatcher(_bus.asyncCall(call), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this, watcher] {
        const QDBusMessage reply = watcher->reply();
        watcher->deleteLater();
        const auto answer = reply.arguments().value(0);
        if (reply.type() != QDBusMessage::ReplyMessage ||
            answer.userType() != qMetaTypeId<QDBusArgument>() ||
            answer.value<QDBusArgument>().currentSignature() != "a{sa{sv}}")
            return;
        _settings = qdbus_cast<SettingsByNamespace>(answer);
        tell();
    });
}

void SettingsListener::settingChanged(const QDBusMessage& message) {
    const auto words = message.arguments();
    if (message.signature() != "ssv")
        return;
    _settings[words[0].toString()][words[1].toString()] = words[2].value<QDBusVariant>().variant();
    if (_told)
        tell(); // before the first answer this would be a part of the truth
}

void SettingsListener::tell() {
    const auto appearance = appearanceOf(_settings);
    if (appearance == _told)
        return;
    _told = appearance;
    _changed(appearance);
}

struct DesktopSettings::Private {
    std::unique_ptr<SettingsListener> listener;
};

DesktopSettings::DesktopSettings()
    : _private(std::make_unique<Private>()) {}

DesktopSettings::~DesktopSettings() = default;

void DesktopSettings::start(std::function<void(const DesktopAppearance&)> changed) {
    (void)RunLoop::main(); // makes what the bus's answers come through
    _private->listener = std::make_unique<SettingsListener>(std::move(changed));
}

void DesktopSettings::stop() {
    _private->listener = nullptr;
}

} // namespace orvo
