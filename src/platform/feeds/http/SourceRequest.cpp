#include "platform/feeds/http/SourceRequest.h"

#include "platform/feeds/http/AsciiText.h"
#include "platform/feeds/http/HttpURL.h"
#include "platform/feeds/http/SourceError.h"
#include "platform/feeds/http/SourceSecrets.h"

#include <QByteArray>
#include <QCryptographicHash>

#include <algorithm>
#include <array>
#include <cctype>
#include <climits>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* Mask = "…";
constexpr std::string_view FileScheme = "file://";
/// What the loader itself says to the server, or the toolkit for it.
constexpr std::array<std::string_view, 8> OwnHeaders = {"accept-encoding",
                                                        "connection",
                                                        "content-length",
                                                        "host",
                                                        "if-modified-since",
                                                        "if-none-match",
                                                        "range",
                                                        "transfer-encoding"};

bool isControl(char c) {
    return static_cast<unsigned char>(c) < 0x20 || c == 0x7F;
}

bool hasControls(std::string_view text) {
    return std::ranges::any_of(text, isControl);
}

bool isFileURL(std::string_view location) {
    return beginsIgnoringCase(location, FileScheme);
}

/// By RFC 9110's token.
bool isHeaderName(std::string_view name) {
    return !name.empty() && std::ranges::all_of(name, [](unsigned char c) {
        return std::isalnum(c) != 0 ||
               std::string_view("!#$%&'*+-.^_`|~").find(static_cast<char>(c)) !=
                   std::string_view::npos;
    });
}

/// Empty for a path that the system can be asked for.
std::string problemOfPath(const std::filesystem::path& path) {
    if (path.native().find('\0') != std::string::npos)
        return "a path cannot hold a zero byte";
    constexpr std::size_t Longest = PATH_MAX - 1;
    const auto length = std::filesystem::absolute(path).native().size();
    return length <= Longest
               ? ""
               : fmt::format(
                     "a path of {} bytes is longer than the system permits ({})", length, Longest);
}

std::string problemOfLocation(const SourceRequest& request) {
    const auto shown = request.displayLocation();
    if (request.location.empty())
        return "no location is given";
    if (hasControls(request.location))
        return fmt::format("{}: a location cannot hold control characters", shown);
    if (request.isRemote())
        return HttpURL::normalized(request.location)
                   ? ""
                   : fmt::format("{}: this is no valid web address", shown);
    const auto path = request.localPath();
    if (path)
        return problemOfPath(*path);
    if (isFileURL(request.location))
        return fmt::format("{}: this names no file on this machine", shown);
    return fmt::format("{}: only http, https and file are understood", shown);
}

std::string problemOfSecrets(const SourceRequest& request) {
    const auto shown = request.displayLocation();
    for (const auto& [name, value] : request.headers) {
        // A name that is no name may be a secret given in the wrong place.
        if (!isHeaderName(name))
            return fmt::format("{}: a header's name holds what no name can hold", shown);
        if (hasControls(value))
            return fmt::format("{}: the header {} holds control characters", shown, name);
        if (std::ranges::find(OwnHeaders, asciiLowercased(name)) != OwnHeaders.end())
            return fmt::format("{}: the header {} is not for others to set", shown, name);
    }
    if (std::ranges::any_of(request.query, [](const auto& pair) { return pair.first.empty(); }))
        return fmt::format("{}: a query parameter has no name", shown);
    if (request.userPassword && hasControls(*request.userPassword))
        return fmt::format("{}: user and password hold control characters", shown);
    if (!request.isRemote() && request.hasSecrets())
        return fmt::format("{}: headers, query and user are for web addresses only", shown);
    return "";
}

void replaceAll(std::string& text, const std::string& secret) {
    // Less keeps no secret, and stands in many an innocent number.
    constexpr std::size_t ShortestSecret = 4;
    if (secret.size() < ShortestSecret)
        return;
    const std::string_view mask = Mask;
    for (auto at = text.find(secret); at != std::string::npos; at = text.find(secret, at))
        at = text.replace(at, secret.size(), mask).find(mask, at) + mask.size();
}

void addPairs(std::vector<std::string>& secrets, const SourceRequest::Pairs& pairs) {
    for (const auto& [name, value] : pairs) {
        secrets.push_back(value);
        if (const auto blank = value.rfind(' '); blank != std::string::npos) // `Bearer SECRET`
            secrets.push_back(value.substr(blank + 1));
    }
}

