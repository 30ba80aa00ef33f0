#include "orvo/FeedsListCommand.h"

#include "orvo/FeedChoice.h"
#include "orvo/JsonParts.h"
#include "orvo/console/PeriodText.h"
#include "orvo/console/TextTable.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

/// Nothing where the schedule does not say.
std::optional<std::string> textOrNull(const std::optional<ScheduleInfo>& info,
                                      std::string ScheduleInfo::*member) {
    return info && !((*info).*member).empty() ? std::optional((*info).*member) : std::nullopt;
}

/// By feed, in its place among them; nothing for one without a schedule.
using Infos = std::vector<std::optional<ScheduleInfo>>;

/// Nothing for all, with the reason in `error`, when the schedules cannot be read.
Infos infosOf(const std::vector<FeedConfiguration>& feeds,
              CommandContext& context,
              std::shared_ptr<NSError>& error) {
    Infos infos(feeds.size());
    std::shared_ptr<NSError> unread;
    const auto schedules = context.schedules(unread);
    for (std::size_t place = 0; !unread && place < feeds.size(); ++place)
        infos[place] = schedules->info(feeds[place].name, &unread);
    if (!unread)
        return infos;
    error = unread;
    return Infos(feeds.size());
}

/// Null for nothing.
template <class T>
void add(JsonWriter& json, const char* key, const std::optional<T>& value) {
    json.key(key);
    if (value)
        json.value(*value);
    else
        json.null();
}

/// What is not known is null, never 0 or false. `areKnown`: whether the schedules could be read; a
/// feed without one has no lines then.
std::string json(const FeedChoice& choice, const Infos& infos, bool areKnown, double now) {
    const auto none = areKnown ? std::optional<std::int64_t>(0) : std::nullopt;
    JsonWriter json;
    json.beginObject().key("feeds").beginArray();
    for (std::size_t place = 0; place < choice.feeds.size(); ++place) {
        const auto& feed = choice.feeds[place];
        const auto& info = infos[place];
        json.beginObject();
        json.key("name").value(feed.name);
        add(json, "lines", info ? info->lines : none);
        add(json, "agencies", info ? info->agencies : none);
        json.key("version").value(textOrNull(info, &ScheduleInfo::version));
        json.key("start_date").value(textOrNull(info, &ScheduleInfo::startDate));
        json.key("end_date").value(textOrNull(info, &ScheduleInfo::endDate));
        add(json, "run_out", areKnown ? std::optional(info && info->hasRunOut(now)) : std::nullopt);
        JsonParts::addTime(json, "imported", info ? std::optional(info->importedAt) : std::nullopt);
        JsonParts::addTime(json, "checked", feed.lastScheduleCheck);
        json.key("static").value(feed.schedule.displayLocation());
        json.key("alerts").beginArray();
        for (const auto& source : feed.alerts)
            json.value(source.displayLocation());
        json.endArray().endObject();
    }
    json.endArray();
    JsonParts::addError(json, choice.error);
    return json.endObject().text();
}

std::string validity(const std::optional<ScheduleInfo>& info, double now) {
    if (!info)
        return "no schedule";
    if (info->hasRunOut(now))
        return "ran out on " + info->endDate;
    return info->endDate.empty() ? "open" : "until " + info->endDate;
}

std::string checked(const FeedConfiguration& feed, double now) {
    if (!feed.lastScheduleCheck)
        return "never";
    return PeriodText::age(now - *feed.lastScheduleCheck) + " ago";
}

} // namespace

CommandSpec FeedsListCommand::spec() const {
    return {.path = {"feeds", "list"},
            .summary = "List the feeds",
            .description = "With their schedules, how long those are valid, when a newer one was "
                           "last asked for, and where the alerts come from.",
            .options = {{"json", "", "print JSON"}},
            .examples = {{"orvo feeds list", "all feeds"}}};
}

ExitCode FeedsListCommand::run(const Arguments& arguments, CommandContext& context) {
    auto choice = FeedChoice::of({}, context);
    std::shared_ptr<NSError> unread;
    const auto infos = infosOf(choice.feeds, context, unread);
    if (!choice.error)
        choice.error = unread;
    const double now = context.now();
    if (arguments.has("json"))
        context.terminal().output() << json(choice, infos, !unread, now);
    if (choice.error)
        return context.fail(*choice.error);
    if (arguments.has("json"))
        return ExitCode::Answered;
    if (choice.feeds.empty())
        context.terminal().note("No feeds yet. Add one with: orvo feeds add");
    TextTable table({{"Feed", TextTable::Column::Alignment::Left, false},
                     {"Lines", TextTable::Column::Alignment::Right, false},
                     {"Schedule", TextTable::Column::Alignment::Left, false},
                     {"Checked", TextTable::Column::Alignment::Left, false},
                     {"Static"},
                     {"Alerts"}});
    for (std::size_t place = 0; place < choice.feeds.size(); ++place) {
        const auto& feed = choice.feeds[place];
        const auto& info = infos[place];
        std::string alerts;
        for (const auto& source : feed.alerts)
            alerts += (alerts.empty() ? "" : " ") + source.displayLocation();
        table.addRow({feed.name,
                      fmt::format("{}", info ? info->lines : 0),
                      validity(info, now),
                      checked(feed, now),
                      feed.schedule.displayLocation(),
                      alerts});
    }
    if (!table.isEmpty())
        table.print(context.terminal());
    return ExitCode::Answered;
}

} // namespace orvo
