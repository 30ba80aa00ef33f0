#pragma once

#include "platform/foundation/NSObject.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// Something happened. Immutable.
class NSNotification final : public virtual NSObject {
public:
    /// `object`: to whom; may be nil.
    [[nodiscard]] static std::shared_ptr<NSNotification>
    notificationWithName_object(std::string name, std::shared_ptr<NSObject> object);

    [[nodiscard]] const std::string& name() const noexcept { return _name; }
    [[nodiscard]] const std::shared_ptr<NSObject>& object() const noexcept { return _object; }

private:
    std::string _name;
    std::shared_ptr<NSObject> _object;
};

/// Tells observers what happened, by name. Main thread; observers are told inside the call that
/// posts, in the order in which they were added.
class NSNotificationCenter final : public virtual NSObject {
public:
    /// The program's own, always the same object.
    [[nodiscard]] static const std::shared_ptr<NSNotificationCenter>& defaultCenter();

    /// The observer is held weakly; its method gets the `NSNotification` as its sender. Without a
    /// name it hears all names, without an object those of every object. Added twice it is told
    /// twice.
    /// @throws NSInvalidArgumentException for a nil observer, or one that does not respond
    void addObserver_selector_name_object(const std::shared_ptr<NSObject>& observer,
                                          Selector selector,
                                          std::optional<std::string> name,
                                          const std::shared_ptr<NSObject>& object);
    /// From all names. An observer that is removed while others are told is not told any more.
    void removeObserver(const NSObject& observer);
    /// Observers that are added meanwhile do not hear of it.
    void postNotificationName_object(std::string name, std::shared_ptr<NSObject> object);
    /// How many are registered and alive, each registration counted.
    [[nodiscard]] std::size_t _observerCount() const;

private:
    struct Registration {
        std::weak_ptr<NSObject> observer;
        const NSObject* address;
        Selector selector;
        std::optional<std::string> name;
        const NSObject* object; ///< compared only
        bool isRemoved = false;
    };

    std::vector<std::shared_ptr<Registration>> _registrations;
};

} // namespace orvo
