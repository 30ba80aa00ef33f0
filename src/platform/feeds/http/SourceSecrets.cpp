#include "platform/feeds/http/SourceSecrets.h"

#include "platform/feeds/http/AsciiText.h"
#include "platform/feeds/http/HttpURL.h"

#include <algorithm>
#include <array>

namespace orvo {

namespace {

constexpr std::array<std::string_view, 8> KeyNames = {
    "sig", "pwd", "pass", "code", "user", "username", "appid", "app_id"};
constexpr std::array<std::string_view, 7> KeyNameParts = {
    "key", "token", "secret", "passw", "auth", "signature", "credential"};

/// Cuts off and answers what stands before the next `separator`.
std::string_view next(std::string_view& rest, char separator) {
    const auto end = rest.find(separator);
    const auto part = rest.substr(0, end);
    rest = end == std::string_view::npos ? std::string_view{} : rest.substr(end + 1);
    return part;
}

} // namespace

bool isKeyParameter(std::string_view name) {
    const auto known = asciiLowercased(name);
    return std::ranges::find(KeyNames, known) != KeyNames.end() ||
           std::ranges::any_of(KeyNameParts, [&](std::string_view part) {
               return known.find(part) != std::string::npos;
           });
}

SourceSecrets secretsApart(std::string_view location) {
    SourceSecrets apart;
    const auto scheme = HttpURL::scheme(location).size();
    if (scheme == 0) {
        apart.location = location;
        return apart;
    }
    auto rest = location.substr(scheme + 3);
    auto authority = rest.substr(0, rest.find_first_of("/?#"));
    rest.remove_prefix(authority.size());
    if (const auto at = authority.rfind('@'); at != std::string_view::npos) {
        apart.userInfo = authority.substr(0, at);
        authority.remove_prefix(at + 1);
    }
    apart.location = location.substr(0, scheme + 3);
    apart.location += authority;
    const auto fragment = rest.find('#');
    const auto tail = fragment == std::string_view::npos ? "" : rest.substr(fragment);
    rest = rest.substr(0, fragment);
    apart.location += next(rest, '?');
    char separator = '?';
    while (!rest.empty()) {
        auto pair = next(rest, '&');
        auto value = pair;
        const auto name = HttpURL::percentDecoded(next(value, '='));
        if (isKeyParameter(name)) {
            apart.query.emplace_back(name, HttpURL::percentDecoded(value));
            continue;
        }
        apart.location += separator;
        apart.location += pair;
        separator = '&';
    }
    apart.location += tail;
    return apart;
}

} // namespace orvo
