#include "platform/foundation/FoundationCoding.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSURL.h"

#include <algorithm>
#include <bit>
#include <fmt/format.h>

namespace orvo::FoundationCoding {

namespace {

constexpr const char* ObjectsOfCollection = "NS.objects";
constexpr const char* KeysOfDictionary = "NS.keys";
constexpr const char* TimeOfDate = "NS.time";
constexpr const char* BaseOfURL = "NS.base";
constexpr const char* RelativeOfURL = "NS.relative";
constexpr const char* TextOfString = "NS.string";
constexpr const char* BytesOfData = "NS.data";
constexpr const char* DomainOfError = "NSDomain";
constexpr const char* CodeOfError = "NSCode";
constexpr const char* UserInfoOfError = "NSUserInfo";

using Objects = std::vector<std::shared_ptr<NSObject>>;
using Use = NSKeyedUnarchiver::Use;

std::string keyOfElement(std::size_t index) {
    return fmt::format("NS.object.{}", index);
}

/// Foundation's layouts hold lists of references, which only a keyed archive has.
NSKeyedUnarchiver& unarchiver(NSCoder& coder) {
    return dynamic_cast<NSKeyedUnarchiver&>(coder);
}

/// Whether the objects can be found by content in good time: many of one hash are no accident.
bool haveUsefulHashes(const Objects& objects) {
    constexpr std::size_t tolerated = 64;
    std::vector<std::uint64_t> hashes;
    hashes.reserve(objects.size());
    for (const auto& object : objects)
        hashes.push_back(object->hash());
    std::ranges::sort(hashes);
    for (std::size_t i = tolerated; i < hashes.size(); ++i)
        if (hashes[i] == hashes[i - tolerated])
            return false;
    return true;
}

std::shared_ptr<NSObject> decodeString(NSCoder& coder) {
    auto text = unarchiver(coder)._valueForKey(TextOfString);
    if (!dynamic_cast<const NSString*>(text.get()))
        unarchiver(coder)._failCorrupt("a string without text");
    return text;
}

std::shared_ptr<NSObject> decodeData(NSCoder& coder) {
    auto bytes = unarchiver(coder)._valueForKey(BytesOfData);
    if (!dynamic_cast<const NSData*>(bytes.get()))
        unarchiver(coder)._failCorrupt("data without bytes");
    return bytes;
}

std::shared_ptr<NSObject> decodeDate(NSCoder& coder) {
    const auto time =
        std::dynamic_pointer_cast<NSNumber>(unarchiver(coder)._valueForKey(TimeOfDate));
    if (time)
        return NSDate::dateWithTimeIntervalSinceReferenceDate(time->doubleValue());
    unarchiver(coder)._failCorrupt("a date without a time");
    return nullptr;
}

std::shared_ptr<NSObject> decodeArray(NSCoder& coder) {
    return NSArray::arrayWithObjects(
        unarchiver(coder)._decodeArrayOfObjectsForKey(ObjectsOfCollection, Use::Kept));
}

std::shared_ptr<NSObject> decodeDictionary(NSCoder& coder) {
    auto& archive = unarchiver(coder);
    auto keys = archive._decodeArrayOfObjectsForKey(KeysOfDictionary, Use::FoundByContent);
    auto values = archive._decodeArrayOfObjectsForKey(ObjectsOfCollection, Use::Kept);
    if (archive.error())
        return nullptr;
    if (keys.size() != values.size() || !haveUsefulHashes(keys)) {
        archive._failCorrupt("a dictionary whose keys and values do not fit");
        return nullptr;
    }
    NSDictionary::Entries entries;
    entries.reserve(keys.size());
    for (std::size_t i = 0; i < keys.size(); ++i)
        entries.emplace_back(std::move(keys[i]), std::move(values[i]));
    return NSDictionary::dictionaryWithEntries(std::move(entries));
}

Objects decodeElements(NSKeyedUnarchiver& archive) {
    Objects elements;
    if (archive.containsValueForKey(ObjectsOfCollection)) {
        elements = archive._decodeArrayOfObjectsForKey(ObjectsOfCollection, Use::FoundByContent);
    } else {
        for (std::size_t i = 0; archive.containsValueForKey(keyOfElement(i)); ++i)
            if (auto element = archive._decodeElementForKey(keyOfElement(i), Use::FoundByContent))
                elements.push_back(std::move(element));
    }
    if (!archive.error() && !haveUsefulHashes(elements))
        archive._failCorrupt("a set of too many elements with one hash");
    return archive.error() ? Objects() : elements;
}

std::shared_ptr<NSObject> decodeOrderedSet(NSCoder& coder) {
    return NSOrderedSet::orderedSetWithObjects(decodeElements(unarchiver(coder)));
}

std::shared_ptr<NSObject> decodeMutableSet(NSCoder& coder) {
    auto set = NSMutableSet::set();
    for (const auto& element : decodeElements(unarchiver(coder)))
        set->addObject(element);
    return set;
}

std::shared_ptr<NSObject> decodeURL(NSCoder& coder) {
    auto& archive = unarchiver(coder);
    const auto base = archive.decodeObjectOfClass_forKey("NSURL", BaseOfURL);
    const auto text = archive.decodeStringForKey(RelativeOfURL);
    auto url = text && !base ? NSURL::URLWithString(*text) : nullptr;
    if (!url && !archive.error())
        archive._failCorrupt("a URL that is none, or is relative to another");
    return url;
}

std::shared_ptr<NSObject> decodeError(NSCoder& coder) {
    static const auto classesOfUserInfo = [] {
        auto names = propertyListClasses();
        names.insert(names.end(), {"NSError", "NSURL", "NSOrderedSet", "NSSet"});
        return names;
    }();
    auto& archive = unarchiver(coder);
    const auto domain = archive.decodeStringForKey(DomainOfError);
    const auto code = archive.decodeIntegerForKey(CodeOfError);
    const auto info = archive.decodeObjectOfClasses_forKey(classesOfUserInfo, UserInfoOfError);
    auto userInfo = std::dynamic_pointer_cast<NSDictionary>(info);
    if (!domain || (info && !userInfo)) {
        if (!archive.error())
            archive._failCorrupt("an error without a domain, or with another user info");
        return nullptr;
    }
    return NSError::errorWithDomain_code_userInfo(*domain, code, std::move(userInfo));
}

CodingClass collection(std::string name,
                       std::vector<std::string> superclasses,
                       std::shared_ptr<NSObject> (*decode)(NSCoder&)) {
    return {std::move(name),
            std::move(superclasses),
            decode,
            true,
            CodingClass::Content::AllowedWithTheObject};
}

} // namespace

bool isKnown(const NSObject& object) {
    return scalarClass(object) || dynamic_cast<const NSDate*>(&object) ||
           dynamic_cast<const NSArray*>(&object) || dynamic_cast<const NSDictionary*>(&object) ||
           dynamic_cast<const NSOrderedSet*>(&object) ||
           dynamic_cast<const NSMutableSet*>(&object) || dynamic_cast<const NSError*>(&object) ||
           dynamic_cast<const NSURL*>(&object);
}

std::optional<std::string> scalarContent(const NSObject& object) {
    if (const auto* text = dynamic_cast<const NSString*>(&object))
        return "s" + text->utf8();
    if (const auto* data = dynamic_cast<const NSData*>(&object))
        return std::string("d").append(data->stringView());
    const auto* number = dynamic_cast<const NSNumber*>(&object);
    if (!number)
        return std::nullopt;
    if (const auto* flag = std::get_if<bool>(&number->value()))
        return *flag ? "true" : "false";
    if (const auto* real = std::get_if<double>(&number->value()))
        return fmt::format("r{:x}", std::bit_cast<std::uint64_t>(*real));
    return "i" + number->description();
}

std::optional<std::string> scalarClass(const NSObject& object) {
    if (dynamic_cast<const NSString*>(&object))
        return "NSString";
    if (dynamic_cast<const NSNumber*>(&object))
        return "NSNumber";
    if (dynamic_cast<const NSData*>(&object))
        return "NSData";
    return std::nullopt;
}

std::vector<std::string> encode(const NSObject& object, NSKeyedArchiver& archiver) {
    if (const auto* array = dynamic_cast<const NSArray*>(&object)) {
        archiver._encodeArrayOfObjects_forKey(array->elements(), ObjectsOfCollection);
        return {"NSArray", "NSObject"};
    }
    if (const auto* dictionary = dynamic_cast<const NSDictionary*>(&object)) {
        Objects keys;
        Objects values;
        for (const auto& [key, value] : dictionary->entries()) {
            keys.push_back(key);
            values.push_back(value);
        }
        archiver._encodeArrayOfObjects_forKey(keys, KeysOfDictionary);
        archiver._encodeArrayOfObjects_forKey(values, ObjectsOfCollection);
        return {"NSDictionary", "NSObject"};
    }
    if (const auto* date = dynamic_cast<const NSDate*>(&object)) {
        archiver.encodeDouble_forKey(date->timeIntervalSinceReferenceDate(), TimeOfDate);
        return {"NSDate", "NSObject"};
    }
    if (const auto* set = dynamic_cast<const NSOrderedSet*>(&object)) {
        for (std::size_t i = 0; i < set->count(); ++i)
            archiver.encodeObject_forKey(set->elements()[i], keyOfElement(i));
        return {"NSOrderedSet", "NSObject"};
    }
    if (const auto* set = dynamic_cast<const NSMutableSet*>(&object)) {
        Objects elements;
        set->enumerate([&](const auto& element) {
            elements.push_back(element);
            return true;
        });
        archiver._encodeArrayOfObjects_forKey(elements, ObjectsOfCollection);
        return {"NSMutableSet", "NSSet", "NSObject"};
    }
    if (const auto* url = dynamic_cast<const NSURL*>(&object)) {
        archiver.encodeObject_forKey(nullptr, BaseOfURL);
        archiver.encodeString_forKey(url->absoluteString(), RelativeOfURL);
        return {"NSURL", "NSObject"};
    }
    if (const auto* error = dynamic_cast<const NSError*>(&object)) {
        archiver.encodeString_forKey(error->domain(), DomainOfError);
        archiver.encodeInteger_forKey(error->code(), CodeOfError);
        archiver.encodeObject_forKey(error->userInfo(), UserInfoOfError);
        return {"NSError", "NSObject"};
    }
    return {};
}

const std::vector<std::string>& propertyListClasses() {
    static const std::vector<std::string> names{
        "NSString", "NSNumber", "NSData", "NSDate", "NSArray", "NSDictionary"};
    return names;
}

/// The kinds that can change are made as those that cannot. A plain set keeps an order.
const std::vector<CodingClass>& classes() {
    static const std::vector<CodingClass> all{
        {"NSString", {"NSObject"}, decodeString},
        {"NSMutableString", {"NSString", "NSObject"}, decodeString},
        {"NSNumber",
         {"NSValue", "NSObject"},
         [](NSCoder& coder) {
             unarchiver(coder)._failCorrupt("a number that is none");
             return std::shared_ptr<NSObject>();
         }},
        {"NSData", {"NSObject"}, decodeData},
        {"NSMutableData", {"NSData", "NSObject"}, decodeData},
        {"NSDate", {"NSObject"}, decodeDate},
        collection("NSArray", {"NSObject"}, decodeArray),
        collection("NSMutableArray", {"NSArray", "NSObject"}, decodeArray),
        collection("NSDictionary", {"NSObject"}, decodeDictionary),
        collection("NSMutableDictionary", {"NSDictionary", "NSObject"}, decodeDictionary),
        collection("NSOrderedSet", {"NSObject"}, decodeOrderedSet),
        collection("NSMutableOrderedSet", {"NSOrderedSet", "NSObject"}, decodeOrderedSet),
        collection("NSSet", {"NSObject"}, decodeOrderedSet),
        collection("NSMutableSet", {"NSSet", "NSObject"}, decodeMutableSet),
        {"NSURL", {"NSObject"}, decodeURL},
        {"NSError", {"NSObject"}, decodeError},
    };
    return all;
}

} // namespace orvo::FoundationCoding
