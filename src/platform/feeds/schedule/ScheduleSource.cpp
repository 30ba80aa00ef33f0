#include "platform/feeds/schedule/ScheduleSource.h"

#include <utility>

namespace orvo {

ScheduleSource ScheduleSource::fromPath(std::filesystem::path path) {
    ScheduleSource source;
    source._name = path.string();
    source._path = std::move(path);
    return source;
}

ScheduleSource ScheduleSource::fromBytes(std::shared_ptr<NSData> bytes, std::string name) {
    ScheduleSource source;
    source._bytes = std::move(bytes);
    source._name = std::move(name);
    return source;
}

} // namespace orvo
