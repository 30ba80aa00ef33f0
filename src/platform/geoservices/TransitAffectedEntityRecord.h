#pragma once

#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <utility>

namespace orvo {

/// A concerned line as a plain immutable value.
class TransitAffectedEntityRecord : public virtual TransitIncidentAffectedEntity {
public:
    struct Fields {
        std::uint64_t muid = 0;
        bool hasNextStopIDs = false;
        std::shared_ptr<NSOrderedSet> nextStopIDs;
    };

    [[nodiscard]] static std::shared_ptr<TransitAffectedEntityRecord> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }

    [[nodiscard]] std::uint64_t muid() const override { return _fields.muid; }
    [[nodiscard]] bool hasNextStopIDs() const override { return _fields.hasNextStopIDs; }
    [[nodiscard]] std::shared_ptr<NSOrderedSet> nextStopIDs() const override {
        return _fields.nextStopIDs;
    }

protected:
    void _initWithFields(Fields fields) { _fields = std::move(fields); }

private:
    Fields _fields;
};

} // namespace orvo
