#pragma once

#include "platform/settings/DesktopAppearance.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QMap>
#include <QObject>
#include <QVariantMap>

#include <functional>
#include <optional>

namespace orvo {

using SettingsByNamespace = QMap<QString, QVariantMap>;

/// What the settings mean; of several that say the same the desktops' common one counts.
[[nodiscard]] DesktopAppearance appearanceOf(const SettingsByNamespace& settings);

/// Receives what the portal tells.
class SettingsListener : public QObject {
    Q_OBJECT

public:
    explicit SettingsListener(std::function<void(const DesktopAppearance&)> changed);
    ~SettingsListener() override;

private Q_SLOTS:
    /// The whole message: the toolkit refuses a slot for its variants until it has met one.
    void settingChanged(const QDBusMessage& message);

private:
    void askAll();
    void tell();

    std::function<void(const DesktopAppearance&)> _changed;
    QString _connectionName;
    QDBusConnection _bus;
    SettingsByNamespace _settings;
    std::optional<DesktopAppearance> _told;
};

} // namespace orvo
