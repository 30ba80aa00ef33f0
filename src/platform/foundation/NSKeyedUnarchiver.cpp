#include "platform/foundation/NSKeyedUnarchiver.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/FoundationCoding.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"

#include <algorithm>
#include <fmt/format.h>
#include <utility>

namespace orvo {

/// The object whose keys are read, for a scope that may end with an exception.
class NSKeyedUnarchiver::FrameScope {
public:
    FrameScope(NSKeyedUnarchiver& archive, Frame frame)
        : _archive(archive) {
        _archive._frames.push_back(std::move(frame));
    }
    FrameScope(const FrameScope&) = delete;
    FrameScope& operator=(const FrameScope&) = delete;
    ~FrameScope() { _archive._frames.pop_back(); }

private:
    NSKeyedUnarchiver& _archive;
};

std::shared_ptr<NSKeyedUnarchiver>
NSKeyedUnarchiver::initForReadingFromData_error(const std::shared_ptr<NSData>& data,
                                                std::shared_ptr<NSError>* error) {
    std::shared_ptr<NSError> reason;
    auto unarchiver = std::make_shared<NSKeyedUnarchiver>();
    unarchiver->_table = CodingClassTable::current().get();
    if (!data)
        reason = KeyedArchive::error(NSCoderReadCorruptError, "there is no data");
    else if (unarchiver->open(*data, &reason))
        return unarchiver;
    if (error)
        *error = reason;
    return nullptr;
}

std::shared_ptr<NSObject>
NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(const std::vector<std::string>& classes,
                                                            const std::shared_ptr<NSData>& data,
                                                            std::shared_ptr<NSError>* error) {
    const auto unarchiver = initForReadingFromData_error(data, error);
    return unarchiver ? unarchiver->decodeTopLevelObjectOfClasses_forKey_error(
                            classes, NSKeyedArchiveRootObjectKey, error)
                      : nullptr;
}

bool NSKeyedUnarchiver::open(const NSData& data, std::shared_ptr<NSError>* error) {
    const auto fail = [&](const char* what, const std::shared_ptr<NSError>& underlying = nullptr) {
        *error = KeyedArchive::error(NSCoderReadCorruptError, what, underlying);
        return false;
    };
    std::shared_ptr<NSError> reason;
    const auto list = PropertyList::read(data.bytes(), &reason);
    if (!list)
        return fail("the bytes are no property list", reason);
    const auto root = std::dynamic_pointer_cast<NSDictionary>(list);
    if (!root || stringValue(root->objectForKey(KeyedArchive::ArchiverKey).get()) !=
                     KeyedArchive::ArchiverName)
        return fail("the property list is no keyed archive");
    const auto version =
        std::dynamic_pointer_cast<NSNumber>(root->objectForKey(KeyedArchive::VersionKey));
    if (!version || version->integerValue() != KeyedArchive::Version)
        return fail("the archive is of an unknown version");
    auto top = std::dynamic_pointer_cast<NSDictionary>(root->objectForKey(KeyedArchive::TopKey));
    _objects = std::dynamic_pointer_cast<NSArray>(root->objectForKey(KeyedArchive::ObjectsKey));
    if (!top || !_objects || _objects->count() == 0 ||
        stringValue(_objects->elements().front().get()) != KeyedArchive::Nil)
        return fail("the archive has no objects");
    _frames.push_back({std::move(top), AnyClass, {}});
    _hashableBytes = PropertyList::maximumKeyBytes(data.length());
    return true;
}

void NSKeyedUnarchiver::setClass_forClassName(const std::string& className,
                                              const std::string& archivedName) {
    _classNames.insert_or_assign(archivedName, className);
    _classes.clear(); // may have been found under their own names
}

std::shared_ptr<NSObject> NSKeyedUnarchiver::decodeTopLevelObjectOfClasses_forKey_error(
    const std::vector<std::string>& classes,
    const std::string& key,
    std::shared_ptr<NSError>* error) {
    const auto policy = std::exchange(_policy, NSDecodingFailurePolicy::SetErrorAndReturn);
    std::shared_ptr<NSObject> object;
    if (!_error && !containsValueForKey(key))
        failWithError(KeyedArchive::error(NSCoderValueNotFoundError,
                                          fmt::format("there is nothing under the key {}", key)));
    else
        object = decodeObjectOfClasses_forKey(classes, key);
    _policy = policy;
    if (error)
        *error = _error;
    return object;
}

void NSKeyedUnarchiver::finishDecoding() {
    if (_frames.size() > 1)
        throw NSInvalidArgumentException("attempt to finish decoding within an object");
    _frames.clear();
    _decoded.clear();
    _classes.clear();
    _objects = nullptr;
}

void NSKeyedUnarchiver::failWithError(const std::shared_ptr<NSError>& error) {
    if (!_error)
        _error = error;
    if (_policy == NSDecodingFailurePolicy::RaiseException)
        throw NSInvalidUnarchiveOperationException(_error->localizedDescription());
}

void NSKeyedUnarchiver::_failCorrupt(const std::string& what) {
    failWithError(KeyedArchive::error(NSCoderReadCorruptError, what));
}

std::shared_ptr<NSObject> NSKeyedUnarchiver::_valueForKey(const std::string& key) const {
    if (_error || _frames.empty())
        return nullptr;
    return _frames.back().record->objectForKey(KeyedArchive::escapedKey(key));
}

bool NSKeyedUnarchiver::containsValueForKey(const std::string& key) const {
    return _valueForKey(key) != nullptr;
}

std::shared_ptr<NSObject>
NSKeyedUnarchiver::decodeObjectOfClasses_forKey(const std::vector<std::string>& classes,
                                                const std::string& key) {
    return decodeUnderKey(key, allowedSet(classes));
}

std::shared_ptr<NSObject> NSKeyedUnarchiver::decodeObjectForKey(const std::string& key) {
    return decodeUnderKey(key, allowedSet(FoundationCoding::propertyListClasses()));
}

std::shared_ptr<NSNumber> NSKeyedUnarchiver::numberForKey(const std::string& key) {
    const auto value = _valueForKey(key);
    auto number = std::dynamic_pointer_cast<NSNumber>(value);
    if (value && !number)
        _failCorrupt(fmt::format("the value under the key {} is no number", key));
    return number;
}

bool NSKeyedUnarchiver::decodeBoolForKey(const std::string& key) {
    const auto number = numberForKey(key);
    return number && number->boolValue();
}

std::int64_t NSKeyedUnarchiver::decodeIntegerForKey(const std::string& key) {
    const auto number = numberForKey(key);
    return number ? number->integerValue() : 0;
}

double NSKeyedUnarchiver::decodeDoubleForKey(const std::string& key) {
    const auto number = numberForKey(key);
    return number ? number->doubleValue() : 0;
}

std::vector<std::shared_ptr<NSObject>>
NSKeyedUnarchiver::_decodeArrayOfObjectsForKey(const std::string& key, Use use) {
    const auto list = std::dynamic_pointer_cast<NSArray>(_valueForKey(key));
    if (!list) {
        if (!_error)
            _failCorrupt(fmt::format("there is no list under the key {}", key));
        return {};
    }
    std::vector<std::shared_ptr<NSObject>> objects;
    objects.reserve(list->count());
    for (const auto& reference : list->elements()) {
        auto object = decodeReference(*reference, _frames.back().allowed, use);
        if (!object && !_error)
            _failCorrupt(fmt::format("an element under the key {} is nil", key));
        if (_error)
            return {};
        objects.push_back(std::move(object));
    }
    return objects;
}

std::shared_ptr<NSObject> NSKeyedUnarchiver::_decodeElementForKey(const std::string& key, Use use) {
    const auto reference = _valueForKey(key);
    auto object = reference ? decodeReference(*reference, _frames.back().allowed, use) : nullptr;
    if (!object && !_error)
        _failCorrupt(fmt::format("the element {} is nil", key));
    return object;
}

std::shared_ptr<NSObject> NSKeyedUnarchiver::decodeUnderKey(const std::string& key,
                                                            Allowed allowed) {
    const auto reference = _valueForKey(key);
    return reference ? decodeReference(*reference, allowed, Use::Kept) : nullptr;
}

std::shared_ptr<NSObject>
NSKeyedUnarchiver::decodeReference(const NSObject& reference, Allowed allowed, Use use) {
    const auto* uid = dynamic_cast<const PropertyListUID*>(&reference);
    if (!uid) {
        _failCorrupt("a value stands where a reference should");
        return nullptr;
    }
    if (uid->value() == 0)
        return nullptr;
    const auto* entry = decoded(uid->value(), allowed);
    if (!entry)
        return nullptr;
    const bool isWithinAnObject = _frames.size() > 1; // and not at the top, which has no limits
    if (isWithinAnObject && !_frames.back().extent.include(entry->extent)) {
        _failCorrupt("the objects are nested too deep, or unfold to too many");
        return nullptr;
    }
    if (use == Use::FoundByContent) {
        constexpr std::size_t bytesPerObject = 16; // what hashing one costs at least
        const auto cost = entry->extent.bytes + bytesPerObject * entry->extent.objects;
        if (cost > _hashableBytes) {
            _failCorrupt("too much is to be found by content");
            return nullptr;
        }
        _hashableBytes -= cost;
    }
    return entry->object;
}

NSKeyedUnarchiver::Decoded* NSKeyedUnarchiver::decoded(std::uint64_t number, Allowed allowed) {
    if (number >= _objects->count()) {
        _failCorrupt(fmt::format("there is no object {}", number));
        return nullptr;
    }
    const auto* itsClass = classOf(*_objects->elements()[static_cast<std::size_t>(number)]);
    if (!itsClass)
        return nullptr;
    if (!isAllowed(*itsClass, allowed)) {
        _failCorrupt(fmt::format(
            "object {} is of the class {}, which is not allowed there", number, itsClass->name));
        return nullptr;
    }
    const bool dependsOnSet = itsClass->content == CodingClass::Content::AllowedWithTheObject;
    auto& entry = _decoded[{number, dependsOnSet ? allowed : AnyClass}];
    if (entry.isDone)
        return &entry;
    if (entry.isOpen) {
        _failCorrupt(fmt::format("object {} contains itself", number));
        return nullptr;
    }
    if (_frames.size() > KeyedArchive::MaximumDepth) {
        _failCorrupt("the objects are nested too deep");
        return nullptr;
    }
    decodeContent(
        _objects->elements()[static_cast<std::size_t>(number)], *itsClass, allowed, entry);
    return _error ? nullptr : &entry;
}

void NSKeyedUnarchiver::decodeContent(const std::shared_ptr<NSObject>& archived,
                                      const CodingClass& itsClass,
                                      Allowed allowed,
                                      Decoded& entry) {
    auto record = std::dynamic_pointer_cast<NSDictionary>(archived);
    if (!record) {
        entry.object = archived;
        entry.extent.bytes = FoundationCoding::scalarContent(*archived)->size();
        entry.isDone = true;
        return;
    }
    entry.isOpen = true;
    const FrameScope scope(*this, {std::move(record), allowed, {}});
    auto object = itsClass.initWithCoder(*this);
    if (_error)
        return;
    entry.object = std::move(object);
    entry.extent = _frames.back().extent;
    entry.isDone = true;
}

NSKeyedUnarchiver::Allowed NSKeyedUnarchiver::allowedSet(const std::vector<std::string>& classes) {
    if (!_requiresSecureCoding)
        return AnyClass;
    const std::set<std::string> names(classes.begin(), classes.end());
    const auto known = std::find(_allowedSets.begin() + 1, _allowedSets.end(), names);
    if (known == _allowedSets.end()) {
        _allowedSets.push_back(names);
        return _allowedSets.size() - 1;
    }
    return static_cast<Allowed>(known - _allowedSets.begin());
}

bool NSKeyedUnarchiver::isAllowed(const CodingClass& itsClass, Allowed allowed) const {
    if (allowed == AnyClass)
        return true;
    return itsClass.supportsSecureCoding &&
           std::ranges::any_of(_allowedSets[allowed],
                               [&](const auto& name) { return itsClass.isKindOf(name); });
}

const CodingClass* NSKeyedUnarchiver::classOf(const NSObject& archived) {
    if (const auto scalar = FoundationCoding::scalarClass(archived))
        return _table->find(*scalar);
    const auto* record = dynamic_cast<const NSDictionary*>(&archived);
    const auto uid = record ? std::dynamic_pointer_cast<PropertyListUID>(
                                  record->objectForKey(KeyedArchive::ClassKey))
                            : nullptr;
    if (uid && uid->value() < _objects->count())
        return classNumbered(uid->value());
    _failCorrupt("an object has no class");
    return nullptr;
}

const CodingClass* NSKeyedUnarchiver::classNumbered(std::uint64_t number) {
    auto& known = _classes[number];
    if (known)
        return known;
    const auto* description = dynamic_cast<const NSDictionary*>(
        _objects->elements()[static_cast<std::size_t>(number)].get());
    const auto name = description
                          ? stringValue(description->objectForKey(KeyedArchive::ClassNameKey).get())
                          : std::nullopt;
    if (!name) {
        _failCorrupt("an object has no class");
        return nullptr;
    }
    const auto alias = _classNames.find(*name);
    known = _table->find(alias == _classNames.end() ? *name : alias->second);
    if (!known)
        _failCorrupt(fmt::format("the class {} is not known", *name));
    return known;
}

} // namespace orvo
