#pragma once

#include "platform/geoservices/TransitIncident.h"

namespace orvo {

/// An incident as a plain immutable value.
class TransitIncidentRecord : public virtual TransitIncident {
public:
    struct Fields {
        std::uint64_t muid = 0;
        std::shared_ptr<NSDate> startDate;
        std::shared_ptr<NSDate> endDate;
        bool isBlockingIncident = false;
        std::optional<std::string> title;
        std::optional<std::string> summary;
        std::optional<std::string> fullDescription;
        std::optional<std::string> messageForRoutePlanning;
        std::optional<std::string> messageForRouteStepping;
        std::optional<std::string> messageForNonRoutable;
        std::int32_t iconType = 0;
        std::shared_ptr<NSDate> creationDate;
        std::shared_ptr<NSDate> lastUpdated;
        std::shared_ptr<NSArray> affectedEntities;
    };

    [[nodiscard]] static std::shared_ptr<TransitIncidentRecord> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }

    [[nodiscard]] std::uint64_t muid() const override { return _fields.muid; }
    [[nodiscard]] std::shared_ptr<NSDate> startDate() const override { return _fields.startDate; }
    [[nodiscard]] std::shared_ptr<NSDate> endDate() const override { return _fields.endDate; }
    [[nodiscard]] bool isBlockingIncident() const override { return _fields.isBlockingIncident; }
    [[nodiscard]] std::optional<std::string> title() const override { return _fields.title; }
    [[nodiscard]] std::optional<std::string> summary() const override { return _fields.summary; }
    [[nodiscard]] std::optional<std::string> fullDescription() const override {
        return _fields.fullDescription;
    }
    [[nodiscard]] std::optional<std::string> messageForRoutePlanning() const override {
        return _fields.messageForRoutePlanning;
    }
    [[nodiscard]] std::optional<std::string> messageForRouteStepping() const override {
        return _fields.messageForRouteStepping;
    }
    [[nodiscard]] std::optional<std::string> messageForNonRoutable() const override {
        return _fields.messageForNonRoutable;
    }
    [[nodiscard]] std::int32_t iconType() const override { return _fields.iconType; }
    [[nodiscard]] std::shared_ptr<NSDate> creationDate() const override {
        return _fields.creationDate;
    }
    [[nodiscard]] std::shared_ptr<NSDate> lastUpdated() const override {
        return _fields.lastUpdated;
    }
    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override {
        return _fields.affectedEntities;
    }

private:
    Fields _fields;
};

} // namespace orvo
