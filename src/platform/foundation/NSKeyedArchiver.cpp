#include "platform/foundation/NSKeyedArchiver.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/FoundationCoding.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"

#include <fmt/format.h>

namespace orvo {

std::shared_ptr<NSData> NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
    const std::shared_ptr<NSObject>& root,
    bool requiresSecureCoding,
    std::shared_ptr<NSError>* error) {
    return archiving().get()(root, requiresSecureCoding, error);
}

EnvironmentSlot<NSKeyedArchiver::Archiving>& NSKeyedArchiver::archiving() {
    static EnvironmentSlot<Archiving> slot([] {
        return Archiving([](const auto& root, bool requiresSecureCoding, auto* error) {
            const auto archiver = initRequiringSecureCoding(requiresSecureCoding);
            archiver->encodeObject_forKey(root, NSKeyedArchiveRootObjectKey);
            return archiver->encodedData(error);
        });
    });
    return slot;
}

std::shared_ptr<NSKeyedArchiver>
NSKeyedArchiver::initRequiringSecureCoding(bool requiresSecureCoding) {
    auto archiver = std::make_shared<NSKeyedArchiver>();
    archiver->_requiresSecureCoding = requiresSecureCoding;
    archiver->_objects.push_back(NSString::string(KeyedArchive::Nil));
    archiver->_frames.emplace_back();
    return archiver;
}

std::shared_ptr<NSData> NSKeyedArchiver::encodedData(std::shared_ptr<NSError>* error) {
    if (_frames.empty())
        throw NSInvalidArgumentException("attempt to finish an archive twice");
    std::shared_ptr<NSData> data;
    if (!_error) {
        auto top = NSDictionary::dictionaryWithTextKeys(std::move(_frames.front().values));
        std::shared_ptr<NSError> reason;
        data = PropertyList::write(
            *NSDictionary::dictionaryWithTextKeys({
                {KeyedArchive::VersionKey, NSNumber::numberWithInteger(KeyedArchive::Version)},
                {KeyedArchive::ArchiverKey, NSString::string(KeyedArchive::ArchiverName)},
                {KeyedArchive::TopKey, std::move(top)},
                {KeyedArchive::ObjectsKey, NSArray::arrayWithObjects(std::move(_objects))},
            }),
            &reason);
        if (!data)
            failWithError(KeyedArchive::error(
                NSCoderInvalidValueError, "the objects make no property list", reason));
    }
    _frames.clear();
    if (error)
        *error = _error;
    return data;
}

void NSKeyedArchiver::failWithError(const std::shared_ptr<NSError>& error) {
    if (!_error)
        _error = error;
}

void NSKeyedArchiver::fail(const std::string& what) {
    failWithError(KeyedArchive::error(NSCoderInvalidValueError, what));
}

void NSKeyedArchiver::setValue(const std::string& key, std::shared_ptr<NSObject> value) {
    if (_error)
        return;
    if (_frames.empty())
        throw NSInvalidArgumentException("attempt to encode " + key + " into a finished archive");
    _frames.back().values.emplace_back(KeyedArchive::escapedKey(key), std::move(value));
}

void NSKeyedArchiver::encodeObject_forKey(const std::shared_ptr<NSObject>& object,
                                          const std::string& key) {
    setValue(key, reference(object));
}
void NSKeyedArchiver::encodeBool_forKey(bool value, const std::string& key) {
    setValue(key, NSNumber::numberWithBool(value));
}
void NSKeyedArchiver::encodeInteger_forKey(std::int64_t value, const std::string& key) {
    setValue(key, NSNumber::numberWithInteger(value));
}
void NSKeyedArchiver::encodeDouble_forKey(double value, const std::string& key) {
    setValue(key, NSNumber::numberWithDouble(value));
}

