#pragma once

#include "platform/feeds/http/SourceError.h"
#include "platform/feeds/http/SourceRequest.h"
#include "platform/foundation/NSData.h"

#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>

namespace orvo {

class HttpTransport;

/// How a source is asked for.
struct LoadOptions {
    /// Of the body, before and after decompression.
    std::uint64_t maximumBytes = std::uint64_t{64} << 20;
    /// Seconds of the environment's monotonic clock without a byte from the server.
    double idleTimeout = 15;
    /// The same for the whole load, redirects included.
    double totalTimeout = 60;
    /// A body older than this many seconds, or validated this often in a row, is asked for whole:
    /// some servers answer "not modified" for ever.
    double wholeAfter = 24 * 3600;
    int wholeAfterValidations = 20;
    /// Ask for the whole body whatever is known of it.
    bool unconditional = false;
    /// Ask the server also in a pause that it asked for: a person wants to know.
    bool inPause = false;
    /// Tells by the bytes alone whether none are missing, on a worker queue. It is asked about a
    /// body over HTTP whose end the server did not tell, neither by Content-Length nor by chunks
    /// nor by a compression with a checksum. Empty: no bytes can tell, and such a body is a failed
    /// load; so it is for alerts, where a message that was cut between two entries reads like a
    /// shorter one.
    std::function<bool(const std::shared_ptr<NSData>& bytes)> isWhole;
    /// Judges a body that came whole, on a worker queue: nil, or why it is none of the kind that is
    /// looked for (an error page sent as if all were well). Such a load has failed with that error,
    /// and the earlier body stays the last good one. Empty: every body is good.
    std::function<std::shared_ptr<NSError>(const NSData& bytes)> check;
    /// Called while a body comes over HTTP, on a thread of the network's; must be quick. `total` is
    /// nothing where the server does not tell it; both are of the body as it is sent. Not after the
    /// completion, but for that of a load that is cancelled.
    std::function<void(std::uint64_t soFar, std::optional<std::uint64_t> total)> progress;

    /// For schedules: large, asked for once a day.
    [[nodiscard]] static LoadOptions forSchedule();
};

/// What a load found.
struct SourceBody {
    enum class Outcome {
        Whole,     ///< got whole just now
        Validated, ///< the server said just now that the kept body is still the current one
        Failed     ///< the attempt failed; `bytes` is what is left of an earlier one
    };
    Outcome outcome = Outcome::Failed;
    /// The last good body. Nil when there never was one. Equal pointers are equal bytes.
    std::shared_ptr<NSData> bytes;
    /// When `bytes` was last got whole or validated, in seconds since 1970 by the environment's
    /// wall clock at that time; 0 without bytes. In the future where that clock was set back since.
    double fetchedAt = 0;
    /// When `bytes` was got whole; at most `fetchedAt`.
    double receivedAt = 0;
    /// Why the attempt failed; nil exactly when it did not.
    std::shared_ptr<NSError> error;
};

/// A load under way. It goes on when nobody keeps this.
class SourceLoad {
public:
    SourceLoad() = default;
    SourceLoad(const SourceLoad&) = delete;
    SourceLoad& operator=(const SourceLoad&) = delete;
    virtual ~SourceLoad() = default;

    /// The completion is called soon, on a worker queue, with a cancellation error alone. Other
    /// callers of the same request are not touched. Nothing once the load has ended. Any thread.
    virtual void cancel() = 0;
};

/// Gets the bytes of sources: local files, and HTTP with conditional requests. Any thread.
///
/// The last good body of each remote source is kept in `bodies` in the cache folder, with its
/// validators and times; while `Environment::keepsWritesInMemory()` holds, what comes is kept in
/// memory instead. Callers of one request share it while it is under way; requests run side by
/// side. A server that sends Retry-After is left alone for that time (at most a day), by all
/// loaders of that cache folder: its pauses are kept in `pauses` there.
class SourceLoader {
public:
    using Completion = std::function<void(SourceBody)>;

    /// The folder need not exist yet. HTTP requests need an application object:
    /// `RunLoop::main()` was asked for once before.
    [[nodiscard]] static std::shared_ptr<SourceLoader> make(std::filesystem::path cacheFolder);
    /// With another way to the network, for tests.
    [[nodiscard]] static std::shared_ptr<SourceLoader>
    make(std::filesystem::path cacheFolder, std::shared_ptr<HttpTransport> transport);

    SourceLoader(const SourceLoader&) = delete;
    SourceLoader& operator=(const SourceLoader&) = delete;
    /// Loads under way end with a cancellation error alone.
    ~SourceLoader();

    /// `completion` is called exactly once, on a worker queue, never inside the call. For a caller
    /// that joins a load under way the options of that load hold, but for `progress`.
    std::shared_ptr<SourceLoad>
    load(const SourceRequest& request, const LoadOptions& options, Completion completion);

    /// The last good body that is kept, as a failed load would give it, without asking anybody.
    /// Reads the disk. `bytes` is nil and `error` too for a local source, and where nothing is
    /// kept.
    [[nodiscard]] SourceBody lastGoodBody(const SourceRequest& request) const;

private:
    class Engine;
    explicit SourceLoader(std::shared_ptr<Engine> engine);

    std::shared_ptr<Engine> _engine;
};

} // namespace orvo
