#include "platform/foundation/MemoryPressureSource.h"

#include "platform/foundation/MemoryPressureFile.h"
#include "platform/foundation/RunLoop.h"

#include <QSocketNotifier>

#include <utility>

namespace orvo {

struct MemoryPressureSource::Private {
    MemoryPressure mask;
    std::shared_ptr<DispatchQueue> queue;
    DispatchQueue::Block handler;
    std::unique_ptr<MemoryPressureFile> file;
    std::unique_ptr<QSocketNotifier> notifier; // goes before the file that it watches
};

MemoryPressureSource::MemoryPressureSource(MemoryPressure mask,
                                           std::shared_ptr<DispatchQueue> queue)
    : _private(std::make_unique<Private>()) {
    _private->mask = mask;
    _private->queue = std::move(queue);
}

MemoryPressureSource::~MemoryPressureSource() = default;

void MemoryPressureSource::setEventHandler(DispatchQueue::Block handler) {
    _private->handler = std::move(handler);
}

void MemoryPressureSource::activate() {
    if (_private->notifier)
        return;
    (void)RunLoop::main(); // makes what notifiers need
    _private->file = MemoryPressureFile::open(_private->mask);
    if (!_private->file)
        return;
    _private->notifier = std::make_unique<QSocketNotifier>(_private->file->fileDescriptor(),
                                                           QSocketNotifier::Exception);
    QObject::connect(
        _private->notifier.get(), &QSocketNotifier::activated, [self = _private.get()] {
            if (self->file->hasHappened() && self->handler)
                self->queue->async(self->handler);
        });
}

void MemoryPressureSource::cancel() {
    _private->notifier.reset();
    _private->file.reset();
}

} // namespace orvo
