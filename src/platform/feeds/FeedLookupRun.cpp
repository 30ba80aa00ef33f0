#include "platform/feeds/FeedLookupRun.h"

#include "platform/feeds/schedule/LineMaker.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

const FeedConfiguration* find(const std::vector<FeedConfiguration>& feeds,
                              const std::string& name) {
    const auto found = std::ranges::find(feeds, name, &FeedConfiguration::name);
    return found == feeds.end() ? nullptr : &*found;
}

std::optional<double> knownAt(const ScheduleLine& line) {
    return line.knownAt > 0 ? std::optional(line.knownAt) : std::nullopt;
}

/// A line of which nothing is known but its number.
std::shared_ptr<FeedTransitLine> namelessLine(std::uint64_t muid) {
    TransitLineRecord::Fields fields;
    fields.muid = muid;
    fields.identifier = MapItemIdentifier::identifierWithMuid(muid);
    return FeedTransitLine::initWithFields_origin(std::move(fields), {});
}

} // namespace

FeedLookupRun::FeedLookupRun(FeedLookup::Ground ground,
                             Question question,
                             FeedLookup::Completion completion)
    : _ground(std::move(ground))
    , _completion(std::move(completion))
    , _question(std::move(question)) {}

void FeedLookupRun::start() {
    DispatchQueue::globalQueue()->async([run = shared_from_this()] { run->begin(); });
}

void FeedLookupRun::begin() {
    if (const auto* lines = std::get_if<LineNumbers>(&_question))
        _wanted = *lines;
    if (!_wanted.empty() || std::holds_alternative<AllLines>(_question))
        _answer.error = plan();
    if (_answer.error)
        _feeds.clear();
    load();
}

std::shared_ptr<NSError> FeedLookupRun::plan() {
    std::shared_ptr<NSError> error;
    const auto all = _ground.feeds(&error);
    if (error)
        return error;
    const auto schedules = _ground.schedules(&error);
    if (!schedules)
        return error;
    if (const auto* wanted = std::get_if<AllLines>(&_question))
        return planFeeds(*wanted, all, *schedules);
    return planLines(all, *schedules);
}

std::shared_ptr<NSError> FeedLookupRun::planFeeds(const AllLines& wanted,
                                                  const std::vector<FeedConfiguration>& all,
                                                  const ScheduleStore& schedules) {
    std::vector<std::string> names;
    std::ranges::transform(all, std::back_inserter(names), &FeedConfiguration::name);
    for (const auto& name : wanted.feeds.value_or(names)) {
        const auto* configuration = find(all, name);
        if (!configuration)
            return NSError::errorWithMessage(FeedErrorDomain,
                                             static_cast<std::int64_t>(FeedErrorCode::UnknownFeed),
                                             fmt::format("There is no feed {}.", name));
        std::shared_ptr<NSError> unread;
        LineNumbers lines;
        for (const auto& line : schedules.lines(name, &unread)) {
            lines.push_back(line.muid);
            _wanted.push_back(line.muid);
            _lines[line.muid] = {makeTransitLine(line), line.agency.timezone, knownAt(line), {}};
        }
        if (!unread)
            unread = addFeed(*configuration, std::move(lines), schedules);
        if (unread)
            return unread;
    }
    return nullptr;
}

/// What cannot be read of the schedules leaves its lines unknown; nothing is answered where that is
/// all of them.
std::shared_ptr<NSError> FeedLookupRun::planLines(const std::vector<FeedConfiguration>& all,
                                                  const ScheduleStore& schedules) {
    LinesOfFeeds linesOfFeeds;
    for (const auto muid : _wanted) {
        if (!_lines.contains(muid))
            _lines[muid] = lineOf(muid, schedules, linesOfFeeds);
    }
    for (const auto& configuration : all) {
        const auto lines = linesOfFeeds.find(configuration.name);
        if (lines == linesOfFeeds.end())
            continue;
        if (const auto unread = addFeed(configuration, lines->second, schedules)) {
            for (const auto muid : lines->second)
                _lines[muid].unread = unread;
        }
    }
    const bool isAnyRead =
        std::ranges::any_of(_lines, [](const auto& line) { return !line.second.unread; });
    return isAnyRead ? nullptr : _lines.at(_wanted.front()).unread;
}

FeedLookupRun::Line FeedLookupRun::lineOf(std::uint64_t muid,
                                          const ScheduleStore& schedules,
                                          LinesOfFeeds& linesOfFeeds) const {
    std::shared_ptr<NSError> unread;
    if (const auto line = schedules.line(muid, &unread)) {
        auto& lines = linesOfFeeds[line->feed];
        if (line->present)
            lines.push_back(muid);
        return {makeTransitLine(*line), line->agency.timezone, knownAt(*line), {}};
    }
    auto kept = _ground.lastKnownLine(muid);
    if (kept && !unread)
        (void)linesOfFeeds[kept->origin().feed]; // the feed is asked, though not for this line
    return {kept ? std::move(kept) : namelessLine(muid), {}, {}, std::move(unread)};
}

