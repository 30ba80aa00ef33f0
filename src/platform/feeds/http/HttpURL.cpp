#include "platform/feeds/http/HttpURL.h"

#include "platform/feeds/http/AsciiText.h"

#include <QByteArray>
#include <QString>
#include <QUrl>

#include <algorithm>
#include <charconv>

namespace orvo::HttpURL {

namespace {

QUrl parsed(std::string_view text) {
    return QUrl(QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())),
                QUrl::TolerantMode);
}

std::optional<std::string> sendable(const QUrl& url) {
    if (!url.isValid() || url.host().isEmpty() ||
        (url.scheme() != QLatin1String("http") && url.scheme() != QLatin1String("https")))
        return std::nullopt;
    return url.toEncoded(QUrl::RemoveFragment | QUrl::FullyEncoded).toStdString();
}

int portOf(const QUrl& url) {
    return url.port(url.scheme() == QLatin1String("https") ? 443 : 80);
}

bool isSchemeCharacter(char c) {
    const char small = asciiLowercased(c);
    return (small >= 'a' && small <= 'z') || (c >= '0' && c <= '9') || c == '+' || c == '-' ||
           c == '.';
}

} // namespace

std::string_view scheme(std::string_view text) {
    const auto end = text.find("://");
    if (end == std::string_view::npos ||
        !std::ranges::all_of(text.substr(0, end), isSchemeCharacter))
        return {};
    return text.substr(0, end);
}

bool hasHttpScheme(std::string_view text) {
    return beginsIgnoringCase(text, "http://") || beginsIgnoringCase(text, "https://");
}

std::optional<std::string> normalized(std::string_view text) {
    return sendable(parsed(text));
}

std::optional<std::string> resolved(std::string_view base, std::string_view location) {
    const QUrl reference = parsed(location);
    if (!reference.isValid() || reference.isEmpty())
        return std::nullopt;
    return sendable(parsed(base).resolved(reference));
}

bool isSecure(std::string_view url) {
    return parsed(url).scheme() == QLatin1String("https");
}

bool isSameServer(std::string_view url, std::string_view next) {
    const QUrl one = parsed(url);
    const QUrl other = parsed(next);
    if (one.host() != other.host())
        return false;
    if (one.scheme() == other.scheme())
        return portOf(one) == portOf(other);
    return !isSecure(url) && portOf(one) == 80 && portOf(other) == 443;
}

std::string withQuery(std::string_view url,
                      const std::vector<std::pair<std::string, std::string>>& pairs) {
    std::string result(url);
    char separator = '?';
    if (const auto query = result.find('?'); query != std::string::npos)
        separator = query + 1 == result.size() || result.ends_with('&') ? '\0' : '&';
    for (const auto& [name, value] : pairs) {
        if (separator != '\0')
            result += separator;
        result += percentEncoded(name) + "=" + percentEncoded(value);
        separator = '&';
    }
    return result;
}

std::string percentEncoded(std::string_view text) {
    return QByteArray(text.data(), static_cast<qsizetype>(text.size()))
        .toPercentEncoding()
        .toStdString();
}

std::string percentDecoded(std::string_view text) {
    std::string decoded;
    for (std::size_t at = 0; at < text.size(); ++at) {
        unsigned char byte = 0;
        const auto* digits = text.data() + at + 1;
        // The toolkit's own decoder makes bytes also of what are no digits.
        if (text[at] == '%' && text.size() - at > 2 &&
            std::from_chars(digits, digits + 2, byte, 16).ptr == digits + 2) {
            decoded += static_cast<char>(byte);
            at += 2;
        } else {
            decoded += text[at];
        }
    }
    return decoded;
}

std::string base64(std::string_view text) {
    return QByteArray(text.data(), static_cast<qsizetype>(text.size())).toBase64().toStdString();
}

} // namespace orvo::HttpURL
