#include "platform/feeds/alerts/IncidentBuilder.h"

#include "platform/feeds/alerts/AlertSelection.h"
#include "platform/feeds/alerts/ConcernedLines.h"
#include "platform/feeds/alerts/EffectFilter.h"
#include "platform/feeds/alerts/EntityReader.h"
#include "platform/feeds/alerts/IncidentMerger.h"
#include "platform/feeds/alerts/IncidentOrder.h"
#include "platform/feeds/alerts/IncidentRecords.h"
#include "platform/feeds/alerts/LineTable.h"

#include <algorithm>
#include <deque>
#include <fmt/format.h>
#include <functional>
#include <memory_resource>
#include <span>
#include <utility>

namespace orvo {

namespace {

/// One answer in the making.
class Build {
public:
    Build(const std::shared_ptr<const LineTable>& table,
          const std::vector<AlertSource>& sources,
          const IncidentQuery& query)
        : _table(table)
        , _index(table->index())
        , _sources(sources)
        , _query(query)
        , _askedAt(_table->count(), NotAsked) {}

    FeedIncidents run() {
        prepareLines();
        judgeSources();
        buildIncidents(mergeAlerts());
        for (std::size_t i = 0; i < _result.lines.size(); ++i)
            finish(i);
        report();
        return std::move(_result);
    }

private:
    static constexpr std::size_t NotAsked = static_cast<std::size_t>(-1);
    static constexpr std::size_t FirstRoom = std::size_t{64} * 1024; // bytes

    void prepareLines() {
        if (_query.lines) {
            for (const std::uint64_t muid : *_query.lines)
                addLine(muid, _table->placeOf(muid));
        } else {
            for (const ScheduleLine& line : _index.lines())
                addLine(line.muid, static_cast<LineTable::Place>(_result.lines.size()));
        }
    }

    void addLine(std::uint64_t muid, LineTable::Place place) {
        const std::size_t position = _result.lines.size();
        _result.lines.push_back({muid, {}, false});
        _sameAs.push_back(position);
        if (place == LineTable::None)
            return;
        if (_askedAt[place] == NotAsked)
            _askedAt[place] = position;
        else
            _sameAs.back() = _askedAt[place];
    }

    /// Reads the outer structure of each message. When only some lines are asked about, each entity
    /// is looked at on the way, while its bytes are at hand.
    void judgeSources() {
        std::function<void(std::string_view)> look;
        if (_query.lines) {
            _selection.emplace(_index, *_query.lines, _query.stepFree);
            look = [this](std::string_view entity) {
                _selection->look(entity);
            };
        }
        for (const AlertSource& source : _sources) {
            const std::size_t lookedAt = _selection ? _selection->count() : 0;
            _proofs.push_back(SourceProof::judge(source, _query.now, look));
            if (_selection && !_proofs.back().message)
                _selection->truncate(lookedAt);
        }
        if (_selection)
            _selection->choose();
    }

    IncidentMerger::Incidents mergeAlerts() {
        IncidentMerger merger(_index.feed(), _index.language(), &_room);
        _result.sources.resize(_sources.size());
        std::size_t place = 0;
        for (std::size_t source = 0; source < _sources.size(); ++source) {
            if (!_proofs[source].message)
                continue;
            EntityReader reader(_result.sources[source].statistics,
                                _selection ? &_selection->shapes() : nullptr);
            for (const std::string_view entity : _proofs[source].message->entities)
                if (!_selection || _selection->isChosen(place++))
                    mergeAlert(reader.read(entity), source, merger);
        }
        return merger.take();
    }

    void mergeAlert(const AlertReading& reading, std::size_t source, IncidentMerger& merger) {
        _hasLostSelectors = _hasLostSelectors || reading.mayConcernAnyLine;
        if (!reading.alert)
            return;
        const auto against =
            reasonAgainstIncident(reading.alert->effect, reading.alert->severity, _query.stepFree);
        if (against)
            return _result.sources[source].statistics.add(*against);
        _alerts.emplace_back(*reading.alert, &_room);
        merger.add(_alerts.back(), source);
    }

