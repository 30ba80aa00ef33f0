#pragma once

#include "platform/foundation/Log.h"

#include <string>

namespace orvo::LogWriter {

/// One line, ending in a line feed, for people at a terminal:
/// `2024-07-24T01:28:40Z com.zentu.Orvo TransitWidget debug: Received 3 line items.` Control
/// characters of the text are escaped, so that a line stays one line whatever it quotes.
[[nodiscard]] std::string
line(const LogRecord& record, const std::string& text, double secondsSince1970);

/// Whether `stream` ("DEVICE:INODE", what `JOURNAL_STREAM` holds; may be nil) names the file that
/// `fileDescriptor` is connected to.
[[nodiscard]] bool isConnectedTo(const char* stream, int fileDescriptor);

/// To standard error where `ORVO_LOG` asks for a log and standard error does not go to the journal
/// anyhow, else to the journal: what a program has to say to the person in front of it is no log.
[[nodiscard]] LogSink standard();

} // namespace orvo::LogWriter
