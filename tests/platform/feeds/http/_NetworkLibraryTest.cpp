#include "platform/feeds/http/_NetworkLibrary.h"

#include "platform/feeds/http/HttpTransport.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"

#include <gtest/gtest.h>

#include <future>

namespace orvo {
namespace {

std::string reasonWith(const std::filesystem::path& file) {
    const auto library = _NetworkLibrary::file().overrideWith(file);
    std::string reason;
    EXPECT_EQ(_NetworkLibrary::connectionTo("http://127.0.0.1/", {}, reason), nullptr);
    return reason;
}

TEST(_NetworkLibraryTest, SaysWhichLibraryIsMissing) {
    const auto reason = reasonWith("/nowhere/OrvoSockets.so");
    EXPECT_TRUE(reason.starts_with("the network's library cannot be used: ")) << reason;
    EXPECT_NE(reason.find("/nowhere/OrvoSockets.so"), std::string::npos) << reason;
}

TEST(_NetworkLibraryTest, SaysWhichFunctionIsMissing) {
    const auto reason = reasonWith("libc.so.6");
    EXPECT_NE(reason.find("OrvoMakeNetworkConnection"), std::string::npos) << reason;
}

TEST(_NetworkLibraryTest, WithoutItAServerIsUnreachable) {
    (void)RunLoop::main();
    const auto library = _NetworkLibrary::file().overrideWith("/nowhere/OrvoSockets.so");
    const auto transport = HttpTransport::network();
    std::promise<HttpAnswer> ended;
    HttpExchange exchange;
    exchange.url = "http://127.0.0.1:9/";
    exchange.idleTimeout = exchange.deadline = Environment::monotonicClock().get()->seconds() + 60;
    transport->start(exchange, [&ended](HttpAnswer answer) { ended.set_value(std::move(answer)); });
    const auto answer = ended.get_future().get();
    EXPECT_EQ(answer.failure, HttpAnswer::Failure::Unreachable);
    EXPECT_NE(answer.reason.find("/nowhere/OrvoSockets.so"), std::string::npos) << answer.reason;
}

} // namespace
} // namespace orvo