    void buildIncidents(const IncidentMerger::Incidents& incidents) {
        RecordContext context{_index.feed(),
                              _index.timezone(),
                              {},
                              IncidentWording(_query.language, _index.language()),
                              _table,
                              {}};
        for (const SourceProof& proof : _proofs)
            context.headerDates.push_back(NSDate::dateWithTimeIntervalSince1970(proof.headerTime));
        SelectorResolver resolver(*_table, _result.statistics);
        ConcernedLines lines(resolver);
        IncidentRecords records(context);
        for (const Incident& incident : incidents) {
            // Whether a title is only a name can be told when all lines are known.
            if (_selection && !context.wording.mayBeOnlyName(incident, _table->longestName()))
                lines.find(incident);
            else
                lines.findAll(incident);
            buildIncident(incident, lines, records);
        }
        _hasLostStops = resolver.hasLostStops();
        _hasLostSelectors = _hasLostSelectors || lines.lostSelectors() > 0;
        _result.statistics.add(AlertCount::UnreadableSelectors, lines.lostSelectors());
    }

    void
    buildIncident(const Incident& incident, const ConcernedLines& lines, IncidentRecords& records) {
        _result.statistics.add(AlertCount::Incidents);
        _result.statistics.add(AlertCount::RepeatedAlerts, incident.members.size() - 1);
        if (lines.lines().empty() && lines.areAll())
            return _result.statistics.add(AlertCount::AlertsOfNoLine, incident.members.size());
        records.begin(incident, lines);
        std::span<const std::size_t> members; // never none for a line
        for (const ConcernedLines::Line& line : lines.lines()) {
            const std::size_t position = _askedAt[line.place];
            if (position == NotAsked)
                continue;
            // Mostly the same alerts name all lines: what they come to is not worked out again.
            if (!std::ranges::equal(members, lines.membersOf(line))) {
                members = lines.membersOf(line);
                findPeriods(incident, members);
            }
            for (const IncidentPeriod& period : _periods)
                _result.lines[position].incidents.push_back(records.record(line, period));
        }
        if (records.count() == 0 && isOutOfTime(incident))
            _result.statistics.add(AlertCount::AlertsOutOfTime, incident.members.size());
    }

    /// What the periods of some members of an incident come to.
    void findPeriods(const Incident& incident, std::span<const std::size_t> members) {
        _periods.clear();
        for (const std::size_t member : members)
            IncidentPeriods::addOfAlert(*incident.members[member].alert, _periods);
        IncidentPeriods::keepCurrentAndComing(_periods, _query.now);
    }

    /// Whether none of its alerts holds now or within a day.
    [[nodiscard]] bool isOutOfTime(const Incident& incident) {
        for (std::size_t member = 0; member < incident.members.size(); ++member) {
            findPeriods(incident, std::span(&member, 1));
            if (!_periods.empty())
                return false;
        }
        return true;
    }

    /// Puts the line's incidents in order, and says so where its status could not be proven. A
    /// coming incident does not tell how the line runs now, but is worth keeping.
    void finish(std::size_t position) {
        LineIncidents& line = _result.lines[position];
        if (_sameAs[position] != position) {
            line = _result.lines[_sameAs[position]];
            return;
        }
        std::sort(line.incidents.begin(), line.incidents.end(), [](const auto& a, const auto& b) {
            return standsBefore(*a, *b);
        });
        const auto status = statusOf(line);
        if (!status)
            return;
        const ScheduleLine* const known = _index.line(line.muid);
        line.isUnknown = true;
        line.incidents.insert(
            line.incidents.begin(),
            makeUnknownIncident({_index.feed(),
                                 line.muid,
                                 known ? known->agency.name : std::string(),
                                 known && !known->agency.timezone.empty() ? known->agency.timezone
                                                                          : _index.timezone()},
                                *status,
                                _query.now,
                                _query.language));
    }

