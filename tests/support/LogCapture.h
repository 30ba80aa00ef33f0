#pragma once

#include "platform/foundation/Log.h"

#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace orvo::testing {

/// Collects every log line of every level for the scope of a test, in place of writing them.
class LogCapture {
public:
    LogCapture()
        : _lines(std::make_shared<Lines>())
        , _levels(Log::levels().overrideWith({{"*", LogLevel::Debug}}))
        , _sink(Log::sink().overrideWith([lines = _lines](const LogRecord& record) {
            const std::lock_guard lock(lines->mutex);
            lines->records.push_back(record);
        })) {}

    std::vector<LogRecord> records() const {
        const std::lock_guard lock(_lines->mutex);
        return _lines->records;
    }
    /// The lines with every value, in order.
    std::vector<std::string> messages() const {
        std::vector<std::string> messages;
        for (const auto& record : records())
            messages.push_back(record.message);
        return messages;
    }
    std::vector<std::string> formats() const {
        std::vector<std::string> formats;
        for (const auto& record : records())
            formats.push_back(record.format);
        return formats;
    }

private:
    struct Lines {
        std::mutex mutex;
        std::vector<LogRecord> records;
    };
    std::shared_ptr<Lines> _lines;
    EnvironmentSlot<std::vector<std::pair<std::string, LogLevel>>>::Override _levels;
    EnvironmentSlot<LogSink>::Override _sink;
};

} // namespace orvo::testing
