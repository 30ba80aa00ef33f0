#include "platform/feeds/http/LoadedBodies.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"
#include "support/TemporaryProfile.h"

#include <QFile>
#include <QSslCertificate>
#include <QSslConfiguration>
#include <QSslKey>
#include <QSslServer>
#include <QSslSocket>
#include <gtest/gtest.h>

#include <atomic>

namespace orvo {
namespace {

using testing::codeOf;
using testing::messageOf;
using testing::requestFor;
using testing::textOf;

QByteArray contentOf(const char* name) {
    QFile file(QStringLiteral(ORVO_TEST_SOURCE_DIR "/platform/feeds/http/tls/") +
               QLatin1String(name));
    EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << name;
    return file.readAll();
}

/// Loads over TLS from a server on the main thread, whose certificate is its own authority and
/// holds for 127.0.0.1 alone.
class TLSTest : public ::testing::Test {
protected:
    TLSTest() {
        (void)RunLoop::main();
        auto configuration = earlier;
        configuration.setLocalCertificate(certificate);
        configuration.setPrivateKey(QSslKey(contentOf("key.pem"), QSsl::Rsa));
        server.setSslConfiguration(configuration);
        QObject::connect(&server, &QSslServer::pendingConnectionAvailable, &server, [this] {
            auto* socket = server.nextPendingConnection();
            QObject::connect(socket, &QTcpSocket::readyRead, socket, [this, socket] {
                asked += socket->readAll();
                socket->write(reply);
                socket->disconnectFromHost();
            });
        });
        EXPECT_TRUE(server.listen(QHostAddress::LocalHost));
    }
    ~TLSTest() override { QSslConfiguration::setDefaultConfiguration(earlier); }

    void trustTheServer() {
        auto configuration = earlier;
        configuration.addCaCertificate(certificate);
        QSslConfiguration::setDefaultConfiguration(configuration);
    }
    SourceBody load(const std::string& host = "127.0.0.1") {
        const auto loader = SourceLoader::make(folder.path());
        SourceBody body;
        std::atomic<bool> done = false;
        location = "https://" + host + ":" + std::to_string(server.serverPort()) + "/alerts.pb";
        (void)loader->load(requestFor(location), {}, [&](SourceBody got) {
            body = std::move(got);
            done = true;
            DispatchQueue::mainQueue()->async([] {}); // wakes the run loop
        });
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return done.load(); }, 30));
        return body;
    }

    testing::TemporaryFolder folder;
    QSslConfiguration earlier = QSslConfiguration::defaultConfiguration();
    QSslCertificate certificate{contentOf("certificate.pem")};
    QSslServer server;
    QByteArray reply = "HTTP/1.1 200 OK\r\nContent-Length: 4\r\n\r\nbody";
    QByteArray asked;
    std::string location;
};

TEST_F(TLSTest, ATrustedServerIsAsked) {
    trustTheServer();
    const auto body = load();
    EXPECT_EQ(textOf(body), "body") << messageOf(body);
    EXPECT_TRUE(asked.startsWith("GET /alerts.pb HTTP/1.1\r\n"));
}

TEST_F(TLSTest, AnUntrustedServerIsToldNothing) {
    const auto body = load();
    EXPECT_EQ(codeOf(body), SourceErrorCode::Untrusted);
    EXPECT_EQ(messageOf(body).find(location + ": the server cannot be trusted: "), 0U)
        << messageOf(body);
    EXPECT_TRUE(asked.isEmpty());
}

TEST_F(TLSTest, ACertificateForAnotherNameIsNotTrusted) {
    trustTheServer();
    const auto body = load("localhost");
    EXPECT_EQ(codeOf(body), SourceErrorCode::Untrusted);
    EXPECT_NE(messageOf(body).find("host name"), std::string::npos) << messageOf(body);
    EXPECT_TRUE(asked.isEmpty());
}

TEST_F(TLSTest, ABodyCutShortIsAFailure) {
    trustTheServer();
    reply.chop(1);
    const auto body = load();
    EXPECT_EQ(messageOf(body), location + ": only 3 of 4 bytes came");
}

TEST_F(TLSTest, ARedirectToPlainHttpIsNotFollowed) {
    trustTheServer();
    reply = "HTTP/1.1 302 Found\r\nLocation: http://127.0.0.1/\r\n\r\n";
    const auto body = load();
    EXPECT_EQ(messageOf(body), location + ": redirected from https to http");
}

} // namespace
} // namespace orvo
