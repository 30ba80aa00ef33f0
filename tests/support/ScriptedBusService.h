#pragma once

#include "platform/foundation/RunLoop.h"
#include "support/PrivateBus.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVariant>
#include <QDBusVirtualObject>

#include <cstdlib>
#include <string>

namespace orvo::testing {

/// A bus in the place of the session's and of the system's: one for all tests of the process, which
/// finds these only once. The variables that name them are set each time.
inline std::string desktopBusAddress() {
    static const PrivateBus bus;
    constexpr int replace = 1;
    (void)RunLoop::main();
    for (const char* variable : {"DBUS_SESSION_BUS_ADDRESS", "DBUS_SYSTEM_BUS_ADDRESS"})
        setenv(variable, bus.address().c_str(), replace);
    return bus.address();
}

/// Stands for a service of the desktop, on the bus at an address. It answers in the test's own
/// thread, while that runs its run loop; messages arrive in the order in which they are sent.
class ScriptedBusService : public QDBusVirtualObject {
public:
    /// Owns the names when it is made.
    ScriptedBusService(const std::string& address, const QStringList& names)
        : bus(QDBusConnection::connectToBus(QString::fromStdString(address), names.front())) {
        bus.registerVirtualObject("/", this, QDBusConnection::SubPath);
        for (const auto& name : names)
            bus.registerService(name);
    }
    ~ScriptedBusService() override { QDBusConnection::disconnectFromBus(bus.name()); }

    void signal(const char* path,
                const char* interface,
                const char* name,
                const QVariantList& arguments) const {
        auto message = QDBusMessage::createSignal(path, interface, name);
        message.setArguments(arguments);
        bus.send(message);
    }
    /// @param values those that the signal tells
    /// @param others the names of those that it does not
    void propertiesChanged(const char* path,
                           const char* interface,
                           const QVariantMap& values,
                           const QStringList& others) const {
        signal(path,
               "org.freedesktop.DBus.Properties",
               "PropertiesChanged",
               {QString(interface), values, others});
    }

    QDBusConnection bus;
    int asked = 0; ///< so many calls it has taken

protected:
    /// What is replied to any call.
    virtual QVariant answerTo(const QDBusMessage& question) = 0;
    /// As the answer to one that asks for a property.
    static QVariant propertyAnswer(const QVariant& value) {
        return QVariant::fromValue(QDBusVariant(value));
    }

private:
    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
        ++asked;
        connection.send(message.createReply(answerTo(message)));
        return true;
    }
};

} // namespace orvo::testing
