#pragma once

#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLine.h"

namespace orvo {

/// An incident whose every property can be set, for trying out how advisories look. Not
/// synchronised.
class DebugTransitIncident final : public virtual TransitIncident {
public:
    /// Numbers 0, texts and objects nil.
    [[nodiscard]] static std::shared_ptr<DebugTransitIncident> init();
    /// A made-up incident of the line, current for a day before and after now.
    [[nodiscard]] static std::shared_ptr<DebugTransitIncident>
    __debug_fakeIncidentAffectingLine(const std::shared_ptr<TransitLine>& line);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    void setMuid(std::uint64_t muid) { _muid = muid; }
    [[nodiscard]] std::shared_ptr<NSDate> startDate() const override { return _startDate; }
    void setStartDate(std::shared_ptr<NSDate> date) { _startDate = std::move(date); }
    [[nodiscard]] std::shared_ptr<NSDate> endDate() const override { return _endDate; }
    void setEndDate(std::shared_ptr<NSDate> date) { _endDate = std::move(date); }
    [[nodiscard]] bool isBlockingIncident() const override { return _blockingIncident; }
    void setBlockingIncident(bool blocking) { _blockingIncident = blocking; }

    [[nodiscard]] std::optional<std::string> title() const override { return _title; }
    void setTitle(std::optional<std::string> text) { _title = std::move(text); }
    [[nodiscard]] std::optional<std::string> summary() const override { return _summary; }
    void setSummary(std::optional<std::string> text) { _summary = std::move(text); }
    [[nodiscard]] std::optional<std::string> fullDescription() const override {
        return _fullDescription;
    }
    void setFullDescription(std::optional<std::string> text) { _fullDescription = std::move(text); }
    [[nodiscard]] std::optional<std::string> messageForRoutePlanning() const override {
        return _messageForRoutePlanning;
    }
    void setMessageForRoutePlanning(std::optional<std::string> text) {
        _messageForRoutePlanning = std::move(text);
    }
    [[nodiscard]] std::optional<std::string> messageForRouteStepping() const override {
        return _messageForRouteStepping;
    }
    void setMessageForRouteStepping(std::optional<std::string> text) {
        _messageForRouteStepping = std::move(text);
    }
    [[nodiscard]] std::optional<std::string> messageForNonRoutable() const override {
        return _messageForNonRoutable;
    }
    void setMessageForNonRoutable(std::optional<std::string> text) {
        _messageForNonRoutable = std::move(text);
    }

    [[nodiscard]] std::int32_t iconType() const override { return _iconType; }
    void setIconType(std::int32_t type) { _iconType = type; }
    [[nodiscard]] std::shared_ptr<NSDate> creationDate() const override { return _creationDate; }
    void setCreationDate(std::shared_ptr<NSDate> date) { _creationDate = std::move(date); }
    [[nodiscard]] std::shared_ptr<NSDate> lastUpdated() const override { return _lastUpdated; }
    void setLastUpdated(std::shared_ptr<NSDate> date) { _lastUpdated = std::move(date); }
    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override {
        return _affectedEntities;
    }
    void setAffectedEntities(std::shared_ptr<NSArray> entities) {
        _affectedEntities = std::move(entities);
    }

private:
    // Dates and arrays are immutable: to keep one is to copy it.
    std::uint64_t _muid = 0;
    std::shared_ptr<NSDate> _startDate;
    std::shared_ptr<NSDate> _endDate;
    bool _blockingIncident = false;
    std::optional<std::string> _title;
    std::optional<std::string> _summary;
    std::optional<std::string> _fullDescription;
    std::optional<std::string> _messageForRoutePlanning;
    std::optional<std::string> _messageForRouteStepping;
    std::optional<std::string> _messageForNonRoutable;
    std::int32_t _iconType = 0;
    std::shared_ptr<NSDate> _creationDate;
    std::shared_ptr<NSDate> _lastUpdated;
    std::shared_ptr<NSArray> _affectedEntities;
};

} // namespace orvo
