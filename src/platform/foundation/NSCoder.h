#pragma once

#include "platform/foundation/NSError.h"
#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// Codes of `NSCocoaErrorDomain`.
inline constexpr std::int64_t NSCoderReadCorruptError = 4864;   ///< wrong bytes or a wrong class
inline constexpr std::int64_t NSCoderValueNotFoundError = 4865; ///< nothing under the key
inline constexpr std::int64_t NSCoderInvalidValueError = 4866;  ///< cannot be archived

/// What an object hands its content to, or takes it from, by keys. Classes are given by the names
/// under which they are archived. One thread at a time.
///
/// A coder either writes or reads: the members of the other kind throw
/// `NSInvalidArgumentException`. After a failure a coder takes and gives nothing more (nil, 0,
/// false), so nobody need look at `error()` after each value.
class NSCoder : public virtual NSObject {
public:
    [[nodiscard]] virtual bool requiresSecureCoding() const = 0;
    /// The first failure; nil when all went well so far.
    [[nodiscard]] virtual std::shared_ptr<NSError> error() const = 0;
    /// Makes the whole coding fail. Only the first failure counts.
    virtual void failWithError(const std::shared_ptr<NSError>& error) = 0;

    /// Nil is kept as nil.
    virtual void encodeObject_forKey(const std::shared_ptr<NSObject>& object,
                                     const std::string& key);
    virtual void encodeBool_forKey(bool value, const std::string& key);
    virtual void encodeInteger_forKey(std::int64_t value, const std::string& key);
    virtual void encodeDouble_forKey(double value, const std::string& key);
    /// As an object; no text as nil.
    void encodeString_forKey(const std::optional<std::string>& text, const std::string& key);

    /// Also where the value is nil.
    [[nodiscard]] virtual bool containsValueForKey(const std::string& key) const;
    /// Nil when there is none, or it was nil. An object that is of none of the classes and derives
    /// from none makes the coding fail where secure coding is required. What a collection contains
    /// must be of these classes too.
    [[nodiscard]] virtual std::shared_ptr<NSObject>
    decodeObjectOfClasses_forKey(const std::vector<std::string>& classes, const std::string& key);
    /// Of any class; where secure coding is required only of those that property lists have.
    [[nodiscard]] virtual std::shared_ptr<NSObject> decodeObjectForKey(const std::string& key);
    /// False or 0 when there is none; a value of another kind makes the coding fail.
    [[nodiscard]] virtual bool decodeBoolForKey(const std::string& key);
    [[nodiscard]] virtual std::int64_t decodeIntegerForKey(const std::string& key);
    [[nodiscard]] virtual double decodeDoubleForKey(const std::string& key);

    [[nodiscard]] std::shared_ptr<NSObject> decodeObjectOfClass_forKey(const std::string& className,
                                                                       const std::string& key);
    /// The same as T; nil when it is none.
    template <class T>
    [[nodiscard]] std::shared_ptr<T> decodeObjectOfClass_forKey(const std::string& className,
                                                                const std::string& key) {
        return std::dynamic_pointer_cast<T>(decodeObjectOfClass_forKey(className, key));
    }
    [[nodiscard]] std::optional<std::string> decodeStringForKey(const std::string& key);
};

} // namespace orvo
