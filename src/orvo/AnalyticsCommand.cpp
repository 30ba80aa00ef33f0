#include "orvo/AnalyticsCommand.h"

#include "orvo/JsonParts.h"
#include "orvo/console/PeriodText.h"
#include "orvo/console/TextTable.h"
#include "platform/geoservices/LocalAnalyticsStore.h"

#include <charconv>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

using Session = StoredAnalyticsSession;
using Action = StoredAnalyticsAction;

constexpr std::int64_t StandardSessions = 20;

std::optional<std::int64_t> count(const std::string& text) {
    std::int64_t value = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, value);
    return result.ec == std::errc() && result.ptr == end && value > 0 ? std::optional(value)
                                                                      : std::nullopt;
}

/// The numbers' meanings are the recorder's.
std::string endOf(const Session& session) {
    switch (session.endState) {
    case 1:
        return fmt::format("tap on row {}", session.tappedItemIndex);
    case 2:
        return "closed";
    default:
        return fmt::format("{}", session.endState);
    }
}

std::string messageOf(std::int64_t type) {
    switch (type) {
    case 1:
        return "no lines";
    case 2:
        return "good service";
    case 3:
        return "one incident";
    case 4:
        return "several incidents";
    default:
        return fmt::format("{}", type);
    }
}

std::string shownOf(const Session& session) {
    if (session.initiallyExpanded)
        return "expanded";
    return session.everExpanded ? "compact, expanded" : "compact";
}

void addSession(JsonWriter& json, const Session& session) {
    json.beginObject();
    JsonParts::addTime(json, "started", session.startedAt);
    json.key("duration").value(session.duration);
    json.key("type").value(session.widgetType);
    json.key("end_state").value(session.endState);
    json.key("was_locked").value(session.wasLocked);
    json.key("initially_expanded").value(session.initiallyExpanded);
    json.key("ever_expanded").value(session.everExpanded);
    json.key("message_type").value(session.messageType);
    json.key("tapped_item_index").value(session.tappedItemIndex);
    json.key("incidents").beginArray();
    for (const auto& item : session.incidents)
        json.beginObject()
            .key("line_muid")
            .value(item.lineMuid)
            .key("title")
            .value(item.incidentTitle)
            .endObject();
    json.endArray().endObject();
}

std::string json(const std::vector<Session>& sessions,
                 const std::vector<Action>& actions,
                 const std::shared_ptr<NSError>& error) {
    JsonWriter json;
    json.beginObject().key("sessions").beginArray();
    for (const auto& session : sessions)
        addSession(json, session);
    json.endArray().key("actions").beginArray();
    for (const auto& action : actions) {
        json.beginObject();
        JsonParts::addTime(json, "at", action.at);
        json.key("action").value(action.action);
        json.key("target").value(action.target);
        json.endObject();
    }
    json.endArray();
    JsonParts::addError(json, error);
    return json.endObject().text();
}

void print(const std::vector<Session>& sessions, const CommandContext& context) {
    TextTable table({{"Started", TextTable::Column::Alignment::Left, false},
                     {"Seconds", TextTable::Column::Alignment::Right, false},
                     {"Shown"},
                     {"Message"},
                     {"Incidents", TextTable::Column::Alignment::Right, false},
                     {"Ended"},
                     {"Locked", TextTable::Column::Alignment::Left, false}});
    for (const auto& session : sessions)
        table.addRow({PeriodText::moment(session.startedAt, context.now(), std::nullopt),
                      fmt::format("{:.1f}", session.duration),
                      shownOf(session),
                      messageOf(session.messageType),
                      fmt::format("{}", session.incidents.size()),
                      endOf(session),
                      session.wasLocked ? "yes" : "no"});
    table.print(context.terminal());
}

} // namespace

CommandSpec AnalyticsCommand::spec() const {
    return {.path = {"analytics"},
            .summary = "List what the widget recorded of its own use",
            .description =
                "Each time that the widget was looked at: when, for how long, what it showed, and "
                "how that ended; the newest first. It lies in your state folder, and nothing of it "
                "ever leaves this machine.",
            .options = {{"limit",
                         "N",
                         fmt::format("how many; {} if you say nothing", StandardSessions)},
                        {"json", "", "print JSON: times in UTC, also the single actions"}},
            .examples = {{"orvo analytics", "the last sessions"},
                         {"orvo analytics --limit 1000 --json", "for a script"}}};
}

ExitCode AnalyticsCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto given = arguments.value("limit");
    const auto limit = given ? count(*given) : StandardSessions;
    if (!limit)
        return context.wrongUsage(fmt::format("--limit cannot be {}", *given),
                                  "Write a number above 0.");
    std::shared_ptr<NSError> error;
    const auto sessions = LocalAnalyticsStore::sessions(*limit, &error);
    const auto actions = error ? std::nullopt : LocalAnalyticsStore::actions(*limit, &error);
    if (arguments.has("json"))
        context.terminal().output() << json(sessions.value_or(std::vector<Session>()),
                                            actions.value_or(std::vector<Action>()),
                                            error);
    if (error)
        return context.fail(*error);
    if (arguments.has("json"))
        return ExitCode::Answered;
    if (!sessions->empty())
        print(*sessions, context);
    else
        context.terminal().note(
            actions->empty() ? "The widget has recorded nothing yet."
                             : "The widget has recorded no session yet, only single actions; "
                               "--json shows them.");
    return ExitCode::Answered;
}

} // namespace orvo
