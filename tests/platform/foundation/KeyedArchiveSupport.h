#pragma once

#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"

#include <string>
#include <utility>
#include <vector>

namespace orvo::testing {

/// A box with a name, other boxes, and whatever else is put in.
class Box : public virtual NSSecureCoding {
public:
    static std::shared_ptr<Box> boxNamed(std::string name) {
        auto box = std::make_shared<Box>();
        box->name = std::move(name);
        return box;
    }
    static std::shared_ptr<Box> initWithCoder(NSCoder& coder) { return decoded<Box>(coder); }

    void encodeWithCoder(NSCoder& coder) const override {
        coder.encodeString_forKey(name, "name");
        coder.encodeBool_forKey(isOpen, "open");
        coder.encodeInteger_forKey(weight, "weight");
        coder.encodeDouble_forKey(height, "height");
        coder.encodeObject_forKey(boxes, "boxes");
        coder.encodeObject_forKey(next, "next");
    }
    bool isEqual(const NSObject* other) const override {
        const auto* box = dynamic_cast<const Box*>(other);
        return box && box->name == name && box->isOpen == isOpen && box->weight == weight &&
               box->height == height && equal(box->boxes, boxes) && equal(box->next, next);
    }
    std::uint64_t hash() const override { return hashOf(name); }

    std::optional<std::string> name;
    bool isOpen = false;
    std::int64_t weight = 0;
    double height = 0;
    std::shared_ptr<NSArray> boxes;
    std::shared_ptr<NSObject> next;

protected:
    template <class T>
    static std::shared_ptr<T> decoded(NSCoder& coder) {
        auto box = std::make_shared<T>();
        box->name = coder.decodeStringForKey("name");
        box->isOpen = coder.decodeBoolForKey("open");
        box->weight = coder.decodeIntegerForKey("weight");
        box->height = coder.decodeDoubleForKey("height");
        box->boxes = std::dynamic_pointer_cast<NSArray>(
            coder.decodeObjectOfClasses_forKey({"NSArray", "Box"}, "boxes"));
        box->next = coder.decodeObjectOfClass_forKey("Box", "next");
        return box->name == "none" ? nullptr : box;
    }
};

/// A box that derives from a box.
class Crate final : public Box {
public:
    static std::shared_ptr<Crate> initWithCoder(NSCoder& coder) { return decoded<Crate>(coder); }
    std::vector<std::string> classesForCoder() const override {
        return {"Crate", "Box", "NSObject"};
    }
};

/// Can be archived, but makes no promise.
class Loose final : public virtual NSCoding {
public:
    static std::shared_ptr<Loose> initWithCoder(NSCoder& coder) {
        auto loose = std::make_shared<Loose>();
        loose->content = coder.decodeObjectForKey("content");
        return loose;
    }
    void encodeWithCoder(NSCoder& coder) const override {
        coder.encodeObject_forKey(content, "content");
    }
    std::shared_ptr<NSObject> content;
};

inline std::shared_ptr<const CodingClassTable> boxClasses() {
    auto loose = CodingClass::of<Loose>("Loose");
    loose.supportsSecureCoding = false;
    return std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<Box>("Box"),
                         CodingClass::of<Crate>("Crate", {"Box", "NSObject"}),
                         std::move(loose)});
}

/// Archives made by hand, object by object; the first object is number 1 and the root.
class HandMadeArchive {
public:
    using Entries = std::vector<std::pair<std::string, std::shared_ptr<NSObject>>>;

    static std::shared_ptr<NSObject> reference(std::uint64_t number) {
        return PropertyListUID::uidWithValue(number);
    }
    static std::shared_ptr<NSObject> references(const std::vector<std::uint64_t>& numbers) {
        NSArray::Elements elements;
        for (const auto number : numbers)
            elements.push_back(reference(number));
        return NSArray::arrayWithObjects(std::move(elements));
    }
    /// The description of a class without superclasses.
    static std::shared_ptr<NSObject> classNamed(const std::string& name) {
        return NSDictionary::dictionaryWithTextKeys(
            {{"$classname", NSString::string(name)},
             {"$classes", NSArray::arrayOf<NSString>({NSString::string(name)})}});
    }
    /// An object whose class is described by the object of that number.
    static std::shared_ptr<NSObject> object(std::uint64_t classNumber, Entries entries) {
        entries.emplace_back("$class", reference(classNumber));
        return NSDictionary::dictionaryWithTextKeys(std::move(entries));
    }

    static std::shared_ptr<NSDictionary> list(NSArray::Elements objects) {
        objects.insert(objects.begin(), NSString::string("$null"));
        return NSDictionary::dictionaryWithTextKeys(
            {{"$version", NSNumber::numberWithInteger(100000)},
             {"$archiver", NSString::string("NSKeyedArchiver")},
             {"$top", NSDictionary::dictionaryWithTextKeys({{"root", reference(1)}})},
             {"$objects", NSArray::arrayWithObjects(std::move(objects))}});
    }
    static std::shared_ptr<NSData> data(NSArray::Elements objects) {
        return PropertyList::write(*list(std::move(objects)));
    }
};

} // namespace orvo::testing
