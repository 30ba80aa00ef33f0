#include "platform/demo/server/DemoAlertServer.h"

#include "platform/demo/DemoAlertFeed.h"
#include "platform/foundation/RunLoop.h"
#include "support/TestClock.h"

#include <QTcpSocket>
#include <gtest/gtest.h>

namespace orvo {
namespace {

class DemoAlertServerTest : public ::testing::Test {
protected:
    void SetUp() override {
        (void)RunLoop::main();
        std::shared_ptr<NSError> error;
        server = DemoAlertServer::start(
            0,
            [this](const std::string& request, int status) {
                log.push_back(request + " " + std::to_string(status));
            },
            &error);
        ASSERT_NE(server, nullptr) << descriptionOf(error);
    }

    std::string ask(const std::string& request) const {
        QTcpSocket socket;
        socket.connectToHost("127.0.0.1", server->port());
        socket.write(QByteArray::fromStdString(request));
        QByteArray answer;
        RunLoop::main().runUntil(
            [&] {
                answer += socket.readAll();
                return socket.state() == QAbstractSocket::UnconnectedState;
            },
            10);
        return (answer + socket.readAll()).toStdString();
    }

    static std::string header(const std::string& answer, const std::string& name) {
        const auto at = answer.find(name + ": ");
        if (at == std::string::npos)
            return {};
        const auto begin = at + name.size() + 2;
        return answer.substr(begin, answer.find("\r\n", begin) - begin);
    }

    static std::string body(const std::string& answer) {
        return answer.substr(answer.find("\r\n\r\n") + 4);
    }

    testing::StoppedClock clock{1750000000};
    std::vector<std::string> log;
    std::unique_ptr<DemoAlertServer> server;
};

TEST_F(DemoAlertServerTest, AnswersWithWhatIsTrueAtTheMoment) {
    const auto answer = ask("GET /alerts.pb HTTP/1.1\r\nHost: x\r\n\r\n");
    EXPECT_EQ(answer.rfind("HTTP/1.1 200 OK\r\n", 0), 0U);
    EXPECT_EQ(body(answer),
              demoAlertFeed(DemoIncidents::live(1750000000, 1750000000), 1750000000)->stringView());
    EXPECT_EQ(header(answer, "Content-Length"), std::to_string(body(answer).size()));
    EXPECT_EQ(log, std::vector<std::string>{"GET /alerts.pb 200"});
}

TEST_F(DemoAlertServerTest, AnswersNotModifiedUntilAnIncidentChanges) {
    const auto first = ask("GET /alerts.pb HTTP/1.1\r\n\r\n");
    const std::string conditional =
        "GET /alerts.pb HTTP/1.1\r\nif-none-match:  " + header(first, "ETag") + " \r\n\r\n";
    clock->advance(10);
    const auto second = ask(conditional);
    EXPECT_EQ(second.rfind("HTTP/1.1 304 ", 0), 0U);
    EXPECT_EQ(body(second), "");
    clock->advance(25);
    const auto third = ask(conditional);
    EXPECT_EQ(third.rfind("HTTP/1.1 200 ", 0), 0U);
    EXPECT_NE(header(third, "ETag"), header(first, "ETag"));
}

TEST_F(DemoAlertServerTest, AHeadRequestGetsNoBody) {
    const auto answer = ask("HEAD /alerts.pb HTTP/1.0\r\n\r\n");
    EXPECT_EQ(answer.rfind("HTTP/1.1 200 OK\r\n", 0), 0U);
    EXPECT_EQ(body(answer), "");
}

TEST_F(DemoAlertServerTest, RefusesWhatItDoesNotServe) {
    EXPECT_EQ(ask("GET /other HTTP/1.1\r\n\r\n").substr(9, 3), "404");
    EXPECT_EQ(ask("POST /alerts.pb HTTP/1.1\r\n\r\n").substr(9, 3), "405");
    EXPECT_EQ(ask("hello\r\n\r\n").substr(9, 3), "400");
    EXPECT_EQ(ask(std::string(20000, 'x')).substr(9, 3), "400");
}

TEST_F(DemoAlertServerTest, ATakenPortIsAnErrorThatNamesIt) {
    std::shared_ptr<NSError> error;
    EXPECT_EQ(DemoAlertServer::start(server->port(), {}, &error), nullptr);
    ASSERT_NE(error, nullptr);
    EXPECT_NE(error->localizedDescription().find(std::to_string(server->port())),
              std::string::npos);
}

TEST(DemoAlertFeed, IsTheSameForTheSameContent) {
    const auto incidents = DemoIncidents::around(1750000000);
    EXPECT_TRUE(equal(demoAlertFeed(incidents, 1), demoAlertFeed(incidents, 1)));
    EXPECT_FALSE(equal(demoAlertFeed(incidents, 1), demoAlertFeed(incidents, 2)));
}

} // namespace
} // namespace orvo
