#include "platform/foundation/KeyedArchive.h"

#include "platform/foundation/NSString.h"

#include <algorithm>

namespace orvo::KeyedArchive {

bool Extent::include(const Extent& part) noexcept {
    height = std::max(height, part.height + 1);
    objects += part.objects;
    bytes += part.bytes;
    return height <= MaximumDepth && objects <= MaximumObjects;
}

std::string escapedKey(const std::string& key) {
    return key.starts_with('$') ? "$" + key : key;
}

std::shared_ptr<NSError>
error(std::int64_t code, const std::string& what, const std::shared_ptr<NSError>& underlying) {
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> info{
        {NSLocalizedDescriptionKey, NSString::string("keyed archive: " + what)}};
    if (underlying)
        info.emplace_back(NSUnderlyingErrorKey, underlying);
    return NSError::errorWithDomain_code_userInfo(
        NSCocoaErrorDomain, code, NSDictionary::dictionaryWithTextKeys(std::move(info)));
}

} // namespace orvo::KeyedArchive
