#include "platform/foundation/LogWriter.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/ISO8601.h"
#include "platform/foundation/LogSettings.h"
#include "platform/foundation/NSDate.h"

#include <array>
#include <cstdlib>
#include <fmt/format.h>
#include <sys/stat.h>
#include <sys/uio.h>
#include <syslog.h>
#include <unistd.h>

#define SD_JOURNAL_SUPPRESS_LOCATION // the place would be this file for every line
#include <systemd/sd-journal.h>

namespace orvo::LogWriter {

namespace {

int priorityOf(LogLevel level) {
    constexpr std::array priorities = {LOG_DEBUG, LOG_INFO, LOG_NOTICE, LOG_ERR, LOG_CRIT};
    return priorities.at(static_cast<std::size_t>(level));
}

void writeToStandardError(const std::string& line) {
    // One call, so that lines of several threads do not mix; where it fails there is nobody to
    // tell.
    [[maybe_unused]] const auto written = write(STDERR_FILENO, line.data(), line.size());
}

void writeToJournal(const LogRecord& record, const std::string& text) {
    std::array fields = {"MESSAGE=" + text,
                         fmt::format("PRIORITY={}", priorityOf(record.level)),
                         "ORVO_SUBSYSTEM=" + record.subsystem,
                         "ORVO_CATEGORY=" + record.category};
    std::array<iovec, fields.size()> parts{};
    for (std::size_t i = 0; i < fields.size(); ++i)
        parts.at(i) = {fields.at(i).data(), fields.at(i).size()};
    sd_journal_sendv(parts.data(), static_cast<int>(parts.size()));
}

} // namespace

std::string line(const LogRecord& record, const std::string& text, double secondsSince1970) {
    auto line = fmt::format("{} {} {} {}: ",
                            ISO8601::string(secondsSince1970),
                            record.subsystem,
                            record.category,
                            nameOf(record.level));
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (c == '\n')
            line += "\\n";
        else if (byte < 0x20 || byte == 0x7f)
            line += fmt::format("\\x{:02x}", byte);
        else
            line += c;
    }
    return line + "\n";
}

bool isConnectedTo(const char* stream, int fileDescriptor) {
    struct stat file {};
    if (!stream || fstat(fileDescriptor, &file) != 0)
        return false;
    return fmt::format("{}:{}", file.st_dev, file.st_ino) == stream;
}

LogSink standard() {
    const char* const asked = std::getenv("ORVO_LOG");
    const bool journal =
        !asked || !*asked || isConnectedTo(std::getenv("JOURNAL_STREAM"), STDERR_FILENO);
    const bool showsPrivate = LogSettings::ofProcess().showsPrivate;
    return [=](const LogRecord& record) {
        const auto& text = showsPrivate ? record.message : record.redacted;
        if (journal)
            writeToJournal(record, text);
        else
            writeToStandardError(line(record, text, NSDate::date()->timeIntervalSince1970()));
    };
}

} // namespace orvo::LogWriter
