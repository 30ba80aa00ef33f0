#include "platform/mapuikit/DesktopNetworkState.h"

#include <QDBusConnection>
#include <QDBusInterface>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusReply>
#include <QDBusVariant>
#include <QDeadlineTimer>

#include <algorithm>
#include <fstream>
#include <string>

namespace orvo {

namespace {

const char* const Service = "org.freedesktop.NetworkManager";
const char* const ManagerPath = "/org/freedesktop/NetworkManager";
const char* const ManagerInterface = "org.freedesktop.NetworkManager";
const char* const DeviceInterface = "org.freedesktop.NetworkManager.Device";

constexpr int Patience = 1000; // milliseconds

// NetworkManager's numbers: NM_STATE_CONNECTED_GLOBAL, NM_DEVICE_TYPE_…
constexpr uint ConnectedGlobally = 70;
constexpr uint UnknownState = 0;
constexpr uint EthernetDevice = 1;
constexpr uint WirelessDevice = 2;
constexpr uint ModemDevice = 8;

/// The network service, asked within one span of patience for all questions together. A service
/// that does not run is not started.
class NetworkService {
public:
    [[nodiscard]] QVariant property(const QString& path, const char* interface, const char* name) {
        const int left = static_cast<int>(_patience.remainingTime());
        if (left == 0)
            return {};
        auto call =
            QDBusMessage::createMethodCall(Service, path, "org.freedesktop.DBus.Properties", "Get");
        call << QString(interface) << QString(name);
        call.setAutoStartService(false);
        const QDBusReply<QDBusVariant> reply =
            QDBusConnection::systemBus().call(call, QDBus::Block, left);
        return reply.isValid() ? reply.value().variant() : QVariant();
    }

private:
    QDeadlineTimer _patience{Patience};
};

void takeDevices(NetworkService& service, DesktopNetworkState& state) {
    const auto devices = qdbus_cast<QList<QDBusObjectPath>>(
        service.property(ManagerPath, ManagerInterface, "Devices"));
    for (const auto& device : devices) {
        const auto type = service.property(device.path(), DeviceInterface, "DeviceType").toUInt();
        state.hasMobileDevice = state.hasMobileDevice || type == ModemDevice;
        state.hasWiredOrWirelessDevice =
            state.hasWiredOrWirelessDevice || type == EthernetDevice || type == WirelessDevice;
    }
}

std::optional<std::string> firstWord(const std::filesystem::path& file) {
    std::ifstream stream(file);
    std::string word;
    return stream >> word ? std::optional(word) : std::nullopt;
}

} // namespace

std::vector<RadioState> radiosIn(const std::filesystem::path& folder) {
    std::vector<RadioState> radios;
    std::error_code unreadable;
    for (const auto& entry : std::filesystem::directory_iterator(folder, unreadable)) {
        const auto type = firstWord(entry.path() / "type");
        const auto soft = firstWord(entry.path() / "soft");
        const auto hard = firstWord(entry.path() / "hard");
        if (type && soft && hard)
            radios.push_back(
                {.isMobile = *type == "wwan", .isBlocked = *soft == "1" || *hard == "1"});
    }
    return radios;
}

EnvironmentSlot<std::filesystem::path>& RadiosFolder() {
    static EnvironmentSlot<std::filesystem::path> slot(
        [] { return std::filesystem::path("/sys/class/rfkill"); });
    return slot;
}

DesktopNetworkState desktopNetworkState() {
    DesktopNetworkState state;
    state.radios = radiosIn(RadiosFolder().get());
    if (!QDBusConnection::systemBus().isConnected())
        return state;
    NetworkService service;
    const auto connection = service.property(ManagerPath, ManagerInterface, "State");
    if (!connection.isValid() || connection.toUInt() == UnknownState)
        return state;
    state.isOnline = connection.toUInt() == ConnectedGlobally;
    if (*state.isOnline)
        return state;
    const auto isMobileEnabled = service.property(ManagerPath, ManagerInterface, "WwanEnabled");
    state.isMobileDataDisabled = isMobileEnabled.isValid() && !isMobileEnabled.toBool();
    takeDevices(service, state);
    return state;
}

NetworkFailureDiagnosis diagnosisOf(const DesktopNetworkState& state) {
    if (!state.isOnline)
        return NetworkFailureDiagnosis::Unknown;
    if (*state.isOnline)
        return NetworkFailureDiagnosis::None;
    if (!state.radios.empty() && std::ranges::all_of(state.radios, &RadioState::isBlocked))
        return NetworkFailureDiagnosis::AirplaneMode;
    const bool isMobileBlocked = std::ranges::any_of(
        state.radios, [](const RadioState& radio) { return radio.isMobile && radio.isBlocked; });
    if (state.hasMobileDevice && !state.hasWiredOrWirelessDevice &&
        (state.isMobileDataDisabled || isMobileBlocked))
        return NetworkFailureDiagnosis::CellDataDisabled;
    return NetworkFailureDiagnosis::NoInternet;
}

} // namespace orvo
