#include "platform/mapuikit/DesktopNetworkState.h"

#include "platform/foundation/RunLoop.h"
#include "support/MockBusService.h"
#include "support/PrivateBus.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <memory>

namespace orvo {
namespace {

TEST(NetworkFailureDiagnosis, OnlineHasNoSpecificCauseWhateverTheRadiosSay) {
    EXPECT_EQ(diagnosisOf({.isOnline = true, .radios = {{.isBlocked = true}}}),
              NetworkFailureDiagnosis::None);
}

TEST(NetworkFailureDiagnosis, IsUnknownWhereNobodyTells) {
    EXPECT_EQ(diagnosisOf({}), NetworkFailureDiagnosis::Unknown);
    EXPECT_EQ(diagnosisOf({.radios = {{.isBlocked = true}}}), NetworkFailureDiagnosis::Unknown);
}

TEST(NetworkFailureDiagnosis, OfflineWithEveryRadioBlockedIsAirplaneMode) {
    EXPECT_EQ(diagnosisOf({.isOnline = false,
                           .radios = {{.isBlocked = true}, {.isMobile = true, .isBlocked = true}}}),
              NetworkFailureDiagnosis::AirplaneMode);
    EXPECT_EQ(diagnosisOf({.isOnline = false, .radios = {{.isBlocked = true}, {}}}),
              NetworkFailureDiagnosis::NoInternet);
    EXPECT_EQ(diagnosisOf({.isOnline = false}), NetworkFailureDiagnosis::NoInternet);
}

TEST(NetworkFailureDiagnosis, MobileDataIsTheCauseOnlyWhereItIsTheOnlyWayOut) {
    EXPECT_EQ(
        diagnosisOf({.isOnline = false, .isMobileDataDisabled = true, .hasMobileDevice = true}),
        NetworkFailureDiagnosis::CellDataDisabled);
    EXPECT_EQ(diagnosisOf({.isOnline = false,
                           .radios = {{.isMobile = true, .isBlocked = true}, {}},
                           .hasMobileDevice = true}),
              NetworkFailureDiagnosis::CellDataDisabled);
    EXPECT_EQ(diagnosisOf({.isOnline = false,
                           .isMobileDataDisabled = true,
                           .hasMobileDevice = true,
                           .hasWiredOrWirelessDevice = true}),
              NetworkFailureDiagnosis::NoInternet);
    EXPECT_EQ(diagnosisOf({.isOnline = false, .isMobileDataDisabled = true}),
              NetworkFailureDiagnosis::NoInternet);
}

TEST(Radios, AreReadFromTheKernelsFolder) {
    const testing::TemporaryFolder folder;
    const auto radio = [&](const char* name, const char* type, const char* soft, const char* hard) {
        std::filesystem::create_directories(folder.path() / name);
        std::ofstream(folder.path() / name / "type") << type << "\n";
        std::ofstream(folder.path() / name / "soft") << soft << "\n";
        std::ofstream(folder.path() / name / "hard") << hard << "\n";
    };
    radio("rfkill0", "wlan", "0", "0");
    radio("rfkill1", "wwan", "1", "0");
    radio("rfkill2", "bluetooth", "0", "1");
    std::filesystem::create_directories(folder.path() / "unreadable");
    const auto radios = radiosIn(folder.path());
    ASSERT_EQ(radios.size(), 3U);
    EXPECT_EQ(std::ranges::count_if(radios, &RadioState::isBlocked), 2);
    EXPECT_EQ(std::ranges::count_if(radios, &RadioState::isMobile), 1);
    EXPECT_TRUE(radiosIn(folder.path() / "none").empty());
}

/// The whole way, from services on a bus of the test's own to the number that rows ask for. The
/// toolkit keeps its connection for the process, and so one bus serves all these tests.
class NetworkServicesTest : public ::testing::Test {
protected:
    static void SetUpTestSuite() {
        static const testing::PrivateBus bus;
        address = bus.address();
        setenv("DBUS_SYSTEM_BUS_ADDRESS", address.c_str(), 1);
        (void)RunLoop::main(); // the toolkit's connection wants an application object
    }
    void offline() {
        service = std::make_unique<testing::MockBusService>(address, Service);
        setManager("State", std::uint32_t{20});
        setManager("WwanEnabled", true);
        setManager("Devices", testing::MockBusService::ObjectPaths{});
    }
    void setManager(const char* property, testing::MockBusService::Value value) {
        service->set(ManagerPath, Service, property, std::move(value));
    }
    void setDevices(const std::vector<std::uint32_t>& types) {
        testing::MockBusService::ObjectPaths devices;
        for (const std::uint32_t type : types) {
            devices.paths.push_back(std::string(ManagerPath) + "/Devices/" +
                                    std::to_string(devices.paths.size()));
            service->set(
                devices.paths.back(), std::string(Service) + ".Device", "DeviceType", type);
        }
        setManager("Devices", devices);
    }
    void addRadio(const char* name, const char* type, bool isBlocked) const {
        const auto radio = folder.path() / name;
        std::filesystem::create_directories(radio);
        std::ofstream(radio / "type") << type << "\n";
        std::ofstream(radio / "soft") << isBlocked << "\n";
        std::ofstream(radio / "hard") << "0\n";
    }

    static constexpr const char* Service = "org.freedesktop.NetworkManager";
    static constexpr const char* ManagerPath = "/org/freedesktop/NetworkManager";
    static constexpr std::uint32_t Ethernet = 1;
    static constexpr std::uint32_t Modem = 8;
    static inline std::string address;

    testing::TemporaryFolder folder;
    EnvironmentSlot<std::filesystem::path>::Override radios =
        RadiosFolder().overrideWith(folder.path());
    std::unique_ptr<testing::MockBusService> service;
};

TEST_F(NetworkServicesTest, ConnectedMachineHasNoSpecificCause) {
    offline();
    setManager("State", std::uint32_t{70});
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 0U);
}

TEST_F(NetworkServicesTest, BlockedRadiosAreAirplaneMode) {
    offline();
    addRadio("rfkill0", "wlan", true);
    addRadio("rfkill1", "wwan", true);
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 1U);
    addRadio("rfkill1", "wwan", false);
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 3U);
}

TEST_F(NetworkServicesTest, DisabledMobileDataIsTheCauseOnAMachineWithOnlyAModem) {
    offline();
    setDevices({Modem});
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 3U);
    setManager("WwanEnabled", false);
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 2U);
    setDevices({Modem, Ethernet});
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 3U);
}

TEST_F(NetworkServicesTest, ConnectionThatEndsBeforeTheInternetIsNoInternet) {
    offline();
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 3U);
    setManager("State", std::uint32_t{60}); // reaches its site alone
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 3U);
}

TEST_F(NetworkServicesTest, IsUnknownWithoutTheServiceAndWhenItDoesNotKnow) {
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 4U);
    offline();
    setManager("State", std::uint32_t{0});
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 4U);
}

TEST_F(NetworkServicesTest, SilentServiceIsAskedOnceAndGivenUp) {
    offline();
    service->fallSilent();
    EXPECT_EQ(CurrentNetworkFailureDiagnosis(), 4U);
    EXPECT_EQ(service->calls(), 1);
}

} // namespace
} // namespace orvo
