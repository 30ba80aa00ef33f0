#include "platform/foundation/NSObject.h"

#include "platform/foundation/Exceptions.h"

#include <cstdlib>
#include <cxxabi.h>
#include <fmt/format.h>
#include <map>
#include <typeinfo>

namespace orvo {

struct NSObject::Associations {
    std::map<const void*, std::shared_ptr<NSObject>> objects;
};

NSObject::NSObject() = default;
NSObject::~NSObject() = default;

bool NSObject::isEqual(const NSObject* other) const {
    return this == other;
}

std::uint64_t NSObject::hash() const {
    return reinterpret_cast<std::uintptr_t>(this);
}

std::string NSObject::description() const {
    return rootDescription();
}

std::string NSObject::className() const {
    int status = 0;
    char* demangled = abi::__cxa_demangle(typeid(*this).name(), nullptr, nullptr, &status);
    std::string name = status == 0 ? demangled : typeid(*this).name();
    std::free(
        demangled); // NOLINT(cppcoreguidelines-no-malloc): the interface hands out malloc's memory
    if (const auto colon = name.rfind("::"); colon != std::string::npos)
        name.erase(0, colon + 2);
    return name;
}

std::string NSObject::rootDescription() const {
    return fmt::format("<{}: {}>", className(), static_cast<const void*>(this));
}

NSObject::Method NSObject::methodForSelector(const Selector&) {
    return {};
}

bool NSObject::respondsToSelector(const Selector& selector) {
    return static_cast<bool>(methodForSelector(selector));
}

std::shared_ptr<NSObject> NSObject::performSelector(const Selector& selector) {
    return performSelector_withObject(selector, nullptr);
}

std::shared_ptr<NSObject>
NSObject::performSelector_withObject(const Selector& selector,
                                     const std::shared_ptr<NSObject>& sender) {
    const auto method = methodForSelector(selector);
    if (!method)
        throw NSInvalidArgumentException(
            fmt::format("-[{} {}]: unrecognized selector sent to instance {}",
                        className(),
                        selector.name(),
                        static_cast<const void*>(this)));
    return method(sender);
}

void NSObject::setAssociatedObject(const void* key,
                                   const std::shared_ptr<NSObject>& value,
                                   AssociationPolicy policy) {
    if (!value) {
        if (_associations)
            _associations->objects.erase(key);
        return;
    }
    if (!_associations)
        _associations = std::make_unique<Associations>();
    const auto* copying = dynamic_cast<const NSCopying*>(value.get());
    _associations->objects[key] =
        policy == AssociationPolicy::CopyNonatomic && copying ? copying->copy() : value;
}

std::shared_ptr<NSObject> NSObject::associatedObject(const void* key) const {
    if (!_associations)
        return nullptr;
    const auto found = _associations->objects.find(key);
    return found == _associations->objects.end() ? nullptr : found->second;
}

bool equal(const NSObject* a, const NSObject* b) {
    if (!a || !b)
        return a == b;
    return a->isEqual(b);
}

std::uint64_t hashOf(const NSObject* object) {
    return object ? object->hash() : 0;
}

std::string descriptionOf(const NSObject* object) {
    return object ? object->description() : "(null)";
}

} // namespace orvo
