#include "platform/feeds/alerts/IncidentRecords.h"

#include "platform/feeds/alerts/EntityReader.h"
#include "platform/feeds/alerts/FeedAffectedEntity.h"

#include <algorithm>
#include <mutex>
#include <optional>
#include <utility>

namespace orvo {

namespace {

constexpr std::size_t MostLookedAt = 16;

/// The worst that any of the alerts says.
IncidentSeverity severityOf(const Incident& incident) {
    auto severity = static_cast<std::int32_t>(IncidentSeverity::Unknown);
    for (const IncidentMember& member : incident.members)
        severity = std::max(severity, member.alert->severity);
    return static_cast<IncidentSeverity>(severity);
}

/// The first that any of the alerts tells.
IncidentCause causeOf(const Incident& incident) {
    for (const IncidentMember& member : incident.members)
        if (const auto cause = static_cast<IncidentCause>(member.alert->cause);
            cause != IncidentCause::UnknownCause)
            return cause;
    return IncidentCause::UnknownCause;
}

/// The lines of an incident and their stops, in little space.
class ConcernedEntities final : public AffectedEntitySource {
public:
    explicit ConcernedEntities(const ConcernedLines& lines) {
        std::size_t stops = 0;
        for (const ConcernedLines::Line& line : lines.lines())
            stops += lines.stopsOf(line).size();
        _stops->reserve(stops);
        _lines.reserve(lines.lines().size());
        for (const ConcernedLines::Line& line : lines.lines()) {
            for (const std::string_view stop : lines.stopsOf(line))
                _stops->emplace_back(stop);
            _lines.push_back({line.entry->muid, _stops->size()});
        }
    }

    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override {
        NSArray::Elements entities;
        entities.reserve(_lines.size());
        std::size_t firstStop = 0;
        for (const Line& line : _lines) {
            entities.push_back(FeedAffectedEntity::initWithMuid_stops_firstStop_endStop(
                line.muid, _stops, firstStop, line.endStop));
            firstStop = line.endStop;
        }
        return NSArray::arrayWithObjects(std::move(entities));
    }

private:
    struct Line {
        std::uint64_t muid;
        std::size_t endStop;
    };
    std::vector<Line> _lines;
    std::shared_ptr<std::vector<std::string>> _stops = std::make_shared<std::vector<std::string>>();
};

/// The selectors of an incident as they came, until somebody asks for what they name besides the
/// lines that were asked about: few do. They keep the schedule's lines.
class UnresolvedEntities final : public AffectedEntitySource {
public:
    UnresolvedEntities(std::shared_ptr<const LineTable> table, const Incident& incident)
        : _table(std::move(table)) {
        for (const IncidentMember& member : incident.members)
            _selectorFields += member.alert->selectorFields;
    }

    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override {
        std::call_once(_once, [this] { resolve(); });
        return _resolved->affectedEntities();
    }

private:
    void resolve() const {
        Alert alert;
        EntityReader::readSelectors(_selectorFields, alert.selectors);
        Incident incident;
        incident.members = {{&alert, 0}};
        AlertStatistics unused;
        SelectorResolver resolver(*_table, unused);
        ConcernedLines lines(resolver);
        lines.find(incident);
        _resolved.emplace(lines);
        _table.reset();
        _selectorFields = {};
    }

