#pragma once

#include "platform/foundation/Selector.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// How an associated object is attached.
enum class AssociationPolicy {
    RetainNonatomic, ///< keeps the object itself
    CopyNonatomic, ///< keeps `NSCopying::copy()` of it; an object that does not copy is kept itself
};

/// The root of every class and protocol. Bases derive from it virtually, so that an object has one
/// identity, however many protocols it adopts. Objects live in shared pointers; nil is the null
/// pointer.
///
/// A public default constructor stands for `alloc`; a static `init…` function allocates and
/// initialises.
class NSObject : public std::enable_shared_from_this<NSObject> {
public:
    NSObject(const NSObject&) = delete;
    NSObject& operator=(const NSObject&) = delete;
    virtual ~NSObject();

    /// Content equality. The default is identity. `other` may be nil, which is never equal.
    [[nodiscard]] virtual bool isEqual(const NSObject* other) const;
    /// Objects that are equal hash alike. The default derives from identity.
    [[nodiscard]] virtual std::uint64_t hash() const;
    /// Text for logs and dumps. The default is `rootDescription()`.
    [[nodiscard]] virtual std::string description() const;
    /// The name of the receiver's own class, without its namespace.
    [[nodiscard]] virtual std::string className() const;
    /// `<ClassName: 0xADDRESS>`.
    [[nodiscard]] std::string rootDescription() const;

    /// A method that somebody can keep by name: it is called with the object that sends the message
    /// (a timer, a notification, or nil) and answers an object or nil.
    using Method =
        std::function<std::shared_ptr<NSObject>(const std::shared_ptr<NSObject>& sender)>;

    /// The method that can be performed by this name; empty where the receiver has none. A class
    /// with such methods overrides this and asks its base for all others.
    [[nodiscard]] virtual Method methodForSelector(const Selector& selector);
    [[nodiscard]] bool respondsToSelector(const Selector& selector);
    /// Performs the method with nil as its sender.
    /// @throws NSInvalidArgumentException when the receiver does not respond
    std::shared_ptr<NSObject> performSelector(const Selector& selector);
    std::shared_ptr<NSObject> performSelector_withObject(const Selector& selector,
                                                         const std::shared_ptr<NSObject>& sender);

    /// Attaches `value` under `key` (an address that stands for the key); nil detaches. Not
    /// synchronised.
    void setAssociatedObject(const void* key,
                             const std::shared_ptr<NSObject>& value,
                             AssociationPolicy policy);
    /// Nil when nothing is attached.
    [[nodiscard]] std::shared_ptr<NSObject> associatedObject(const void* key) const;

protected:
    NSObject();

private:
    struct Associations;
    std::unique_ptr<Associations> _associations;
};

/// An object that can be copied. An immutable one may answer itself.
class NSCopying : public virtual NSObject {
public:
    [[nodiscard]] virtual std::shared_ptr<NSObject> copy() const = 0;
};

/// A collection that can be walked from the first element to the last.
class NSFastEnumeration : public virtual NSObject {
public:
    /// Calls `visit` for each element in enumeration order until it answers false.
    virtual void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const = 0;
};

/// Both nil, or `isEqual:`. `a` is the receiver of that message.
[[nodiscard]] bool equal(const NSObject* a, const NSObject* b);
/// 0 for nil.
[[nodiscard]] std::uint64_t hashOf(const NSObject* object);
/// `(null)` for nil.
[[nodiscard]] std::string descriptionOf(const NSObject* object);

template <class A, class B>
[[nodiscard]] bool equal(const std::shared_ptr<A>& a, const std::shared_ptr<B>& b) {
    return equal(static_cast<const NSObject*>(a.get()), static_cast<const NSObject*>(b.get()));
}
template <class T>
[[nodiscard]] std::uint64_t hashOf(const std::shared_ptr<T>& object) {
    return hashOf(static_cast<const NSObject*>(object.get()));
}
template <class T>
[[nodiscard]] std::string descriptionOf(const std::shared_ptr<T>& object) {
    return descriptionOf(static_cast<const NSObject*>(object.get()));
}

/// `self` as a strong reference, inside a member function of T.
template <class T>
[[nodiscard]] std::shared_ptr<T> strong(T* self) {
    return std::shared_ptr<T>(self->shared_from_this(), self);
}
template <class T>
[[nodiscard]] std::shared_ptr<const T> strong(const T* self) {
    return std::shared_ptr<const T>(self->shared_from_this(), self);
}

} // namespace orvo
