#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

/// Arithmetic of `http://` and `https://` URLs, as text. Any thread.
namespace orvo::HttpURL {

/// What stands before `://` when that can be a scheme; else empty.
[[nodiscard]] std::string_view scheme(std::string_view text);
/// Whether it begins with `http://` or `https://`, in letters of either case.
[[nodiscard]] bool hasHttpScheme(std::string_view text);
/// In the form in which it is sent, without fragment. Nothing for what is no URL of these schemes
/// with a host.
[[nodiscard]] std::optional<std::string> normalized(std::string_view text);
/// What a Location header names when it comes with the answer from `base`. Nothing for what is no
/// URL of these schemes.
[[nodiscard]] std::optional<std::string> resolved(std::string_view base, std::string_view location);

[[nodiscard]] bool isSecure(std::string_view url);
/// Whether `next` is the same server, as far as secrets go: the same host and port, or the same
/// host at the usual ports with TLS in place of none.
[[nodiscard]] bool isSameServer(std::string_view url, std::string_view next);

/// With the pairs at the end of its query, percent-encoded.
[[nodiscard]] std::string withQuery(std::string_view url,
                                    const std::vector<std::pair<std::string, std::string>>& pairs);
/// Every byte encoded but letters, digits, `-`, `.`, `_` and `~`.
[[nodiscard]] std::string percentEncoded(std::string_view text);
[[nodiscard]] std::string percentDecoded(std::string_view text);
[[nodiscard]] std::string base64(std::string_view text);

} // namespace orvo::HttpURL
