#include "platform/foundation/NSCoding.h"

#include "platform/foundation/FoundationCoding.h"

namespace orvo {

bool supportsSecureCoding(const NSObject* object) {
    if (!object)
        return false;
    if (const auto* coding = dynamic_cast<const NSCoding*>(object)) {
        const auto* secure = dynamic_cast<const NSSecureCoding*>(coding);
        return secure && secure->supportsSecureCoding();
    }
    return FoundationCoding::isKnown(*object);
}

} // namespace orvo
