#include "platform/feeds/schedule/CsvReader.h"

#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <fmt/format.h>
#include <utility>

namespace orvo {

namespace {

enum class FieldBytes { Text, WithZero, NotUtf8 };

FieldBytes look(std::string_view bytes) {
    const auto isPlain = [](char byte) {
        return byte > 0;
    };
    if (std::ranges::all_of(bytes, isPlain)) // nearly always
        return FieldBytes::Text;
    if (bytes.find('\0') != std::string_view::npos)
        return FieldBytes::WithZero;
    return Text::isValidUTF8(bytes) ? FieldBytes::Text : FieldBytes::NotUtf8;
}

bool isBlank(char character) {
    return character == ' ' || character == '\t';
}

} // namespace

CsvReader::CsvReader(ScheduleStream& stream, std::string file)
    : _decoder(stream, file)
    , _file(std::move(file)) {}

std::string_view CsvReader::field(std::size_t index) const noexcept {
    if (index >= _ends.size())
        return {};
    const std::size_t begin = index == 0 ? 0 : _ends[index - 1];
    return std::string_view(_row).substr(begin, _ends[index] - begin);
}

bool CsvReader::next(std::shared_ptr<NSError>& error) {
    while (readRow(error)) {
        if (error)
            return false;
        const bool isBlankRow = _ends.size() == 1 && _row.empty();
        if (!isBlankRow)
            return true;
    }
    return false;
}

/// Answers false at the end of the file.
bool CsvReader::readRow(std::shared_ptr<NSError>& error) {
    _row.clear();
    _ends.clear();
    _fieldIsQuoted = false;
    ++_rowNumber;
    State state = State::FieldStart;
    while (true) {
        if (_piece.empty() && !refill(error)) {
            if (error)
                return false;
            if (state == State::Quoted) {
                error = refusal("a quotation mark is never closed");
                return false;
            }
            if (state == State::FieldStart && _ends.empty())
                return false;
            endField(_fieldIsQuoted, error);
            return true;
        }
        if (_piece.empty())
            continue; // only the line feed that belongs to the row before
        if (consume(state, error) || error)
            return true;
        if (_row.size() > MaximumRowLength) {
            error = refusal("the row is longer than a row may be (1 MiB)");
            return true;
        }
    }
}

bool CsvReader::refill(std::shared_ptr<NSError>& error) {
    _piece = _decoder.next(error);
    if (_piece.empty())
        return false;
    if (std::exchange(_afterCarriageReturn, false) && _piece.front() == '\n')
        _piece.remove_prefix(1);
    return true;
}

/// Takes the next character, or run of plain ones. Answers true at the end of the row.
bool CsvReader::consume(State& state, std::shared_ptr<NSError>& error) {
    if (state == State::Quoted) {
        if (_piece.front() != '"') {
            appendRun(state);
            return false;
        }
        _piece.remove_prefix(1);
        state = State::QuoteSeen;
        return false;
    }
    const char character = _piece.front();
    switch (character) {
    case ',':
        _piece.remove_prefix(1);
        endField(_fieldIsQuoted, error);
        state = State::FieldStart;
        return false;
    case '\r':
    case '\n':
        _piece.remove_prefix(1);
        if (character == '\r') {
            if (_piece.empty())
                _afterCarriageReturn = true;
            else if (_piece.front() == '\n')
                _piece.remove_prefix(1);
        }
        endField(_fieldIsQuoted, error);
        return true;
    case '"':
        _piece.remove_prefix(1);
        if (state == State::FieldStart) {
            _fieldIsQuoted = true;
            state = State::Quoted;
            return false;
        }
        _row.push_back('"');
        state = state == State::QuoteSeen ? State::Quoted : State::Plain;
        return false;
    default:
        if (state == State::FieldStart && isBlank(character)) {
            _piece.remove_prefix(1);
            return false;
        }
        if (state == State::QuoteSeen && isBlank(character)) {
            _piece.remove_prefix(1);
            return false;
        }
        state = State::Plain;
        appendRun(state);
        return false;
    }
}

/// Takes everything up to the next character that may mean something.
void CsvReader::appendRun(State state) {
    const auto means = [state](char character) {
        return character == '"' || (state != State::Quoted &&
                                    (character == ',' || character == '\r' || character == '\n'));
    };
    const auto length =
        static_cast<std::size_t>(std::ranges::find_if(_piece, means) - _piece.begin());
    _row.append(_piece.substr(0, length));
    _piece.remove_prefix(length);
}

void CsvReader::endField(bool isQuoted, std::shared_ptr<NSError>& error) {
    const std::size_t begin = _ends.empty() ? 0 : _ends.back();
    if (!isQuoted)
        while (_row.size() > begin && isBlank(_row.back()))
            _row.pop_back();
    _ends.push_back(_row.size());
    _fieldIsQuoted = false;
    if (_ends.size() > MaximumFields) {
        error = refusal("the row has more fields than a row may have (4096)");
        return;
    }
    const auto found = look(std::string_view(_row).substr(begin));
    if (found == FieldBytes::WithZero)
        error = refusal("a byte is 0, which text has none of; UTF-16 needs its byte-order mark");
    else if (found == FieldBytes::NotUtf8)
        error = refusal("the text is not UTF-8");
}

std::shared_ptr<NSError> CsvReader::refusal(const char* reason) const {
    return scheduleError(ScheduleErrorCode::NotText,
                         fmt::format("{}, row {}: {}", _file, _rowNumber, reason));
}

} // namespace orvo