void NSKeyedArchiver::_encodeArrayOfObjects_forKey(
    const std::vector<std::shared_ptr<NSObject>>& objects, const std::string& key) {
    NSArray::Elements references;
    references.reserve(objects.size());
    for (const auto& object : objects)
        references.push_back(reference(object));
    setValue(key, NSArray::arrayWithObjects(std::move(references)));
}

std::shared_ptr<NSObject> NSKeyedArchiver::reference(const std::shared_ptr<NSObject>& object) {
    return PropertyListUID::uidWithValue(object && !_error && !_frames.empty() ? addObject(object)
                                                                               : 0);
}

void NSKeyedArchiver::include(const KeyedArchive::Extent& part) {
    const bool isWithinAnObject = _frames.size() > 1; // and not at the top, which has no limits
    if (isWithinAnObject && !_frames.back().extent.include(part))
        fail("the objects are nested too deep, or too many");
}

NSKeyedArchiver::Number NSKeyedArchiver::addObject(const std::shared_ptr<NSObject>& object) {
    if (auto content = FoundationCoding::scalarContent(*object))
        return addScalar(object, *std::move(content));
    if (const auto known = _archived.find(object.get()); known != _archived.end()) {
        if (known->second.isOpen)
            fail(fmt::format("an object of class {} contains itself", object->className()));
        include(known->second.extent);
        return known->second.number;
    }
    if (_frames.size() > KeyedArchive::MaximumDepth) {
        fail("the objects are nested too deep");
        return 0;
    }
    const auto number = _objects.size();
    _objects.push_back(_objects.front()); // keeps the place until the content is known
    _kept.push_back(object);
    _archived[object.get()] = {number, true, {}};
    _frames.emplace_back();
    std::vector<std::string> classes;
    const bool isEncoded = encodeContent(*object, classes);
    auto frame = std::move(_frames.back());
    _frames.pop_back();
    if (!isEncoded || _error)
        return 0;
    frame.values.emplace_back(KeyedArchive::ClassKey,
                              PropertyListUID::uidWithValue(addClass(classes)));
    _objects[number] = NSDictionary::dictionaryWithTextKeys(std::move(frame.values));
    _archived[object.get()] = {number, false, frame.extent};
    include(frame.extent);
    return number;
}

NSKeyedArchiver::Number NSKeyedArchiver::addScalar(const std::shared_ptr<NSObject>& object,
                                                   std::string content) {
    include({1, 1, content.size()});
    const auto [entry, isNew] = _scalars.try_emplace(std::move(content), _objects.size());
    if (isNew)
        _objects.push_back(object);
    return entry->second;
}

bool NSKeyedArchiver::encodeContent(const NSObject& object, std::vector<std::string>& classes) {
    const auto* coding = dynamic_cast<const NSCoding*>(&object);
    if (!coding) {
        classes = FoundationCoding::encode(object, *this);
        if (classes.empty())
            fail(fmt::format("an object of class {} cannot be archived", object.className()));
        return !classes.empty();
    }
    if (_requiresSecureCoding && !supportsSecureCoding(&object)) {
        fail(fmt::format("the class {} supports no secure coding", object.className()));
        return false;
    }
    coding->encodeWithCoder(*this);
    classes = coding->classesForCoder();
    if (classes.empty())
        throw NSInvalidArgumentException("the class " + object.className() + " gives no classes");
    return true;
}

NSKeyedArchiver::Number NSKeyedArchiver::addClass(const std::vector<std::string>& classes) {
    std::string chain;
    NSArray::Elements names;
    for (const auto& name : classes) {
        chain += name + '\n';
        names.push_back(NSString::string(name));
    }
    const auto [entry, isNew] = _classes.try_emplace(std::move(chain), _objects.size());
    if (isNew)
        _objects.push_back(NSDictionary::dictionaryWithTextKeys(
            {{KeyedArchive::ClassNameKey, names.front()},
             {KeyedArchive::ClassesKey, NSArray::arrayWithObjects(names)}}));
    return entry->second;
}

} // namespace orvo
