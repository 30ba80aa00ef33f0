#pragma once

// The member functions of ProtoMessage; included by ProtoMessage.h alone.
#include "platform/protobuf/ProtoMessage.h"

namespace orvo {

namespace protoDetail {

template <class T>
inline constexpr bool isScalar = false;
template <class M, class V>
inline constexpr bool isScalar<ProtoScalarField<M, V>> = true;
template <class T>
inline constexpr bool isString = false;
template <class M>
inline constexpr bool isString<ProtoStringField<M>> = true;
template <class T>
inline constexpr bool isRepeated = false;
template <class M, class S>
inline constexpr bool isRepeated<ProtoRepeatedField<M, S>> = true;

template <class T>
std::shared_ptr<T> copied(const std::shared_ptr<T>& object) {
    return object ? std::dynamic_pointer_cast<T>(object->copy()) : nullptr;
}

inline void write(ProtoWriter& writer, std::uint32_t number, bool value) {
    writer.writeBool(number, value);
}
inline void write(ProtoWriter& writer, std::uint32_t number, std::int32_t value) {
    writer.writeInt32(number, value);
}
inline void write(ProtoWriter& writer, std::uint32_t number, std::uint32_t value) {
    writer.writeUInt32(number, value);
}
inline void write(ProtoWriter& writer, std::uint32_t number, std::uint64_t value) {
    writer.writeUInt64(number, value);
}
inline void write(ProtoWriter& writer, std::uint32_t number, double value) {
    writer.writeDouble(number, value);
}
inline void write(ProtoWriter& writer, std::uint32_t number, const ProtoCodable& message) {
    ProtoWriter sub;
    message.writeTo(sub);
    writer.writeBytes(number, sub.bytes());
}

template <class Value>
Value readValue(ProtoReader& reader) {
    if constexpr (std::is_same_v<Value, double>)
        return reader.readDouble();
    else if constexpr (std::is_same_v<Value, bool>)
        return reader.readBool();
    else
        return static_cast<Value>(reader.readVarint());
}

template <class Value>
std::shared_ptr<NSObject> boxed(Value value, ProtoEnumNames names) {
    if constexpr (std::is_same_v<Value, bool>)
        return NSNumber::numberWithBool(value);
    else if constexpr (std::is_same_v<Value, double>)
        return NSNumber::numberWithDouble(value);
    else if constexpr (std::is_signed_v<Value>) {
        if (!names.empty())
            return NSString::string(protoEnumAsString(names, value));
        return NSNumber::numberWithInteger(value);
    } else
        return NSNumber::numberWithUnsignedInteger(value);
}

template <class Value>
std::uint64_t scalarHash(Value value) {
    if constexpr (std::is_same_v<Value, double>)
        return protoHash(value);
    else if constexpr (std::is_signed_v<Value>)
        return protoHash(static_cast<std::uint64_t>(std::int64_t{value}));
    else
        return protoHash(static_cast<std::uint64_t>(value));
}

} // namespace protoDetail

template <class Derived>
bool ProtoMessage<Derived>::readFrom(ProtoReader& reader) {
    while (!reader.isAtEnd()) {
        const auto tag = reader.readTag();
        if (reader.hasError() || tag.wireType == ProtoWireType::EndGroup)
            break;
        bool taken = false;
        forEachField([&](const auto& field) {
            if (!taken && field.number == tag.fieldNumber)
                taken = readField(field, tag, reader);
        });
        if (!taken)
            reader.skip(tag);
    }
    return !reader.hasError();
}

template <class Derived>
template <class Value>
bool ProtoMessage<Derived>::readField(const ProtoScalarField<Derived, Value>& field,
                                      ProtoTag tag,
                                      ProtoReader& reader) {
    constexpr auto wireType =
        std::is_same_v<Value, double> ? ProtoWireType::Fixed64 : ProtoWireType::Varint;
    if (tag.wireType != wireType)
        return false;
    self().*field.value = protoDetail::readValue<Value>(reader);
    setHasBit(field.hasBit, true);
    return true;
}

template <class Derived>
bool ProtoMessage<Derived>::readField(const ProtoStringField<Derived>& field,
                                      ProtoTag tag,
                                      ProtoReader& reader) {
    if (tag.wireType != ProtoWireType::LengthDelimited)
        return false;
    self().*field.value = reader.readString();
    return true;
}

template <class Derived>
template <class Sub>
bool ProtoMessage<Derived>::readField(const ProtoMessageField<Derived, Sub>& field,
                                      ProtoTag tag,
                                      ProtoReader& reader) {
    if (tag.wireType != ProtoWireType::LengthDelimited)
        return false;
    self().*field.value = readSubMessage<Sub>(reader);
    return true;
}

template <class Derived>
template <class Sub>
bool ProtoMessage<Derived>::readField(const ProtoRepeatedField<Derived, Sub>& field,
                                      ProtoTag tag,
                                      ProtoReader& reader) {
    if (tag.wireType != ProtoWireType::LengthDelimited)
        return false;
    (self().*field.value).push_back(readSubMessage<Sub>(reader));
    return true;
}

template <class Derived>
template <class Sub>
std::shared_ptr<Sub> ProtoMessage<Derived>::readSubMessage(ProtoReader& reader) {
    auto message = std::make_shared<Sub>();
    ProtoReader::Mark mark;
    if (reader.placeMark(mark)) {
        if (!message->readFrom(reader))
            reader.recordError();
        reader.recallMark(mark);
    }
    return message;
}

template <class Derived>
void ProtoMessage<Derived>::writeTo(ProtoWriter& writer) const {
    forEachField([&]<class Field>(const Field& field) {
        const auto& value = self().*field.value;
        if constexpr (protoDetail::isScalar<Field>) {
            if (hasBit(field.hasBit))
                protoDetail::write(writer, field.number, value);
        } else if constexpr (protoDetail::isString<Field>) {
            if (value)
                writer.writeString(field.number, *value);
        } else if constexpr (protoDetail::isRepeated<Field>) {
            for (const auto& element : value)
                protoDetail::write(writer, field.number, *element);
        } else if (value)
            protoDetail::write(writer, field.number, *value);
    });
}

template <class Derived>
void ProtoMessage<Derived>::copyTo(Derived& target) const {
    forEachField([&]<class Field>(const Field& field) {
        const auto& value = self().*field.value;
        if constexpr (protoDetail::isScalar<Field>) {
            if (hasBit(field.hasBit))
                target.assign(target.*field.value, value, field.hasBit);
        } else if constexpr (protoDetail::isRepeated<Field>) {
            if (!value.empty())
                target.*field.value = value;
        } else if (value)
            target.*field.value = value;
    });
}

template <class Derived>
void ProtoMessage<Derived>::mergeFrom(const ProtoCodable& otherMessage) {
    if (typeid(*this) != typeid(otherMessage))
        return;
    const auto& other = dynamic_cast<const Derived&>(otherMessage);
    forEachField([&]<class Field>(const Field& field) {
        auto& mine = self().*field.value;
        const auto& theirs = other.*field.value;
        if constexpr (protoDetail::isScalar<Field>) {
            if (other.hasBit(field.hasBit))
                assign(mine, theirs, field.hasBit);
        } else if constexpr (protoDetail::isRepeated<Field>) {
            const auto appended = theirs; // a copy: the other may be the receiver
            mine.insert(mine.end(), appended.begin(), appended.end());
        } else if constexpr (protoDetail::isString<Field>) {
            if (theirs)
                mine = theirs;
        } else if (mine && theirs)
            mine->mergeFrom(*theirs);
        else if (theirs)
            mine = theirs;
    });
}

template <class Derived>
std::shared_ptr<NSDictionary> ProtoMessage<Derived>::dictionaryRepresentation() const {
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries;
    forEachField([&]<class Field>(const Field& field) {
        const auto& value = self().*field.value;
        if constexpr (protoDetail::isScalar<Field>) {
            if (hasBit(field.hasBit))
                entries.emplace_back(field.name, protoDetail::boxed(value, field.names));
        } else if constexpr (protoDetail::isString<Field>) {
            if (value)
                entries.emplace_back(field.name, NSString::string(*value));
        } else if constexpr (protoDetail::isRepeated<Field>) {
            if (value.empty())
                return;
            NSArray::Elements dictionaries;
            for (const auto& element : value)
                dictionaries.push_back(element->dictionaryRepresentation());
            entries.emplace_back(field.name, NSArray::arrayWithObjects(std::move(dictionaries)));
        } else if (value)
            entries.emplace_back(field.name, value->dictionaryRepresentation());
    });
    return NSDictionary::dictionaryWithTextKeys(std::move(entries));
}

template <class Derived>
bool ProtoMessage<Derived>::isEqual(const NSObject* object) const {
    if (!object || typeid(*this) != typeid(*object))
        return false;
    const auto& other = dynamic_cast<const Derived&>(*object);
    bool same = true;
    forEachField([&]<class Field>(const Field& field) {
        const auto& mine = self().*field.value;
        const auto& theirs = other.*field.value;
        if constexpr (protoDetail::isScalar<Field>)
            same = same && hasBit(field.hasBit) == other.hasBit(field.hasBit) &&
                   (!hasBit(field.hasBit) || mine == theirs);
        else if constexpr (protoDetail::isString<Field>)
            same = same && mine == theirs;
        else if constexpr (protoDetail::isRepeated<Field>)
            same = same && NSArray::arrayOf(mine)->isEqual(NSArray::arrayOf(theirs).get());
        else
            same = same && equal(mine, theirs);
    });
    return same;
}

template <class Derived>
std::uint64_t ProtoMessage<Derived>::hash() const {
    std::uint64_t hash = 0;
    forEachField([&]<class Field>(const Field& field) {
        const auto& value = self().*field.value;
        if constexpr (protoDetail::isScalar<Field>)
            hash ^= hasBit(field.hasBit) ? protoDetail::scalarHash(value) : 0;
        else if constexpr (protoDetail::isRepeated<Field>)
            hash ^= value.empty() ? 0 : NSArray::arrayOf(value)->hash();
        else
            hash ^= hashOf(value);
    });
    return hash;
}

template <class Derived>
std::shared_ptr<NSObject> ProtoMessage<Derived>::copy() const {
    auto copy = _alloc();
    copyTo(*copy);
    forEachField([&]<class Field>(const Field& field) {
        if constexpr (protoDetail::isRepeated<Field>) {
            for (auto& element : (*copy).*field.value)
                element = protoDetail::copied(element);
        } else if constexpr (!protoDetail::isScalar<Field> && !protoDetail::isString<Field>)
            (*copy).*field.value = protoDetail::copied((*copy).*field.value);
    });
    return copy;
}

} // namespace orvo
