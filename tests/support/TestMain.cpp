#include <gmock/gmock.h>

#include <cstdlib>

/// Every test runs in the same surroundings, however it is started: an unusual zone, a plain
/// locale, no display, no desktop bus. Only where the captured feeds lie may be said from outside.
int main(int argc, char** argv) {
    constexpr int replace = 1;
    constexpr int keep = 0;
    setenv("TZ", "Pacific/Chatham", replace);
    setenv("LC_ALL", "C.UTF-8", replace);
    setenv("QT_QPA_PLATFORM", "offscreen", replace);
    setenv("DBUS_SESSION_BUS_ADDRESS", "disabled:", replace);
    setenv("ORVO_TEST_FEEDS", ORVO_DEFAULT_TEST_FEEDS, keep);
    testing::InitGoogleMock(&argc, argv);
    return RUN_ALL_TESTS();
}
