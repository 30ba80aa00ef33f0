#pragma once

#include <QDBusConnection>
#include <QObject>
#include <QStringList>

#include <functional>
#include <optional>
#include <string>

namespace orvo {

/// Receives what localed tells.
class LanguageListener : public QObject {
    Q_OBJECT

public:
    explicit LanguageListener(std::function<void(const std::string& language)> changed);
    ~LanguageListener() override;

private Q_SLOTS:
    /// The value is not always told with it.
    void localeChanged() { ask(); }

private:
    void ask();
    void take(const std::string& language);
    void takeNothing();

    std::function<void(const std::string& language)> _changed;
    QString _connectionName;
    QDBusConnection _bus;
    std::string _language;        ///< that the program speaks
    std::optional<bool> _follows; ///< nothing before the first answer
};

} // namespace orvo
