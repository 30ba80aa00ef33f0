#pragma once

#include "platform/feeds/http/HttpTransport.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// Reads the answer to one GET request as it comes off a connection, in pieces of any size. It
/// tells a body that came whole from one that was cut: by Content-Length, or by the last chunk.
/// Where the server gives neither, the connection's end is the body's, and the answer says that
/// nobody told so (`isEndTold`): a server that breaks off looks just the same. One thread at a
/// time.
class HttpResponseParser {
public:
    /// Of status line and headers, and of the trailers behind chunks.
    static constexpr std::size_t LongestHead = 65536;

    /// More than `maximumBytes` of body are a failure.
    explicit HttpResponseParser(std::uint64_t maximumBytes);

    /// What comes after the end, or after a failure, is passed over.
    void feed(std::span<const std::uint8_t> bytes);
    /// The connection has ended.
    void endOfConnection();

    /// Whether nothing more is wanted: all is there, or it has failed. The body of an answer that
    /// is no success is not waited for.
    [[nodiscard]] bool isComplete() const noexcept { return _state == State::Complete; }
    /// Body bytes so far.
    [[nodiscard]] std::uint64_t bodyLength() const noexcept { return _body.size(); }
    /// By Content-Length; nothing where it is not told.
    [[nodiscard]] std::optional<std::uint64_t> announcedLength() const noexcept { return _length; }
    /// What came; the body leaves the parser. For when it is complete.
    [[nodiscard]] HttpAnswer takeAnswer();

private:
    enum class State { Head, Body, BodyToEnd, ChunkSize, Chunk, ChunkEnd, Trailers, Complete };

    [[nodiscard]] std::size_t feedSome(std::span<const std::uint8_t> bytes);
    [[nodiscard]] std::size_t takeLine(std::span<const std::uint8_t> bytes);
    [[nodiscard]] std::size_t takeBody(std::span<const std::uint8_t> bytes);
    void lineCame(std::string_view line);
    void headLineCame(std::string_view line);
    [[nodiscard]] bool readStatusLine(std::string_view line);
    [[nodiscard]] bool readHeader(std::string_view line);
    void headEnded();
    [[nodiscard]] bool readLength();
    void chunkSizeCame(std::string_view line);
    void fail(HttpAnswer::Failure failure, std::string reason);
    void failTooLarge();

    const std::uint64_t _maximumBytes;
    State _state = State::Head;
    std::string _line;         // the one that is coming
    std::size_t _headSize = 0; // of lines so far
    std::optional<std::uint64_t> _length;
    std::uint64_t _missing = 0; // of the body, or of the chunk
    std::vector<std::uint8_t> _body;
    HttpAnswer _answer;
};

} // namespace orvo
