#include "platform/feeds/alerts/SourceProof.h"

#include "platform/feeds/alerts/HeaderTime.h"

#include <string>
#include <utility>

namespace orvo {

namespace {

constexpr double OldestBody = 10.0 * 60;
constexpr double ClockTolerance = 60; // a clock is set now and then

SourceProof
failure(AlertErrorCode code, std::string message, std::optional<double> lastKnown = std::nullopt) {
    SourceProof proof;
    proof.error = NSError::errorWithMessage(
        AlertErrorDomain, static_cast<std::int64_t>(code), std::move(message));
    proof.lastKnown = lastKnown;
    return proof;
}

std::string because(const AlertSource& source, const char* otherwise) {
    return source.error ? source.error->localizedDescription() : otherwise;
}

} // namespace

SourceProof SourceProof::judge(const AlertSource& source,
                               double now,
                               const std::function<void(std::string_view entity)>& visit) {
    if (!source.bytes)
        return failure(AlertErrorCode::NotFetched, because(source, "it was never fetched"));
    if (now - source.fetchedAt > OldestBody)
        return failure(AlertErrorCode::TooOld,
                       because(source, "it was last fetched more than ten minutes ago"),
                       source.fetchedAt);
    // A clock that was set back makes a body of any age look fresh.
    if (source.fetchedAt > now + ClockTolerance)
        return failure(AlertErrorCode::TooOld,
                       because(source, "it was last fetched at a time that has not come yet"),
                       now);
    SourceProof proof;
    proof.message = AlertReader::read(source.bytes->bytes(), &proof.error, visit);
    if (!proof.message)
        return proof;
    const auto made = orvo::headerTime(proof.message->timestamp, source.fetchedAt, now);
    if (!made)
        return failure(AlertErrorCode::Stale,
                       "by its own time it is more than a day old",
                       static_cast<double>(wholeSeconds(proof.message->timestamp)));
    proof.headerTime = *made;
    proof.lastKnown = source.fetchedAt;
    return proof;
}

} // namespace orvo