    /// Why the line's status is unknown; nothing when it is known.
    [[nodiscard]] std::optional<UnknownStatus> statusOf(const LineIncidents& line) const {
        using Reason = UnknownStatus::Reason;
        if (!_index.line(line.muid))
            return UnknownStatus{Reason::LineDeparted, lastKnown(), {}};
        const bool isDisturbed =
            std::any_of(line.incidents.begin(), line.incidents.end(), [&](const auto& incident) {
                const auto& start = incident->occurrence().startDate;
                return !start || start->timeIntervalSince1970() <= _query.now;
            });
        if (isDisturbed)
            return std::nullopt;
        if (_sources.empty())
            return UnknownStatus{Reason::NothingToAsk, std::nullopt, {}};
        for (const SourceProof& proof : _proofs)
            if (proof.error)
                return UnknownStatus{
                    Reason::SourceFailed, lastKnown(), proof.error->localizedDescription()};
        if (_hasLostSelectors)
            return UnknownStatus{Reason::SelectorLost, lastKnown(), {}};
        if (_hasLostStops)
            return UnknownStatus{Reason::SelectorLost,
                                 lastKnown(),
                                 "The schedule could not be asked which lines serve a stop."};
        return std::nullopt;
    }

    /// Since when something is no longer known; nothing when some source was never read.
    [[nodiscard]] std::optional<double> lastKnown() const {
        std::optional<double> oldest;
        for (const SourceProof& proof : _proofs) {
            if (!proof.lastKnown)
                return std::nullopt;
            oldest = oldest ? std::min(*oldest, *proof.lastKnown) : *proof.lastKnown;
        }
        return oldest;
    }

    void report() {
        for (std::size_t i = 0; i < _sources.size(); ++i) {
            AlertSourceReport& source = _result.sources[i];
            source.error = _proofs[i].error;
            source.fetchedAt = _sources[i].fetchedAt;
            if (_proofs[i].message)
                source.headerTime = _proofs[i].headerTime;
            _result.statistics.add(source.statistics);
        }
        // One that is old was read: it says how old it is.
        const auto isRead = [](const SourceProof& proof) {
            return !proof.error ||
                   proof.error->code() == static_cast<std::int64_t>(AlertErrorCode::Stale);
        };
        if (std::any_of(_proofs.begin(), _proofs.end(), isRead))
            return;
        const std::string cause = _proofs.empty() ? "it has no source of alerts"
                                                  : _proofs.front().error->localizedDescription();
        const auto code = _proofs.empty() ? static_cast<std::int64_t>(AlertErrorCode::NoSource)
                                          : _proofs.front().error->code();
        _result.error = NSError::errorWithMessage(
            AlertErrorDomain,
            code,
            fmt::format("The service alerts of {} could not be read: {}", _index.feed(), cause));
    }

    const std::shared_ptr<const LineTable>& _table;
    const LineIndex& _index;
    const std::vector<AlertSource>& _sources;
    const IncidentQuery& _query;
    std::vector<std::size_t> _askedAt; // by place of the line: its first place in the answer
    std::vector<std::size_t> _sameAs;  // by place in the answer: the first place of the same line
    std::optional<AlertSelection> _selection; // nothing when all lines are asked about
    std::vector<SourceProof> _proofs;
    std::pmr::monotonic_buffer_resource _room{FirstRoom};
    std::pmr::deque<Alert> _alerts{&_room}; // incidents point to them
    std::vector<IncidentPeriod> _periods;   // of the incident at hand
    bool _hasLostSelectors = false;
    bool _hasLostStops = false; // selectors with stops may name any line
    FeedIncidents _result;
};

} // namespace

IncidentBuilder::IncidentBuilder(std::shared_ptr<const LineIndex> index)
    : _table(std::make_shared<LineTable>(std::move(index))) {}

FeedIncidents IncidentBuilder::build(const std::vector<AlertSource>& sources,
                                     const IncidentQuery& query) const {
    return Build(_table, sources, query).run();
}

} // namespace orvo
