#include "platform/settings/DesktopLanguage.h"

#include "platform/foundation/LocaleVariables.h"
#include "platform/foundation/RunLoop.h"
#include "platform/foundation/Text.h"
#include "platform/settings/private/LanguageListener.h"

#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusVariant>

#include <algorithm>
#include <array>
#include <cstdlib>

namespace orvo {

namespace {

constexpr const char* LocaleService = "org.freedesktop.locale1";
constexpr const char* LocalePath = "/org/freedesktop/locale1";
constexpr const char* LocaleInterface = "org.freedesktop.locale1";
constexpr const char* PropertiesInterface = "org.freedesktop.DBus.Properties";

std::string setInEnvironment(const char* variable) {
    const char* const value = std::getenv(variable);
    return value ? value : "";
}

/// Of assignments as `LANG=de_CH.UTF-8`.
std::string languageOf(const QStringList& assignments) {
    return localeOfVariables([&](const std::string& variable) -> std::optional<std::string> {
        const auto beginning = QString::fromStdString(variable + '=');
        for (const auto& assignment : assignments) {
            if (assignment.startsWith(beginning))
                return assignment.mid(beginning.size()).toStdString();
        }
        return std::nullopt;
    });
}

/// Whether `LANGUAGE`, a list, prefers another language than that, regions aside.
bool prefersAnother(const std::string& language) {
    const auto list = setInEnvironment("LANGUAGE");
    if (list.empty())
        return false;
    const auto first =
        localeOfVariables([&](const std::string&) { return list.substr(0, list.find(':')); });
    return first.substr(0, first.find('-')) != language.substr(0, language.find('-'));
}

} // namespace

LanguageListener::LanguageListener(std::function<void(const std::string& language)> changed)
    : _changed(std::move(changed))
    , _connectionName(
          QString("orvo-desktop-language-%1").arg(reinterpret_cast<quintptr>(this), 0, 16))
    , _bus(QDBusConnection::connectToBus(QDBusConnection::SystemBus, _connectionName))
    , _language(Text::locale().get()) {
    if (!_bus.isConnected())
        return;
    _bus.connect(LocaleService,
                 LocalePath,
                 PropertiesInterface,
                 "PropertiesChanged",
                 {LocaleInterface},
                 QString(),
                 this,
                 SLOT(localeChanged()));
    ask();
}

LanguageListener::~LanguageListener() {
    QDBusConnection::disconnectFromBus(_connectionName);
}

void LanguageListener::ask() {
    auto call =
        QDBusMessage::createMethodCall(LocaleService, LocalePath, PropertiesInterface, "Get");
    call << QString(LocaleInterface) << QString("Locale");
    call.setAutoStartService(false); // it ends when nobody needs it
    auto* const watcher = new QDBusPendingCallWatcher(_bus.asyncCall(call), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this, watcher] {
        const QDBusPendingReply<QDBusVariant> reply = *watcher;
        watcher->deleteLater();
        const auto value = reply.isValid() ? reply.value().variant() : QVariant();
        if (value.userType() == QMetaType::QStringList)
            take(languageOf(value.toStringList()));
        else
            takeNothing();
    });
}

void LanguageListener::take(const std::string& language) {
    if (!_follows)
        _follows = language == _language && !prefersAnother(language);
    if (!*_follows || language == _language)
        return;
    _language = language;
    _changed(language);
}

void LanguageListener::takeNothing() {
    if (_follows)
        return;
    constexpr std::array Chosen = {"LC_ALL", "LC_MESSAGES", "LANGUAGE"};
    _follows = std::ranges::all_of(
        Chosen, [](const char* variable) { return setInEnvironment(variable).empty(); });
}

struct DesktopLanguage::Private {
    std::unique_ptr<LanguageListener> listener;
};

DesktopLanguage::DesktopLanguage()
    : _private(std::make_unique<Private>()) {}

DesktopLanguage::~DesktopLanguage() = default;

void DesktopLanguage::start(std::function<void(const std::string& language)> changed) {
    (void)RunLoop::main(); // makes what the bus's answers come through
    _private->listener = std::make_unique<LanguageListener>(std::move(changed));
}

void DesktopLanguage::stop() {
    _private->listener = nullptr;
}

} // namespace orvo
