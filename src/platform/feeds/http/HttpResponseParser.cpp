#include "platform/feeds/http/HttpResponseParser.h"

#include "platform/feeds/http/AsciiText.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr std::string_view Blanks = " \t";

std::string_view trimmed(std::string_view text) {
    const auto start = text.find_first_not_of(Blanks);
    if (start == std::string_view::npos)
        return {};
    return text.substr(start, text.find_last_not_of(Blanks) - start + 1);
}

std::optional<std::uint64_t> number(std::string_view text, int base) {
    std::uint64_t value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, base);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return value;
}

} // namespace

HttpResponseParser::HttpResponseParser(std::uint64_t maximumBytes)
    : _maximumBytes(maximumBytes) {}

void HttpResponseParser::feed(std::span<const std::uint8_t> bytes) {
    while (!bytes.empty() && !isComplete())
        bytes = bytes.subspan(feedSome(bytes));
}

std::size_t HttpResponseParser::feedSome(std::span<const std::uint8_t> bytes) {
    switch (_state) {
    case State::Head:
    case State::ChunkSize:
    case State::ChunkEnd:
    case State::Trailers:
        return takeLine(bytes);
    case State::Body:
    case State::BodyToEnd:
    case State::Chunk:
        return takeBody(bytes);
    case State::Complete:
        break;
    }
    return bytes.size();
}

std::size_t HttpResponseParser::takeLine(std::span<const std::uint8_t> bytes) {
    const auto end = std::ranges::find(bytes, static_cast<std::uint8_t>('\n'));
    const bool isWhole = end != bytes.end();
    _line.append(bytes.begin(), end);
    const auto taken = static_cast<std::size_t>(end - bytes.begin()) + (isWhole ? 1 : 0);
    _headSize += taken;
    if (_headSize > LongestHead) {
        fail(HttpAnswer::Failure::Incomplete, "the answer's headers have no end");
    } else if (isWhole) {
        auto line = std::exchange(_line, {});
        if (line.ends_with('\r'))
            line.pop_back();
        lineCame(line);
    }
    return taken;
}

std::size_t HttpResponseParser::takeBody(std::span<const std::uint8_t> bytes) {
    if (_state != State::BodyToEnd)
        bytes = bytes.first(std::min<std::uint64_t>(bytes.size(), _missing));
    if (bytes.size() > _maximumBytes - _body.size()) {
        failTooLarge();
        return bytes.size();
    }
    _body.insert(_body.end(), bytes.begin(), bytes.end());
    if (_state == State::BodyToEnd)
        return bytes.size();
    _missing -= bytes.size();
    if (_missing == 0)
        _state = _state == State::Chunk ? State::ChunkEnd : State::Complete;
    return bytes.size();
}

void HttpResponseParser::lineCame(std::string_view line) {
    switch (_state) {
    case State::Head:
        headLineCame(line);
        break;
    case State::ChunkSize:
        chunkSizeCame(line);
        break;
    case State::ChunkEnd:
        if (line.empty())
            _state = State::ChunkSize;
        else
            fail(HttpAnswer::Failure::Incomplete, "the body's chunks do not fit together");
        break;
    case State::Trailers:
        if (line.empty())
            _state = State::Complete;
        break;
    case State::Body:
    case State::BodyToEnd:
    case State::Chunk:
    case State::Complete:
        break;
    }
}

void HttpResponseParser::headLineCame(std::string_view line) {
    const bool isStatusLine = _answer.status == 0;
    if (!isStatusLine && line.empty())
        headEnded();
    else if (!(isStatusLine ? readStatusLine(line) : readHeader(line)))
        fail(HttpAnswer::Failure::Unreachable, "what answers there is no web server");
}

