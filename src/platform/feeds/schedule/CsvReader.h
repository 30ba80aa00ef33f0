#pragma once

#include "platform/feeds/schedule/TextDecoder.h"

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// Reads comma-separated rows one by one, in bounded memory.
///
/// Rows end with CR, LF or CRLF, the last one also with the file. Blanks around a field are no part
/// of it; inside quotes everything is, and a quote stands twice. Text after a closing quote is
/// taken as it stands. Blank rows are passed over, but counted in the row number. Every field is
/// valid UTF-8 without zero bytes.
class CsvReader {
public:
    static constexpr std::size_t MaximumRowLength = std::size_t{1} << 20; ///< bytes
    static constexpr std::size_t MaximumFields = 4096;

    /// `file` stands in messages. The stream must outlive the reader.
    CsvReader(ScheduleStream& stream, std::string file);

    /// Goes to the next row.
    /// @return false at the end, and on failure, which sets `error`: the stream's own, text that is
    /// not UTF-8, a quote that is never closed, a row beyond the limits
    [[nodiscard]] bool next(std::shared_ptr<NSError>& error);

    /// How many fields the row has; at least one.
    [[nodiscard]] std::size_t fieldCount() const noexcept { return _ends.size(); }
    /// Valid until the next row; empty beyond the last field.
    [[nodiscard]] std::string_view field(std::size_t index) const noexcept;
    /// Of the row just read, the first is 1. A row that holds line breaks counts once.
    [[nodiscard]] std::uint64_t rowNumber() const noexcept { return _rowNumber; }
    [[nodiscard]] const std::string& file() const noexcept { return _file; }

private:
    enum class State { FieldStart, Plain, Quoted, QuoteSeen };

    bool readRow(std::shared_ptr<NSError>& error);
    bool refill(std::shared_ptr<NSError>& error);
    bool consume(State& state, std::shared_ptr<NSError>& error);
    void appendRun(State state);
    void endField(bool isQuoted, std::shared_ptr<NSError>& error);
    std::shared_ptr<NSError> refusal(const char* reason) const;

    TextDecoder _decoder;
    std::string _file;
    std::string_view _piece;
    std::string _row;               // the fields of the row, one after the other
    std::vector<std::size_t> _ends; // where each field ends in _row
    std::uint64_t _rowNumber = 0;
    bool _fieldIsQuoted = false;
    bool _afterCarriageReturn = false;
};

} // namespace orvo
