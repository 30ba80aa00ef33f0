#include "platform/mapuikit/MapItem.h"

#include "platform/foundation/NSString.h"
#include "platform/geoservices/UserSession.h"

namespace orvo {

namespace {

/// The query without the parameter of that name.
std::string withoutParameter(std::string_view query, std::string_view name) {
    std::string kept;
    while (!query.empty()) {
        const auto end = std::min(query.find('&'), query.size());
        const auto parameter = query.substr(0, end);
        if (parameter.substr(0, parameter.find('=')) != name) {
            if (!kept.empty())
                kept += '&';
            kept += parameter;
        }
        query.remove_prefix(std::min(end + 1, query.size()));
    }
    return kept;
}

} // namespace

std::shared_ptr<NSDictionary>
MapItem::_sharedSessionUserInfoForPunchoutUserInfo(const std::shared_ptr<NSDictionary>& userInfo) {
    const auto session = UserSession::sharedInstance()->sharedSessionID();
    if (session.empty())
        return userInfo;
    auto entries = userInfo ? userInfo->entries() : NSDictionary::Entries{};
    entries.emplace_back(NSString::string(SharedSessionKey), NSString::string(session));
    return NSDictionary::dictionaryWithEntries(std::move(entries));
}

std::shared_ptr<NSURL> MapItem::_sharedSessionURLForPunchoutURL(const std::string& url) {
    const auto session = UserSession::sharedInstance()->sharedSessionID();
    if (session.empty())
        return NSURL::URLWithString(url);
    const auto fragmentAt = std::min(url.find('#'), url.size());
    const auto queryAt = std::min(url.find('?'), fragmentAt);
    const auto start = url.substr(0, queryAt);
    const auto fragment = url.substr(fragmentAt);
    auto query =
        queryAt < fragmentAt
            ? withoutParameter(std::string_view(url).substr(queryAt + 1, fragmentAt - queryAt - 1),
                               SharedSessionParameter)
            : std::string();
    if (!query.empty())
        query += '&';
    return NSURL::URLWithString(start + "?" + query + SharedSessionParameter + "=" + session +
                                fragment);
}

} // namespace orvo
