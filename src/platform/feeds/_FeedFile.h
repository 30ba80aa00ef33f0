#pragma once

#include "platform/feeds/FeedConfiguration.h"
#include "platform/foundation/NSDictionary.h"

#include <memory>
#include <optional>
#include <vector>

/// The content of the registry's two files. The first holds nothing that must not be seen; the
/// second knows each secret's source by the feed's name and the location.
namespace orvo::_FeedFile {

[[nodiscard]] std::shared_ptr<NSDictionary> feeds(const std::vector<FeedConfiguration>& feeds);
[[nodiscard]] std::shared_ptr<NSDictionary> secrets(const std::vector<FeedConfiguration>& feeds);

/// Nothing when it is no such list. Entries that are no feeds are left out.
[[nodiscard]] std::optional<std::vector<FeedConfiguration>> readFeeds(const NSObject* list);
/// Puts the secrets where they belong. False when it is no such list.
[[nodiscard]] bool addSecrets(const NSObject* list, std::vector<FeedConfiguration>& feeds);

} // namespace orvo::_FeedFile
