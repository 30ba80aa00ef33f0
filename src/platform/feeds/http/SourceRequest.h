#pragma once

#include "platform/foundation/NSError.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace orvo {

/// Where bytes come from, and as whom they are asked for. `headers`, `query` and `userPassword` are
/// secrets: they stand in no text that this type makes. A value.
struct SourceRequest {
    using Pairs = std::vector<std::pair<std::string, std::string>>;

    std::string location; ///< `http://`, `https://`, `file://`, or a plain path
    Pairs headers;        ///< sent with HTTP requests, names and values
    Pairs query;          ///< added to the URL's query, names and values, not percent-encoded
    std::optional<std::string> userPassword; ///< `user:password` for basic authorization

    /// Whether it is asked for over HTTP.
    [[nodiscard]] bool isRemote() const;
    /// The path of a `file://` URL or plain path; nothing for a remote source, and for a `file://`
    /// URL that names no local file.
    [[nodiscard]] std::optional<std::filesystem::path> localPath() const;
    /// Nil when it can be asked for; else what is wrong with the location, a header or the user.
    [[nodiscard]] std::shared_ptr<NSError> problem() const;

    /// The location for people: without user and password, and with `…` for the values of
    /// parameters that are known to be keys.
    [[nodiscard]] std::string displayLocation() const;
    /// `text` with `…` in place of every secret of this request, also where it is percent-encoded.
    [[nodiscard]] std::string withoutSecrets(std::string text) const;
    /// The same request with user, password and known key parameters moved out of the location.
    [[nodiscard]] SourceRequest withSecretsApart() const;
    /// Whether it carries anything that must not be seen.
    [[nodiscard]] bool hasSecrets() const;
    /// Names the request, with who asks, among all others: 64 hexadecimal digits that tell nothing.
    [[nodiscard]] std::string key() const;

    friend bool operator==(const SourceRequest&, const SourceRequest&) = default;
};

/// As `SourceRequest::displayLocation()`, of any URL or path.
[[nodiscard]] std::string displayLocation(std::string_view location);

} // namespace orvo
