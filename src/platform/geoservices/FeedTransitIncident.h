#pragma once

#include "platform/geoservices/TransitIncidentRecord.h"

#include <memory>
#include <optional>
#include <string>

namespace orvo {

/// GTFS-Realtime `Alert.SeverityLevel`, by its numbers.
enum class IncidentSeverity : std::int32_t { Unknown = 1, Info = 2, Warning = 3, Severe = 4 };

/// GTFS-Realtime `Alert.Effect`, by its numbers.
enum class IncidentEffect : std::int32_t {
    NoService = 1,
    ReducedService = 2,
    SignificantDelays = 3,
    Detour = 4,
    AdditionalService = 5,
    ModifiedService = 6,
    OtherEffect = 7,
    UnknownEffect = 8,
    StopMoved = 9,
    NoEffect = 10,
    AccessibilityIssue = 11,
};

/// GTFS-Realtime `Alert.Cause`, by its numbers.
enum class IncidentCause : std::int32_t {
    UnknownCause = 1,
    OtherCause = 2,
    TechnicalProblem = 3,
    Strike = 4,
    Demonstration = 5,
    Accident = 6,
    Holiday = 7,
    Weather = 8,
    Maintenance = 9,
    Construction = 10,
    PoliceActivity = 11,
    MedicalEmergency = 12,
};

/// The GTFS-Realtime name of a value: `NO_SERVICE`. An unlisted number is given as the number.
[[nodiscard]] std::string nameOf(IncidentSeverity severity);
[[nodiscard]] std::string nameOf(IncidentEffect effect);
[[nodiscard]] std::string nameOf(IncidentCause cause);

/// Makes the affected entities of an incident each time somebody asks for them. An incident may
/// concern hundreds of lines that nobody looks at. Immutable; any thread.
class AffectedEntitySource {
public:
    AffectedEntitySource() = default;
    AffectedEntitySource(const AffectedEntitySource&) = delete;
    AffectedEntitySource& operator=(const AffectedEntitySource&) = delete;
    virtual ~AffectedEntitySource() = default;

    [[nodiscard]] virtual std::shared_ptr<NSArray> affectedEntities() const = 0;
};

/// An incident of a public feed, with what the platform's record has no place for. Immutable. One
/// incident has many objects, for its periods and for lines that it concerns in another way: they
/// share what they have in common.
class FeedTransitIncident final : public TransitIncident {
public:
    using Fields = TransitIncidentRecord::Fields;

    struct Details {
        std::string feed; ///< the feed's short name
        IncidentSeverity severity = IncidentSeverity::Unknown;
        IncidentEffect effect = IncidentEffect::UnknownEffect;
        IncidentCause cause = IncidentCause::UnknownCause;
        bool isPartOfLine = false; ///< only stops or trips of the line are concerned
        bool isUnknown = false;    ///< no incident at all: a status that could not be proven
        /// The summary is the whole description: it is given once, and the field
        /// `fullDescription` is nil.
        bool isSummaryWhole = false;
        std::optional<std::string> spokenTitle; ///< as a voice should say it
        std::optional<std::string> link;        ///< a web page about it
        std::optional<std::string> timeZone;    ///< the agency's, an IANA name
        /// Answers instead of the field `affectedEntities`; nil where that one does.
        std::shared_ptr<const AffectedEntitySource> entitySource;
    };

    /// What objects of one incident share. What an occurrence has as well does not count here.
    struct Common {
        Fields fields;
        Details details;
    };

    /// In what they differ.
    struct Occurrence {
        std::shared_ptr<NSDate> startDate;
        std::shared_ptr<NSDate> endDate;
        bool isBlockingIncident = false;
        bool isPartOfLine = false;
        std::optional<std::string> timeZone;
    };

    [[nodiscard]] static std::shared_ptr<FeedTransitIncident>
    initWithFields_details(Fields fields, Details details);
    /// `common` is not nil.
    [[nodiscard]] static std::shared_ptr<FeedTransitIncident>
    initWithCommon_occurrence(std::shared_ptr<const Common> common, Occurrence occurrence);

    [[nodiscard]] Details details() const;
    [[nodiscard]] const std::shared_ptr<const Common>& common() const noexcept { return _common; }
    [[nodiscard]] const Occurrence& occurrence() const noexcept { return _occurrence; }
    [[nodiscard]] IncidentSeverity severity() const noexcept { return _common->details.severity; }
    [[nodiscard]] IncidentEffect effect() const noexcept { return _common->details.effect; }

    [[nodiscard]] std::uint64_t muid() const override { return _common->fields.muid; }
    [[nodiscard]] std::shared_ptr<NSDate> startDate() const override {
        return _occurrence.startDate;
    }
    [[nodiscard]] std::shared_ptr<NSDate> endDate() const override { return _occurrence.endDate; }
    [[nodiscard]] bool isBlockingIncident() const override {
        return _occurrence.isBlockingIncident;
    }
    [[nodiscard]] std::optional<std::string> title() const override {
        return _common->fields.title;
    }
    [[nodiscard]] std::optional<std::string> summary() const override {
        return _common->fields.summary;
    }
    [[nodiscard]] std::optional<std::string> fullDescription() const override {
        return _common->details.isSummaryWhole ? _common->fields.summary
                                               : _common->fields.fullDescription;
    }
    /// Feeds have one short text for whatever a rider is about to do: where the fields have no
    /// message, it is the title.
    [[nodiscard]] std::optional<std::string> messageForRoutePlanning() const override {
        return orTitle(_common->fields.messageForRoutePlanning);
    }
    [[nodiscard]] std::optional<std::string> messageForRouteStepping() const override {
        return orTitle(_common->fields.messageForRouteStepping);
    }
    [[nodiscard]] std::optional<std::string> messageForNonRoutable() const override {
        return orTitle(_common->fields.messageForNonRoutable);
    }
    [[nodiscard]] std::int32_t iconType() const override { return _common->fields.iconType; }
    [[nodiscard]] std::shared_ptr<NSDate> creationDate() const override {
        return _common->fields.creationDate;
    }
    [[nodiscard]] std::shared_ptr<NSDate> lastUpdated() const override {
        return _common->fields.lastUpdated;
    }
    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override {
        return _common->details.entitySource ? _common->details.entitySource->affectedEntities()
                                             : _common->fields.affectedEntities;
    }

private:
    [[nodiscard]] const std::optional<std::string>&
    orTitle(const std::optional<std::string>& message) const noexcept {
        return message ? message : _common->fields.title;
    }

    std::shared_ptr<const Common> _common;
    Occurrence _occurrence;
};

} // namespace orvo
