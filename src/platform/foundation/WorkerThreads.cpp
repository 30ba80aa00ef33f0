#include "platform/foundation/WorkerThreads.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <pthread.h>
#include <thread>

namespace orvo {

namespace {

constexpr std::chrono::seconds PatienceAtEnd{1};
constexpr std::size_t LongestThreadName = 15;

thread_local const BlockList* currentList = nullptr;
thread_local const std::string* nameOfThisThread = nullptr;

} // namespace

WorkerThreads& WorkerThreads::shared() {
    // Never destroyed: a thread that was left behind may still look at it.
    static auto& threads = *new WorkerThreads;
    return threads;
}

WorkerThreads::WorkerThreads() {
    std::atexit([] { shared().endAll(); });
}

void WorkerThreads::start(const std::shared_ptr<BlockList>& list, const std::string& name) {
    const std::lock_guard lock(_mutex);
    if (_ending)
        return;
    _lists.push_back(list);
    std::thread thread([this, list, name] { work(list, name); });
    pthread_setname_np(thread.native_handle(), name.substr(0, LongestThreadName).c_str());
    thread.detach();
}

bool WorkerThreads::runs(const BlockList& list) {
    return currentList == &list;
}

const std::string& WorkerThreads::currentName() {
    static const std::string none;
    return nameOfThisThread ? *nameOfThisThread : none;
}

void WorkerThreads::work(const std::shared_ptr<BlockList>& list, const std::string& name) {
    currentList = list.get();
    nameOfThisThread = &name;
    while (auto block = list->take())
        block();
    const std::lock_guard lock(_mutex);
    _lists.erase(std::ranges::find(_lists, list));
    _ended.notify_all();
}

void WorkerThreads::endAll() {
    std::unique_lock lock(_mutex);
    _ending = true;
    const auto lists = _lists;
    lock.unlock(); // what a dropped block held may submit another one as it goes
    for (const auto& list : lists)
        list->abandon();
    lock.lock();
    // A worker that itself ends the process does not wait for its own end.
    const std::size_t self = currentList ? 1 : 0;
    _ended.wait_for(lock, PatienceAtEnd, [&] { return _lists.size() <= self; });
}

} // namespace orvo
