#include "platform/foundation/LoopPort.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <QPointer>
#include <QSocketNotifier>
#include <QThread>
#include <QTimer>

#include <algorithm>
#include <array>
#include <cmath>
#include <string>
#include <vector>

namespace orvo {

namespace {

constexpr double LongestTimerSeconds = 1e6;

void makeApplication() {
    static int argc = 1;
    static std::string name = "orvo";
    static std::array<char*, 2> words = {name.data(), nullptr};
    // Never destroyed: it would go after what it stands on.
    new QCoreApplication(argc, words.data());
}

class ApplicationLoopPort final : public LoopPort {
public:
    void watch(int fileDescriptor, std::function<void()> ready) override {
        attach();
        _watches.push_back({fileDescriptor, std::move(ready)});
        listen(_watches.back());
    }

    void turn(std::optional<double> longestWait) override {
        attach();
        if (longestWait && *longestWait <= 0) {
            QCoreApplication::processEvents();
        } else {
            QTimer alarm;
            if (longestWait) {
                alarm.setTimerType(Qt::PreciseTimer);
                alarm.start(static_cast<int>(
                    std::ceil(std::min(*longestWait, LongestTimerSeconds) * 1000)));
            }
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        }
        // Outside `exec` the toolkit never does this by itself.
        if (QThread::currentThread()->loopLevel() == 0)
            QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    int run() override {
        attach();
        // The outermost is the application's own, so that quitting and its signals work.
        if (QThread::currentThread()->loopLevel() == 0)
            return QCoreApplication::exec();
        QEventLoop loop;
        _innerLoops.push_back(&loop);
        const int exitCode = loop.exec();
        _innerLoops.pop_back();
        return exitCode;
    }

    bool leave(int exitCode) override {
        if (QThread::currentThread()->loopLevel() == 0)
            return false;
        if (_innerLoops.empty())
            QCoreApplication::exit(exitCode);
        else
            _innerLoops.back()->exit(exitCode);
        return true;
    }

private:
    struct Watch {
        int fileDescriptor;
        std::function<void()> ready;
    };

    /// A program may destroy its application object and make another one.
    void attach() {
        if (_application)
            return;
        if (!QCoreApplication::instance())
            makeApplication();
        _application = QCoreApplication::instance();
        for (const auto& watch : _watches)
            listen(watch);
    }

    void listen(const Watch& watch) {
        auto* notifier = new QSocketNotifier(
            watch.fileDescriptor, QSocketNotifier::Read, _application); // it goes with it
        QObject::connect(notifier, &QSocketNotifier::activated, notifier, watch.ready);
    }

    std::vector<Watch> _watches;
    QPointer<QCoreApplication> _application;
    std::vector<QEventLoop*> _innerLoops;
};

} // namespace

std::unique_ptr<LoopPort> LoopPort::application() {
    return std::make_unique<ApplicationLoopPort>();
}

} // namespace orvo
