#pragma once

#include "platform/geoservices/TransitLineItem.h"
#include "platform/geoservices/TransitLineRecord.h"

namespace orvo {

/// A line item as a plain immutable value.
class TransitLineItemRecord : public TransitLineRecord, public virtual TransitLineItem {
public:
    struct Service {
        std::shared_ptr<NSArray> incidents;
        bool isIncidentsTTLExpired = false;
        bool hasIncidentComponent = false;
        bool hasEncyclopedicInfo = false;
        std::shared_ptr<NSObject> encyclopedicInfo;
    };

    [[nodiscard]] static std::shared_ptr<TransitLineItemRecord>
    initWithFields_service(Fields line, Service service);

    [[nodiscard]] std::shared_ptr<NSArray> incidents() const override { return _service.incidents; }
    [[nodiscard]] bool isIncidentsTTLExpired() const override {
        return _service.isIncidentsTTLExpired;
    }
    [[nodiscard]] bool hasIncidentComponent() const override {
        return _service.hasIncidentComponent;
    }
    [[nodiscard]] bool hasEncyclopedicInfo() const override { return _service.hasEncyclopedicInfo; }
    [[nodiscard]] std::shared_ptr<NSObject> encyclopedicInfo() const override {
        return _service.encyclopedicInfo;
    }

protected:
    void _initWithFields_service(Fields line, Service service);

private:
    Service _service;
};

} // namespace orvo