bool HttpResponseParser::readStatusLine(std::string_view line) {
    // `HTTP/1.1 200 OK`, the words at the end left out by some.
    constexpr std::size_t StatusAt = 9;
    if (!line.starts_with("HTTP/1.") || line.size() < StatusAt + 3 || line[StatusAt - 1] != ' ' ||
        (line.size() > StatusAt + 3 && line[StatusAt + 3] != ' '))
        return false;
    const auto status = number(line.substr(StatusAt, 3), 10);
    _answer.status = static_cast<int>(status.value_or(0));
    return _answer.status >= 100;
}

bool HttpResponseParser::readHeader(std::string_view line) {
    if (Blanks.find(line.front()) != std::string_view::npos) {
        // An old way to go on with the header before.
        if (_answer.headers.empty())
            return false;
        _answer.headers.back().second += " " + std::string(trimmed(line));
        return true;
    }
    const auto colon = line.find(':');
    if (colon == std::string_view::npos || colon == 0)
        return false;
    _answer.headers.emplace_back(asciiLowercased(trimmed(line.substr(0, colon))),
                                 trimmed(line.substr(colon + 1)));
    return true;
}

void HttpResponseParser::headEnded() {
    if (_answer.status < 200) { // "I am still at it": the answer itself comes behind
        _answer = {};
        return;
    }
    const auto coding = asciiLowercased(_answer.header("transfer-encoding"));
    if (_answer.status >= 300 || _answer.status == 204) {
        _state = State::Complete;
    } else if (!coding.empty()) {
        if (coding == "chunked")
            _state = State::ChunkSize;
        else
            fail(HttpAnswer::Failure::Incomplete, "the body came in a form that was not asked for");
    } else if (!readLength()) {
        fail(HttpAnswer::Failure::Incomplete, "the body's length is told in two ways");
    } else if (!_length) {
        _state = State::BodyToEnd;
    } else if (*_length > _maximumBytes) {
        failTooLarge();
    } else {
        _missing = *_length;
        _state = _missing == 0 ? State::Complete : State::Body;
    }
}

bool HttpResponseParser::readLength() {
    for (const auto& [name, value] : _answer.headers) {
        if (name != "content-length")
            continue;
        const auto length = number(value, 10);
        if (!length || (_length && *_length != *length))
            return false;
        _length = length;
    }
    return true;
}

void HttpResponseParser::chunkSizeCame(std::string_view line) {
    const auto size = number(trimmed(line.substr(0, line.find(';'))), 16);
    _headSize = 0;
    if (!size) {
        fail(HttpAnswer::Failure::Incomplete, "the body's chunks do not fit together");
        return;
    }
    _missing = *size;
    _state = *size == 0 ? State::Trailers : State::Chunk;
}

void HttpResponseParser::endOfConnection() {
    switch (_state) {
    case State::Complete:
        break;
    case State::BodyToEnd:
        _answer.isEndTold = false;
        _state = State::Complete;
        break;
    case State::Head:
        fail(HttpAnswer::Failure::Unreachable, "the server hung up before it answered");
        break;
    case State::Body:
        fail(HttpAnswer::Failure::Incomplete,
             fmt::format("only {} of {} bytes came", _body.size(), *_length));
        break;
    case State::ChunkSize:
    case State::Chunk:
    case State::ChunkEnd:
    case State::Trailers:
        fail(HttpAnswer::Failure::Incomplete, "the body did not come whole");
        break;
    }
}

HttpAnswer HttpResponseParser::takeAnswer() {
    auto answer = std::move(_answer);
    if (answer.failure == HttpAnswer::Failure::None) {
        _body.shrink_to_fit();
        answer.body = NSData::dataWithVector(std::move(_body));
    }
    return answer;
}

void HttpResponseParser::fail(HttpAnswer::Failure failure, std::string reason) {
    _state = State::Complete;
    _answer.failure = failure;
    _answer.reason = std::move(reason);
}

void HttpResponseParser::failTooLarge() {
    fail(HttpAnswer::Failure::TooLarge, fmt::format("larger than {} bytes", _maximumBytes));
}

} // namespace orvo
