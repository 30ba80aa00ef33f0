#pragma once

#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/protobuf/ProtoFields.h"

#include <tuple>
#include <typeinfo>
#include <utility>

namespace orvo {

/// Everything that follows from a message's schema alone. `Derived::schema()` answers a tuple of
/// the field descriptions in ascending field number.
///
/// Reading: an unknown field, or a known one of another wire type, is passed over and lost; an
/// end-group tag ends the message; a second occurrence of a sub-message replaces the first.
/// Writing: ascending field numbers, present fields only.
template <class Derived>
class ProtoMessage : public ProtoCodable {
public:
    bool readFrom(ProtoReader& reader) override;
    void writeTo(ProtoWriter& writer) const override;
    /// Gives `target` every present field of the receiver, sub-messages as the same objects; its
    /// other fields stay. The list is replaced only when the receiver's has elements.
    void copyTo(Derived& target) const;
    void mergeFrom(const ProtoCodable& other) override;
    [[nodiscard]] std::shared_ptr<NSDictionary> dictionaryRepresentation() const override;
    /// The same class, every field present on both sides or on neither, and present ones equal.
    [[nodiscard]] bool isEqual(const NSObject* object) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// Deep.
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

protected:
    /// A new instance of the receiver's own class.
    [[nodiscard]] virtual std::shared_ptr<Derived> _alloc() const {
        return std::make_shared<Derived>();
    }

    [[nodiscard]] bool hasBit(std::uint32_t bit) const noexcept { return (_has & bit) != 0; }
    void setHasBit(std::uint32_t bit, bool present) noexcept {
        _has = present ? _has | bit : _has & ~bit;
    }
    /// Sets a scalar and its bit.
    template <class Value>
    void assign(Value& field, Value value, std::uint32_t bit) noexcept {
        field = value;
        setHasBit(bit, true);
    }

private:
    [[nodiscard]] Derived& self() { return static_cast<Derived&>(*this); }
    [[nodiscard]] const Derived& self() const { return static_cast<const Derived&>(*this); }

    template <class Visit>
    static void forEachField(Visit&& visit) {
        std::apply([&](const auto&... field) { (visit(field), ...); }, Derived::schema());
    }

    template <class Value>
    bool
    readField(const ProtoScalarField<Derived, Value>& field, ProtoTag tag, ProtoReader& reader);
    bool readField(const ProtoStringField<Derived>& field, ProtoTag tag, ProtoReader& reader);
    template <class Sub>
    bool readField(const ProtoMessageField<Derived, Sub>& field, ProtoTag tag, ProtoReader& reader);
    template <class Sub>
    bool
    readField(const ProtoRepeatedField<Derived, Sub>& field, ProtoTag tag, ProtoReader& reader);
    template <class Sub>
    static std::shared_ptr<Sub> readSubMessage(ProtoReader& reader);

    std::uint32_t _has = 0;
};

} // namespace orvo

#include "platform/protobuf/ProtoMessage.inl.h"
