#pragma once

#include "platform/foundation/NSObject.h"

#include <string>
#include <vector>

namespace orvo {

class NSCoder;

/// An object that can be archived. Its class has besides a static `initWithCoder(NSCoder&)`, named
/// in the table of classes made by name (`CodingClassTable`), that answers nil where the coder does
/// not hold what it needs.
class NSCoding : public virtual NSObject {
public:
    /// Gives the coder what makes up the receiver, under keys that are the class's own.
    virtual void encodeWithCoder(NSCoder& coder) const = 0;
    /// The names under which it is archived: its class, then what that derives from, `NSObject`
    /// last. The default is `className()` and `NSObject`.
    [[nodiscard]] virtual std::vector<std::string> classesForCoder() const {
        return {className(), "NSObject"};
    }
};

/// An object whose class decodes only objects of classes that it names.
class NSSecureCoding : public virtual NSCoding {
public:
    /// Whether the class keeps that promise.
    [[nodiscard]] virtual bool supportsSecureCoding() const { return true; }
};

/// Whether the object can be archived where secure coding is required: foundation's own values and
/// collections can, and what adopts `NSSecureCoding` and says so. False for nil.
[[nodiscard]] bool supportsSecureCoding(const NSObject* object);

} // namespace orvo
