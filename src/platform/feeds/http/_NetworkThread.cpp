#include "platform/feeds/http/_NetworkThread.h"

#include <QEventLoop>
#include <QSocketNotifier>

#include <cstdlib>
#include <pthread.h>
#include <vector>

namespace orvo {

namespace {

/// A thread that still uses the toolkit while its libraries are taken down would crash, so all end
/// before.
class ThreadsAtExit {
public:
    static ThreadsAtExit& shared() {
        static auto& threads = *new ThreadsAtExit; // never destroyed: asked until the very end
        return threads;
    }

    void add(const std::shared_ptr<_NetworkThread>& thread) {
        const std::lock_guard lock(_mutex);
        std::erase_if(_threads, [](const auto& other) { return other.expired(); });
        _threads.push_back(thread);
    }

private:
    ThreadsAtExit() {
        std::atexit([] { shared().endAll(); });
    }
    void endAll() {
        std::vector<std::weak_ptr<_NetworkThread>> threads;
        {
            const std::lock_guard lock(_mutex);
            threads = _threads;
        }
        for (const auto& weak : threads)
            if (const auto thread = weak.lock())
                thread->end();
    }

    std::mutex _mutex;
    std::vector<std::weak_ptr<_NetworkThread>> _threads;
};

} // namespace

_NetworkThread::_NetworkThread(Block last)
    : _last(std::move(last)) {}

void _NetworkThread::async(Block block) {
    const std::lock_guard lock(_mutex);
    if (_isEnding)
        return;
    _blocks.push_back(std::move(block));
    if (_thread.joinable()) {
        _signal.raise();
        return;
    }
    _signal.raise();
    ThreadsAtExit::shared().add(shared_from_this());
    _thread = std::thread([self = shared_from_this()] { self->run(); });
    pthread_setname_np(_thread.native_handle(), "network");
}

void _NetworkThread::end() {
    std::thread thread;
    std::deque<Block> dropped; // what they hold goes outside the lock
    {
        const std::lock_guard lock(_mutex);
        _isEnding = true;
        std::swap(thread, _thread);
        std::swap(dropped, _blocks);
        _signal.raise();
    }
    if (!thread.joinable())
        return;
    if (thread.get_id() == std::this_thread::get_id())
        thread.detach();
    else
        thread.join();
}

void _NetworkThread::run() {
    QEventLoop loop;
    QSocketNotifier notifier(_signal.fileDescriptor(), QSocketNotifier::Read);
    QObject::connect(&notifier, &QSocketNotifier::activated, &loop, [&] {
        if (!runBlocks())
            loop.quit();
    });
    loop.exec();
    _last();
}

bool _NetworkThread::runBlocks() {
    while (true) {
        Block block;
        {
            const std::lock_guard lock(_mutex);
            if (_isEnding)
                return false;
            if (_blocks.empty()) {
                _signal.lower();
                return true;
            }
            block = std::move(_blocks.front());
            _blocks.pop_front();
        }
        block();
    }
}

} // namespace orvo
