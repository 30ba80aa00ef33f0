#pragma once

#include "platform/foundation/RunLoop.h"
#include "support/PrivateBus.h"
#include "support/TemporaryProfile.h"

#include <QDBusConnection>
#include <QDBusConnectionInterface>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <gtest/gtest.h>

#include <cstdlib>

namespace orvo::testing {

/// A session bus of the process's own, and another program on it: a second connection. The toolkit
/// keeps the first session bus that it found, so there is one for all tests.
class BusTest : public ::testing::Test {
protected:
    static constexpr const char* Application = "org.example.Map";
    static constexpr const char* Path = "/org/example/Map";
    static constexpr const char* Interface = "org.freedesktop.Application";
    static constexpr NSTimeInterval Patience = 30;

    static void SetUpTestSuite() {
        static const PrivateBus bus;
        constexpr int replace = 1;
        setenv("DBUS_SESSION_BUS_ADDRESS", bus.address().c_str(), replace);
        (void)RunLoop::main();
        other() = QDBusConnection::connectToBus(QString::fromStdString(bus.address()), "other");
    }
    static QDBusConnection& other() {
        static QDBusConnection connection("none");
        return connection;
    }

    static bool waitFor(const std::function<bool()>& done) {
        return RunLoop::main().runUntil(done, Patience);
    }
    /// The answer to a call of the other program.
    static QDBusMessage ask(const char* method, const QVariantList& arguments) {
        auto call = QDBusMessage::createMethodCall(Application, Path, Interface, method);
        call.setArguments(arguments);
        return answerTo(other().asyncCall(call));
    }
    static QDBusMessage answerTo(const QDBusPendingCall& pending) {
        const QDBusPendingCallWatcher watcher(pending); // its end is a turn of the run loop
        waitFor([&] { return watcher.isFinished(); });
        return pending.reply();
    }

    TemporaryProfile profile;
};

} // namespace orvo::testing