    mutable std::once_flag _once;
    mutable std::shared_ptr<const LineTable> _table;
    mutable std::string _selectorFields;
    mutable std::optional<ConcernedEntities> _resolved;
};

std::shared_ptr<const AffectedEntitySource> entitySourceOf(const RecordContext& context,
                                                           const Incident& incident,
                                                           const ConcernedLines& lines) {
    if (lines.areAll())
        return std::make_shared<ConcernedEntities>(lines);
    return std::make_shared<UnresolvedEntities>(context.table, incident);
}

std::optional<std::int64_t> earliestStart(const Incident& incident) {
    std::optional<std::int64_t> earliest;
    for (const IncidentMember& member : incident.members)
        if (const auto start = IncidentPeriods::earliestStart(*member.alert);
            start && (!earliest || *start < *earliest))
            earliest = start;
    return earliest;
}

} // namespace

void IncidentRecords::begin(const Incident& incident, const ConcernedLines& lines) {
    _incident = &incident;
    _lines = &lines;
    _common.reset();
    _made.clear();
}

FeedTransitIncident::Common IncidentRecords::makeCommon() const {
    FeedTransitIncident::Common common;
    FeedTransitIncident::Details& details = common.details;
    details.feed = _context.feed;
    details.severity = severityOf(*_incident);
    details.effect = static_cast<IncidentEffect>(_incident->effect);
    details.cause = causeOf(*_incident);
    details.entitySource = entitySourceOf(_context, *_incident, *_lines);
    IncidentTexts texts = _context.wording.textsOf(*_incident, *_lines, details.cause);
    details.isSummaryWhole = texts.isSummaryWhole;
    details.spokenTitle = std::move(texts.spokenTitle);
    details.link = std::move(texts.link);
    FeedTransitIncident::Fields& fields = common.fields;
    fields.muid = _incident->muid;
    fields.title = std::move(texts.title);
    fields.summary = std::move(texts.summary);
    fields.fullDescription = std::move(texts.fullDescription);
    fields.iconType = _incident->effect;
    fields.lastUpdated = latestHeaderDate();
    const auto start = earliestStart(*_incident);
    fields.creationDate = start ? dateOf(start) : fields.lastUpdated;
    return common;
}

std::shared_ptr<NSDate> IncidentRecords::latestHeaderDate() const {
    const auto dateOfMember = [&](const IncidentMember& member) {
        return _context.headerDates[member.source];
    };
    std::shared_ptr<NSDate> latest = dateOfMember(_incident->members.front());
    for (const IncidentMember& member : _incident->members)
        if (const auto date = dateOfMember(member);
            date->timeIntervalSinceReferenceDate() > latest->timeIntervalSinceReferenceDate())
            latest = date;
    return latest;
}

const std::string& IncidentRecords::timeZoneOf(const ConcernedLines::Line& line) const {
    const std::string& own = line.line->agency.timezone;
    return own.empty() ? _context.timeZone : own;
}

std::shared_ptr<FeedTransitIncident> IncidentRecords::made(const ConcernedLines::Line& line,
                                                           const IncidentPeriod& period) const {
    // There are few different ones of an incident, and like ones are asked for in a row.
    const std::size_t looked = std::min(_made.size(), MostLookedAt);
    const auto found = std::find_if(_made.rbegin(),
                                    _made.rbegin() + static_cast<std::ptrdiff_t>(looked),
                                    [&](const Made& made) {
                                        const auto& known = made.record->occurrence();
                                        return made.period == period &&
                                               known.isPartOfLine == line.isPart &&
                                               known.timeZone.value_or("") == timeZoneOf(line);
                                    });
    return found == _made.rbegin() + static_cast<std::ptrdiff_t>(looked) ? nullptr : found->record;
}

std::shared_ptr<NSDate> IncidentRecords::dateOf(const std::optional<std::int64_t>& seconds) const {
    return seconds ? _context.dates.date(*seconds) : nullptr;
}

FeedTransitIncident::Occurrence IncidentRecords::occurrence(const ConcernedLines::Line& line,
                                                            const IncidentPeriod& period) const {
    FeedTransitIncident::Occurrence occurrence;
    occurrence.startDate = dateOf(period.start);
    occurrence.endDate = dateOf(period.end);
    occurrence.isBlockingIncident =
        static_cast<IncidentEffect>(_incident->effect) == IncidentEffect::NoService && !line.isPart;
    occurrence.isPartOfLine = line.isPart;
    if (!timeZoneOf(line).empty())
        occurrence.timeZone = timeZoneOf(line);
    return occurrence;
}

std::shared_ptr<FeedTransitIncident> IncidentRecords::record(const ConcernedLines::Line& line,
                                                             const IncidentPeriod& period) {
    if (auto known = made(line, period))
        return known;
    if (!_common)
        _common = std::make_shared<const FeedTransitIncident::Common>(makeCommon());
    auto record = FeedTransitIncident::initWithCommon_occurrence(_common, occurrence(line, period));
    _made.push_back({period, record});
    return record;
}

} // namespace orvo