void addUser(std::vector<std::string>& secrets, const std::string& userPassword) {
    secrets.push_back(userPassword);
    secrets.push_back(QByteArray::fromStdString(userPassword).toBase64().toStdString());
    if (const auto colon = userPassword.find(':'); colon != std::string::npos)
        secrets.push_back(userPassword.substr(colon + 1));
}

} // namespace

bool SourceRequest::isRemote() const {
    return HttpURL::hasHttpScheme(location);
}

std::optional<std::filesystem::path> SourceRequest::localPath() const {
    if (isRemote() || location.empty())
        return std::nullopt;
    if (!isFileURL(location)) {
        if (!HttpURL::scheme(location).empty())
            return std::nullopt;
        return location;
    }
    auto rest = std::string_view(location).substr(FileScheme.size());
    constexpr std::string_view ThisMachine = "localhost/";
    if (beginsIgnoringCase(rest, ThisMachine))
        rest.remove_prefix(ThisMachine.size() - 1);
    if (!rest.starts_with('/'))
        return std::nullopt;
    return HttpURL::percentDecoded(rest);
}

std::shared_ptr<NSError> SourceRequest::problem() const {
    auto message = problemOfLocation(*this);
    if (message.empty())
        message = problemOfSecrets(*this);
    if (message.empty())
        return nullptr;
    return sourceError(SourceErrorCode::InvalidRequest, std::move(message));
}

std::string SourceRequest::displayLocation() const {
    return orvo::displayLocation(location);
}

std::string SourceRequest::withoutSecrets(std::string text) const {
    const auto inLocation = secretsApart(location);
    std::vector<std::string> secrets;
    addPairs(secrets, headers);
    addPairs(secrets, query);
    addPairs(secrets, inLocation.query);
    if (userPassword)
        addUser(secrets, *userPassword);
    addUser(secrets, HttpURL::percentDecoded(inLocation.userInfo));
    secrets.push_back(inLocation.userInfo);
    for (std::size_t index = 0, count = secrets.size(); index < count; ++index)
        secrets.push_back(HttpURL::percentEncoded(secrets[index]));
    // What holds another goes first, or its rest would be left.
    std::ranges::sort(secrets, std::ranges::greater{}, &std::string::size);
    for (const auto& secret : secrets)
        replaceAll(text, secret);
    return text;
}

SourceRequest SourceRequest::withSecretsApart() const {
    if (!isRemote())
        return *this;
    auto apart = secretsApart(location);
    auto request = *this;
    request.location = std::move(apart.location);
    for (auto& pair : apart.query)
        request.query.push_back(std::move(pair));
    if (!apart.userInfo.empty() && !request.userPassword)
        request.userPassword = HttpURL::percentDecoded(apart.userInfo);
    return request;
}

bool SourceRequest::hasSecrets() const {
    return !headers.empty() || !query.empty() || userPassword.has_value();
}

std::string SourceRequest::key() const {
    QCryptographicHash hash(QCryptographicHash::Sha256);
    // Each text with its length, so that no two requests read alike.
    const auto add = [&](std::string_view text) {
        const auto part = fmt::format("{}:{}", text.size(), text);
        hash.addData(QByteArrayView(part.data(), static_cast<qsizetype>(part.size())));
    };
    const auto addAll = [&](const Pairs& pairs) {
        add(std::to_string(pairs.size()));
        for (const auto& [name, value] : pairs) {
            add(name);
            add(value);
        }
    };
    add(location);
    addAll(headers);
    addAll(query);
    add(userPassword ? "user" : "nobody");
    add(userPassword.value_or(""));
    return hash.result().toHex().toStdString();
}

std::string displayLocation(std::string_view location) {
    const auto apart = secretsApart(location);
    auto shown = apart.location;
    const auto fragment = shown.find('#');
    auto tail = fragment == std::string::npos ? std::string() : shown.substr(fragment);
    shown.resize(shown.size() - tail.size());
    char separator = shown.find('?') == std::string::npos ? '?' : '&';
    for (const auto& pair : apart.query) {
        shown += fmt::format("{}{}={}", separator, pair.first, Mask);
        separator = '&';
    }
    shown += tail;
    std::ranges::replace_if(shown, isControl, '?');
    return shown;
}

} // namespace orvo
