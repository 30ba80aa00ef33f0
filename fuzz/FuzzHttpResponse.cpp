#include "platform/feeds/http/HttpResponseParser.h"

#include <algorithm>
#include <cstdlib>
#include <vector>

namespace {

using namespace orvo;

constexpr std::uint64_t MostBytes = 4096;

/// The answer to bytes that come in pieces of `step`, each in a heap block of its size, and after
/// which the connection ends.
HttpAnswer answerTo(std::span<const std::uint8_t> bytes, std::size_t step) {
    HttpResponseParser parser(MostBytes);
    while (!bytes.empty()) {
        const auto piece = bytes.first(std::min(step, bytes.size()));
        parser.feed(std::vector<std::uint8_t>(piece.begin(), piece.end()));
        bytes = bytes.subspan(piece.size());
        if (parser.bodyLength() > MostBytes)
            std::abort();
    }
    parser.endOfConnection();
    if (!parser.isComplete())
        std::abort();
    return parser.takeAnswer();
}

/// Whether the answer is a failure with a reason, or has a status and a body whose end is told
/// truly.
bool isSound(const HttpAnswer& answer) {
    if (answer.failure != HttpAnswer::Failure::None)
        return !answer.reason.empty() && !answer.body;
    const auto length = answer.header("content-length");
    const bool isSuccess = answer.status >= 200 && answer.status < 300 && answer.status != 204;
    const bool tellsEnd = !length.empty() || !answer.header("transfer-encoding").empty();
    return answer.status >= 200 && answer.body && answer.body->length() <= MostBytes &&
           (!isSuccess || answer.isEndTold == tellsEnd);
}

bool isSame(const HttpAnswer& a, const HttpAnswer& b) {
    return a.failure == b.failure && a.reason == b.reason && a.status == b.status &&
           a.headers == b.headers && a.isEndTold == b.isEndTold && equal(a.body, b.body);
}

} // namespace

/// Whatever the bytes, they are read to an end, alike in pieces of any size, and nobody is told
/// that a body came whole whose end the server did not tell.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::span bytes(data, size);
    const HttpAnswer whole = answerTo(bytes, std::max<std::size_t>(size, 1));
    if (!isSound(whole))
        std::abort();
    for (const std::size_t step : {1U, 7U})
        if (!isSame(whole, answerTo(bytes, step)))
            std::abort();
    return 0;
}
