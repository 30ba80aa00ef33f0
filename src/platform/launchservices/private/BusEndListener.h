#pragma once

#include <QDBusConnection>
#include <QObject>

#include <functional>
#include <utility>

namespace orvo {

/// Hears that a bus is gone.
class BusEndListener : public QObject {
    Q_OBJECT

public:
    BusEndListener(QDBusConnection& bus, std::function<void()> isGone)
        : _isGone(std::move(isGone)) {
        // The connection itself tells of its end, as a signal that is nobody's on the bus.
        bus.connect(QString(),
                    "/org/freedesktop/DBus/Local",
                    "org.freedesktop.DBus.Local",
                    "Disconnected",
                    this,
                    SLOT(busIsGone()));
    }

private Q_SLOTS:
    void busIsGone() { _isGone(); }

private: // NOLINT(readability-redundant-access-specifiers): what stands above are slots
    std::function<void()> _isGone;
};

} // namespace orvo
