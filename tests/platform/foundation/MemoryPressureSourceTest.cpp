#include "platform/foundation/MemoryPressureSource.h"

#include "platform/foundation/MemoryPressureFile.h"
#include "platform/foundation/RunLoop.h"

#include <gtest/gtest.h>

#include <memory>
#include <netinet/in.h>
#include <stdexcept>
#include <sys/socket.h>
#include <unistd.h>
#include <vector>

namespace orvo::MemoryPressureSourceTests {
namespace {

constexpr NSTimeInterval Patience = 30; // seconds; only a failure waits so long

/// Two ends of a connection; an urgent byte makes the other end ready as the kernel's files are.
class Connection {
public:
    Connection() {
        const int listener = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        auto* plain = reinterpret_cast<sockaddr*>(&address);
        if (::bind(listener, plain, size) != 0 || ::listen(listener, 1) != 0 ||
            ::getsockname(listener, plain, &size) != 0)
            throw std::runtime_error("cannot listen");
        sender = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        if (::connect(sender, plain, size) != 0)
            throw std::runtime_error("cannot connect");
        receiver = ::accept(listener, nullptr, nullptr);
        ::close(listener);
    }
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;
    ~Connection() {
        ::close(sender);
        ::close(receiver);
    }
    void sendUrgentByte() const { ASSERT_EQ(::send(sender, "!", 1, MSG_OOB), 1); }

    int sender = -1;
    int receiver = -1;
};

class FakeFile final : public MemoryPressureFile {
public:
    FakeFile(int fd, const bool& concerned)
        : _fd(fd)
        , _concerned(concerned) {}
    int fileDescriptor() const noexcept override { return _fd; }
    bool hasHappened() override {
        char byte = 0;
        return ::recv(_fd, &byte, 1, MSG_OOB) == 1 && _concerned;
    }

private:
    int _fd;
    const bool& _concerned;
};

/// Blocks wait until the test runs them.
class HeldQueue final : public DispatchQueue {
public:
    void async(Block block) override { blocks.push_back(std::move(block)); }
    bool isCurrent() const override { return false; }
    std::vector<Block> blocks;
};

class MemoryPressureSourceTest : public ::testing::Test {
protected:
    std::shared_ptr<MemoryPressureSource> source() {
        auto made = std::make_shared<MemoryPressureSource>(MemoryPressure::Critical, queue);
        made->setEventHandler([this] { ++events; });
        return made;
    }

    Connection connection;
    bool concerned = true;
    std::shared_ptr<HeldQueue> queue = std::make_shared<HeldQueue>();
    int events = 0;
    std::vector<MemoryPressure> opened;

private:
    EnvironmentSlot<MemoryPressureFile::Opener>::Override _opener =
        MemoryPressureFile::opener().overrideWith([this](MemoryPressure degree) {
            opened.push_back(degree);
            return std::make_unique<FakeFile>(connection.receiver, concerned);
        });
};

TEST_F(MemoryPressureSourceTest, CallsItsHandlerOnItsQueueEachTime) {
    const auto made = source();
    made->activate();
    EXPECT_EQ(opened, std::vector{MemoryPressure::Critical});
    for (std::size_t times = 1; times <= 2; ++times) {
        connection.sendUrgentByte();
        ASSERT_TRUE(
            RunLoop::main().runUntil([&] { return queue->blocks.size() == times; }, Patience));
        EXPECT_EQ(events, static_cast<int>(times) - 1);
        queue->blocks.back()();
        EXPECT_EQ(events, static_cast<int>(times));
    }
}

TEST_F(MemoryPressureSourceTest, OpensNothingBeforeItIsActivated) {
    const auto made = source();
    EXPECT_TRUE(opened.empty());
    made->activate();
    made->activate();
    EXPECT_EQ(opened.size(), 1U);
}

TEST_F(MemoryPressureSourceTest, SaysNothingWhenItCancels) {
    const auto made = source();
    made->activate();
    made->cancel();
    made->cancel();
    connection.sendUrgentByte();
    RunLoop::main().runOnce();
    EXPECT_TRUE(queue->blocks.empty());
}

TEST_F(MemoryPressureSourceTest, SaysNothingOfWhatIsNotItsDegree) {
    concerned = false;
    const auto made = source();
    made->activate();
    connection.sendUrgentByte();
    RunLoop::main().runOnce();
    EXPECT_TRUE(queue->blocks.empty());
}

TEST_F(MemoryPressureSourceTest, IsSilentWhereTheKernelTellsNothing) {
    const auto scope = MemoryPressureFile::opener().overrideWith(
        [](MemoryPressure) { return std::unique_ptr<MemoryPressureFile>(); });
    const auto made = source();
    made->activate();
    connection.sendUrgentByte();
    RunLoop::main().runOnce();
    EXPECT_TRUE(queue->blocks.empty());
    made->cancel();
}

TEST_F(MemoryPressureSourceTest, IsWhatADispatchSourceForMemoryPressureIs) {
    EXPECT_TRUE(std::dynamic_pointer_cast<MemoryPressureSource>(
        DispatchSource::memoryPressureSource(MemoryPressure::Warning, queue)));
}

} // namespace
} // namespace orvo::MemoryPressureSourceTests
