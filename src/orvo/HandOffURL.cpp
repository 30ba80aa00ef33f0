#include "orvo/HandOffURL.h"

#include "orvo/HandOffError.h"
#include "orvo/console/DisplayText.h"
#include "platform/foundation/NSURL.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>
#include <utility>
#include <vector>

namespace orvo {

namespace {

using Parameter = std::pair<std::string, std::string>;

/// A percent sign that no two hexadecimal digits follow stands for itself.
std::string percentDecoded(std::string_view text) {
    constexpr int Hexadecimal = 16;
    std::string decoded;
    for (std::size_t i = 0; i < text.size(); ++i) {
        unsigned char byte = 0;
        const auto digits = text.substr(std::min(i + 1, text.size()), 2);
        const auto* end = digits.data() + digits.size();
        if (text[i] == '%' && digits.size() == 2 &&
            std::from_chars(digits.data(), end, byte, Hexadecimal).ptr == end) {
            decoded += static_cast<char>(byte);
            i += 2;
        } else {
            decoded += text[i];
        }
    }
    return decoded;
}

std::vector<Parameter> parametersOf(std::string_view query) {
    std::vector<Parameter> parameters;
    while (!query.empty()) {
        const auto end = std::min(query.find('&'), query.size());
        const auto whole = query.substr(0, end);
        const auto equals = std::min(whole.find('='), whole.size());
        parameters.emplace_back(percentDecoded(whole.substr(0, equals)),
                                percentDecoded(whole.substr(std::min(equals + 1, whole.size()))));
        query.remove_prefix(std::min(end + 1, query.size()));
    }
    return parameters;
}

std::optional<std::int32_t> number(std::string_view text) {
    std::int32_t value = 0;
    const auto* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, value);
    return result.ec == std::errc() && result.ptr == end ? std::optional(value) : std::nullopt;
}

std::optional<std::int32_t> mapTypeOf(std::string_view text) {
    constexpr std::string_view letters = "mkhr";
    if (text.size() == 1)
        if (const auto letter = letters.find(text.front()); letter != std::string_view::npos)
            return static_cast<std::int32_t>(letter);
    return number(text);
}

} // namespace

std::optional<HandOffURL> HandOffURL::parse(const std::string& text,
                                            std::shared_ptr<NSError>* error) {
    if (text.size() > MaximumLength) {
        setHandOffError(error,
                        HandOffErrorCode::TooLarge,
                        fmt::format("A URL of {} bytes is too long.", text.size()));
        return std::nullopt;
    }
    constexpr std::size_t MostColumns = 120;
    const auto shown = DisplayText::cut(DisplayText::oneLine(text), MostColumns);
    const auto url = NSURL::URLWithString(text);
    if (!url || url->scheme() != "orvo") {
        setHandOffError(error,
                        HandOffErrorCode::NotOurs,
                        url ? fmt::format("{} is no URL of this application.", shown)
                            : fmt::format("\"{}\" is no URL.", shown));
        return std::nullopt;
    }
    std::string_view rest = url->absoluteString();
    rest = rest.substr(0, rest.find('#'));
    rest.remove_prefix(rest.find(':') + 1);
    const auto queryAt = std::min(rest.find('?'), rest.size());
    const auto place = rest.substr(0, queryAt);
    if (place.find_first_not_of('/') != std::string_view::npos) {
        setHandOffError(error,
                        HandOffErrorCode::Unknown,
                        fmt::format("{} asks for a place, and there are none.", shown));
        return std::nullopt;
    }
    HandOffURL result;
    for (const auto& [name, value] :
         parametersOf(rest.substr(std::min(queryAt + 1, rest.size())))) {
        const bool isFavorites = name == "favorites";
        if (!isFavorites && name != "t")
            continue;
        const auto read = isFavorites ? number(value) : mapTypeOf(value);
        if (!read || (isFavorites && *read != TransitLineFavorites)) {
            setHandOffError(error,
                            HandOffErrorCode::Unknown,
                            fmt::format("{}: there is no {} of that type.",
                                        shown,
                                        isFavorites ? "list of favourites" : "map"));
            return std::nullopt;
        }
        (isFavorites ? result.favoritesType : result.mapType) = read;
    }
    return result;
}

} // namespace orvo
