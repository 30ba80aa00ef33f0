#include "platform/extension/DesktopSystemEvents.h"

#include "platform/foundation/DispatchSource.h"
#include "platform/foundation/RunLoop.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusVariant>
#include <QObject>

#include <optional>
#include <vector>

namespace orvo {

namespace {

const char* const LoginService = "org.freedesktop.login1";
const char* const LoginPath = "/org/freedesktop/login1";
const char* const LoginInterface = "org.freedesktop.login1.Manager";
const char* const SessionInterface = "org.freedesktop.login1.Session";
// The session of this process, or the one that its user has on a display.
const char* const SessionPath = "/org/freedesktop/login1/session/auto";
const char* const NetworkService = "org.freedesktop.NetworkManager";
const char* const NetworkPath = "/org/freedesktop/NetworkManager";
const char* const NetworkInterface = "org.freedesktop.NetworkManager";
const char* const PropertiesInterface = "org.freedesktop.DBus.Properties";
constexpr uint ConnectedGlobally = 70; // NM_STATE_CONNECTED_GLOBAL

} // namespace

/// Receives what the system bus tells.
class BusListener final : public QObject {
    Q_OBJECT

public:
    explicit BusListener(SystemEvents::Handlers handlers)
        : _handlers(std::move(handlers))
        , _connectionName(
              QString("orvo-system-events-%1").arg(reinterpret_cast<quintptr>(this), 0, 16))
        , _bus(QDBusConnection::connectToBus(QDBusConnection::SystemBus, _connectionName)) {
        listen();
        askLock();
        askNetwork();
    }
    ~BusListener() override { QDBusConnection::disconnectFromBus(_connectionName); }

private Q_SLOTS:
    void sessionChanged() { askLock(); }
    void preparingForSleep(bool begins) {
        if (!begins && _handlers.machineDidWake)
            _handlers.machineDidWake();
    }
    void networkState(uint state) { takeNetworkState(state == ConnectedGlobally); }

private:
    void listen() {
        // Signals come from the session's own path, whatever that is.
        _bus.connect(LoginService,
                     QString(),
                     PropertiesInterface,
                     "PropertiesChanged",
                     {SessionInterface},
                     QString(),
                     this,
                     SLOT(sessionChanged()));
        _bus.connect(LoginService,
                     LoginPath,
                     LoginInterface,
                     "PrepareForSleep",
                     this,
                     SLOT(preparingForSleep(bool)));
        _bus.connect(NetworkService,
                     NetworkPath,
                     NetworkInterface,
                     "StateChanged",
                     this,
                     SLOT(networkState(uint)));
    }

    /// `take` hears the value, unless nobody answers.
    template <class Take>
    void
    ask(const char* service, const char* path, const char* interface, const char* name, Take take) {
        auto call = QDBusMessage::createMethodCall(service, path, PropertiesInterface, "Get");
        call << QString(interface) << QString(name);
        call.setAutoStartService(false);
        auto* const watcher = new QDBusPendingCallWatcher(_bus.asyncCall(call), this);
        connect(watcher, &QDBusPendingCallWatcher::finished, this, [watcher, take] {
            const QDBusPendingReply<QDBusVariant> reply = *watcher;
            watcher->deleteLater();
            if (reply.isValid())
                take(reply.value().variant());
        });
    }
    void askLock() {
        ask(LoginService,
            SessionPath,
            SessionInterface,
            "LockedHint",
            [this](const QVariant& value) { takeLock(value.toBool()); });
    }
    void askNetwork() {
        ask(NetworkService, NetworkPath, NetworkInterface, "State", [this](const QVariant& value) {
            if (!_online)
                _online = value.toUInt() == ConnectedGlobally;
        });
    }
    void takeLock(bool locked) {
        if (locked == _locked)
            return;
        _locked = locked;
        if (_handlers.lockDidChange)
            _handlers.lockDidChange(locked);
    }
    void takeNetworkState(bool online) {
        if (online == _online)
            return;
        _online = online;
        if (_handlers.networkDidChange)
            _handlers.networkDidChange();
    }

    SystemEvents::Handlers _handlers;
    QString _connectionName;
    QDBusConnection _bus;
    bool _locked = false;
    std::optional<bool> _online; // nothing while the service has not said
};

struct DesktopSystemEvents::Private {
    std::unique_ptr<BusListener> listener;
    std::vector<std::shared_ptr<DispatchSource>> memory;
};

DesktopSystemEvents::DesktopSystemEvents()
    : _private(std::make_unique<Private>()) {}

DesktopSystemEvents::~DesktopSystemEvents() {
    stop();
}

void DesktopSystemEvents::start(Handlers handlers) {
    stop();
    (void)RunLoop::main(); // makes what the bus's answers come through
    for (const auto mask : {MemoryPressure::Warning,
                            MemoryPressure::Critical,
                            MemoryPressure::ProcessLimitWarning,
                            MemoryPressure::ProcessLimitCritical}) {
        if (!handlers.memoryIsScarce)
            break;
        auto source = DispatchSource::memoryPressureSource(mask, DispatchQueue::mainQueue());
        source->setEventHandler(handlers.memoryIsScarce);
        source->activate();
        _private->memory.push_back(std::move(source));
    }
    _private->listener = std::make_unique<BusListener>(std::move(handlers));
}

void DesktopSystemEvents::stop() {
    _private->listener = nullptr;
    for (const auto& source : _private->memory)
        source->cancel();
    _private->memory.clear();
}

} // namespace orvo

#include "DesktopSystemEvents.moc"
