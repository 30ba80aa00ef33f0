#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSCoder.h"

#include <functional>
#include <initializer_list>
#include <map>
#include <string>
#include <vector>

namespace orvo {

/// A class as the unarchiver knows it: what it is called in archives, and how one is made.
struct CodingClass {
    /// Whether what it contains is decoded with the classes allowed for itself.
    enum class Content { NamedByTheClass, AllowedWithTheObject };

    std::string name;
    std::vector<std::string> superclasses; ///< nearest first, `NSObject` last
    /// Nil where the coder does not hold what the class needs.
    std::function<std::shared_ptr<NSObject>(NSCoder&)> initWithCoder;
    bool supportsSecureCoding = true;
    Content content = Content::NamedByTheClass; ///< the other is for collections

    /// Of a class with a static `initWithCoder(NSCoder&)`.
    template <class T>
    [[nodiscard]] static CodingClass of(std::string name,
                                        std::vector<std::string> superclasses = {"NSObject"}) {
        return {std::move(name), std::move(superclasses), [](NSCoder& coder) {
                    return std::shared_ptr<NSObject>(T::initWithCoder(coder));
                }};
    }

    /// The class itself, or one that it derives from.
    [[nodiscard]] bool isKindOf(const std::string& className) const;
};

/// The classes that an unarchiver can make. Foundation's own are always known; each program hands
/// in the others. Immutable.
class CodingClassTable {
public:
    /// A name given twice stands for the later class.
    CodingClassTable(std::initializer_list<CodingClass> classes = {});

    /// Nil for an unknown name. Lives as long as the table.
    [[nodiscard]] const CodingClass* find(const std::string& name) const;

    /// The table of the running program. Default: only foundation's classes.
    static EnvironmentSlot<std::shared_ptr<const CodingClassTable>>& current();

private:
    std::map<std::string, CodingClass> _classes;
};

} // namespace orvo