std::shared_ptr<NSError> FeedLookupRun::addFeed(const FeedConfiguration& configuration,
                                                LineNumbers lines,
                                                const ScheduleStore& schedules) {
    Feed feed;
    feed.configuration = configuration;
    feed.lines = std::move(lines);
    feed.sources.resize(configuration.alerts.size());
    std::shared_ptr<NSError> unread;
    feed.index = schedules.lineIndex(configuration.name, &unread);
    if (unread)
        return unread;
    feed.hasSchedule = feed.index != nullptr;
    if (!feed.index) {
        LineIndex::Contents contents;
        contents.feed = configuration.name;
        feed.index = std::make_shared<const LineIndex>(std::move(contents));
    }
    _feeds.push_back(std::move(feed));
    return nullptr;
}

void FeedLookupRun::load() {
    // One more than there are sources, so that it is not over before all were asked.
    _awaited = 1;
    for (const auto& feed : _feeds)
        _awaited += feed.sources.size();
    for (auto& feed : _feeds) {
        for (std::size_t index = 0; index < feed.sources.size(); ++index) {
            auto& source = feed.sources[index];
            _ground.load(
                feed.configuration.alerts[index],
                [run = shared_from_this(), &source](SourceBody body) {
                    source = {std::move(body.bytes), body.fetchedAt, std::move(body.error)};
                    run->sourceArrived();
                });
        }
    }
    sourceArrived();
}

void FeedLookupRun::sourceArrived() {
    if (--_awaited == 0)
        DispatchQueue::globalQueue()->async([run = shared_from_this()] { run->answer(); });
}

void FeedLookupRun::answer() {
    _moment.now = NSDate::date()->timeIntervalSince1970();
    _moment.language = Text::locale().get();
    _moment.stepFree = !_feeds.empty() && _ground.asksForStepFree();
    _answer.at = _moment.now;
    for (const auto& feed : _feeds)
        judge(feed);
    if (!_answer.error)
        _answer.error = errorOfAllFeeds();
    if (!_answer.error)
        std::ranges::transform(
            _wanted, std::back_inserter(_answer.items), [&](auto muid) { return itemOf(muid); });
    _completion(_answer);
}

void FeedLookupRun::judge(const Feed& feed) {
    auto query = _moment;
    // Asked for all lines, every entity is read and counted, also what concerns none of them.
    if (!std::holds_alternative<AllLines>(_question))
        query.lines = feed.lines;
    auto incidents = IncidentBuilder(feed.index).build(feed.sources, query);
    FeedStatistics statistics;
    statistics.feed = feed.configuration.name;
    statistics.hasSchedule = feed.hasSchedule;
    statistics.lines = incidents.lines.size();
    statistics.sources = std::move(incidents.sources);
    statistics.alerts = incidents.statistics;
    statistics.error = std::move(incidents.error);
    for (auto& line : incidents.lines) {
        if (line.isUnknown)
            ++statistics.unknownLines;
        else if (!line.incidents.empty())
            ++statistics.linesWithIncidents;
        _known[line.muid] = std::move(line);
    }
    _answer.feeds.push_back(std::move(statistics));
}

std::shared_ptr<NSError> FeedLookupRun::errorOfAllFeeds() const {
    const auto& feeds = _answer.feeds;
    if (feeds.empty() ||
        std::ranges::any_of(feeds, [](const FeedStatistics& feed) { return !feed.error; }))
        return nullptr;
    if (feeds.size() == 1)
        return feeds.front().error;
    std::string message;
    for (const auto& feed : feeds)
        message += (message.empty() ? "" : "\n") + feed.error->localizedDescription();
    return NSError::errorWithMessage(
        FeedLookupErrorDomain, FeedLookupErrorNoFeedReadable, std::move(message));
}

std::shared_ptr<FeedTransitLineItem> FeedLookupRun::itemOf(std::uint64_t muid) const {
    const auto& line = _lines.at(muid);
    TransitLineItemRecord::Service service;
    service.hasIncidentComponent = true;
    service.incidents = incidentsOf(line);
    return FeedTransitLineItem::initWithFields_service_origin(
        line.line->fields(), std::move(service), line.line->origin());
}

std::shared_ptr<NSArray> FeedLookupRun::incidentsOf(const Line& line) const {
    const auto muid = line.line->muid();
    if (const auto known = _known.find(muid); known != _known.end())
        return NSArray::arrayOf(known->second.incidents);
    const auto system = line.line->system();
    const UnknownLine unknown{line.line->origin().feed,
                              muid,
                              (system ? system->name() : std::nullopt).value_or(std::string()),
                              line.timeZone};
    UnknownStatus status;
    status.reason =
        line.unread ? UnknownStatus::Reason::ScheduleUnread : UnknownStatus::Reason::LineDeparted;
    status.lastKnown = line.knownAt;
    if (line.unread)
        status.cause = line.unread->localizedDescription();
    return NSArray::arrayOf<FeedTransitIncident>(
        {makeUnknownIncident(unknown, status, _moment.now, _moment.language)});
}

} // namespace orvo
