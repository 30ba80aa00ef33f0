#include "platform/feeds/_FeedFile.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"

namespace orvo::_FeedFile {

namespace {

using TextEntries = std::vector<std::pair<std::string, std::shared_ptr<NSObject>>>;
using Objects = NSArray::Elements;

std::string text(const NSDictionary& entries, const char* key) {
    return stringValue(entries.objectForKey(key).get()).value_or("");
}

/// The elements under `key` that are of class T; none when there is no array.
template <class T>
std::vector<std::shared_ptr<T>> list(const NSDictionary& entries, const char* key) {
    std::vector<std::shared_ptr<T>> found;
    if (const auto array = std::dynamic_pointer_cast<NSArray>(entries.objectForKey(key)))
        for (const auto& element : array->elements())
            if (auto object = std::dynamic_pointer_cast<T>(element))
                found.push_back(std::move(object));
    return found;
}

std::shared_ptr<NSArray> pairList(const SourceRequest::Pairs& pairs) {
    Objects objects;
    for (const auto& [name, value] : pairs) {
        objects.push_back(NSString::string(name));
        objects.push_back(NSString::string(value));
    }
    return NSArray::arrayWithObjects(std::move(objects));
}

SourceRequest::Pairs readPairs(const NSDictionary& entries, const char* key) {
    SourceRequest::Pairs pairs;
    const auto texts = list<NSString>(entries, key);
    for (std::size_t index = 0; index + 1 < texts.size(); index += 2)
        pairs.emplace_back(texts[index]->utf8(), texts[index + 1]->utf8());
    return pairs;
}

void addSecretsOf(const std::string& feed, const SourceRequest& source, Objects& objects) {
    if (!source.hasSecrets())
        return;
    TextEntries entries{{"feed", NSString::string(feed)},
                        {"location", NSString::string(source.location)},
                        {"headers", pairList(source.headers)},
                        {"query", pairList(source.query)}};
    if (source.userPassword)
        entries.emplace_back("userPassword", NSString::string(*source.userPassword));
    objects.push_back(NSDictionary::dictionaryWithTextKeys(std::move(entries)));
}

void readSecrets(const NSDictionary& entries, SourceRequest& source) {
    if (source.location != text(entries, "location"))
        return;
    source.headers = readPairs(entries, "headers");
    source.query = readPairs(entries, "query");
    source.userPassword = stringValue(entries.objectForKey("userPassword").get());
}

} // namespace

std::shared_ptr<NSDictionary> feeds(const std::vector<FeedConfiguration>& feeds) {
    Objects objects;
    for (const auto& feed : feeds) {
        Objects alerts;
        for (const auto& source : feed.alerts)
            alerts.push_back(NSString::string(source.location));
        TextEntries entries{{"name", NSString::string(feed.name)},
                            {"schedule", NSString::string(feed.schedule.location)},
                            {"alerts", NSArray::arrayWithObjects(std::move(alerts))}};
        if (feed.lastScheduleCheck)
            entries.emplace_back("lastScheduleCheck",
                                 NSDate::dateWithTimeIntervalSince1970(*feed.lastScheduleCheck));
        objects.push_back(NSDictionary::dictionaryWithTextKeys(std::move(entries)));
    }
    return NSDictionary::dictionaryWithTextKeys(
        {{"feeds", NSArray::arrayWithObjects(std::move(objects))}});
}

std::shared_ptr<NSDictionary> secrets(const std::vector<FeedConfiguration>& feeds) {
    Objects objects;
    for (const auto& feed : feeds) {
        addSecretsOf(feed.name, feed.schedule, objects);
        for (const auto& source : feed.alerts)
            addSecretsOf(feed.name, source, objects);
    }
    return NSDictionary::dictionaryWithTextKeys(
        {{"secrets", NSArray::arrayWithObjects(std::move(objects))}});
}

std::optional<std::vector<FeedConfiguration>> readFeeds(const NSObject* object) {
    const auto* root = dynamic_cast<const NSDictionary*>(object);
    if (!root || !std::dynamic_pointer_cast<NSArray>(root->objectForKey("feeds")))
        return std::nullopt;
    std::vector<FeedConfiguration> found;
    for (const auto& entries : list<NSDictionary>(*root, "feeds")) {
        FeedConfiguration feed;
        feed.name = text(*entries, "name");
        feed.schedule.location = text(*entries, "schedule");
        for (const auto& location : list<NSString>(*entries, "alerts"))
            feed.alerts.push_back({location->utf8(), {}, {}, {}});
        if (const auto date =
                std::dynamic_pointer_cast<NSDate>(entries->objectForKey("lastScheduleCheck")))
            feed.lastScheduleCheck = date->timeIntervalSince1970();
        if (!feed.problem())
            found.push_back(std::move(feed));
    }
    return found;
}

bool addSecrets(const NSObject* object, std::vector<FeedConfiguration>& feeds) {
    const auto* root = dynamic_cast<const NSDictionary*>(object);
    if (!root)
        return false;
    for (const auto& entries : list<NSDictionary>(*root, "secrets")) {
        for (auto& feed : feeds) {
            if (feed.name != text(*entries, "feed"))
                continue;
            readSecrets(*entries, feed.schedule);
            for (auto& source : feed.alerts)
                readSecrets(*entries, source);
        }
    }
    return true;
}

} // namespace orvo::_FeedFile
