#include "platform/feeds/alerts/AlertReader.h"

#include "platform/feeds/alerts/WireCursor.h"

#include <algorithm>
#include <string>
#include <utility>

namespace orvo {

namespace {

/// No feed has nearly as many; a body made of empty ones would cost many times its own size.
constexpr std::size_t MostEntities = 250'000;

/// Room is made for entities of about this size; few are much smaller.
constexpr std::size_t UsualEntity = 512;

namespace MessageField {
constexpr std::uint32_t Header = 1;
constexpr std::uint32_t Entity = 2;
} // namespace MessageField

namespace HeaderField {
constexpr std::uint32_t Version = 1;
constexpr std::uint32_t Incrementality = 2;
constexpr std::uint32_t Timestamp = 3;
} // namespace HeaderField

constexpr std::uint64_t FullDataset = 0; // of incrementality

std::optional<AlertMessage>
failure(std::shared_ptr<NSError>* error, AlertErrorCode code, std::string message) {
    if (error)
        *error = NSError::errorWithMessage(
            AlertErrorDomain, static_cast<std::int64_t>(code), std::move(message));
    return std::nullopt;
}

/// What bytes that are no message look like to a person.
std::string appearance(std::string_view bytes) {
    const std::size_t first = bytes.find_first_not_of(" \t\r\n\xEF\xBB\xBF");
    if (first == std::string_view::npos)
        return "it holds nothing but blanks";
    switch (bytes[first]) {
    case '<':
        return "it is a web page or XML, not GTFS-Realtime";
    case '{':
    case '[':
        return "it is JSON, not GTFS-Realtime";
    default:
        break;
    }
    if (bytes.starts_with("\x1F\x8B"))
        return "it is compressed, not GTFS-Realtime";
    return "it is not GTFS-Realtime";
}

/// What a failed walk of the outer structure means. Text fails anywhere: what it looks like says
/// more than where.
std::optional<AlertMessage> failedWalk(std::shared_ptr<NSError>* error,
                                       std::string_view bytes,
                                       const WireCursor& cursor,
                                       const char* place) {
    const std::string looks = appearance(bytes);
    if (cursor.wasCutShort() && looks == "it is not GTFS-Realtime")
        return failure(
            error, AlertErrorCode::Truncated, std::string("it ends in the middle of ") + place);
    return failure(error, AlertErrorCode::NotAlerts, looks);
}

/// What a header says; nothing when it cannot be walked, or says nothing that a header must or may.
struct Header {
    std::uint64_t timestamp = 0;
    bool isWhole = true; ///< the message, by incrementality
};

std::optional<Header> readHeader(std::string_view bytes) {
    Header header;
    bool saysSomething = false;
    WireCursor cursor(bytes);
    while (cursor.next()) {
        switch (cursor.key()) {
        case WireCursor::bytes(HeaderField::Version):
            saysSomething = true;
            break;
        case WireCursor::number(HeaderField::Incrementality):
            header.isWhole = cursor.number() == FullDataset;
            break;
        case WireCursor::number(HeaderField::Timestamp):
            header.timestamp = cursor.number();
            saysSomething = true;
            break;
        default:
            if (cursor.field() <= HeaderField::Timestamp)
                return std::nullopt;
        }
    }
    return saysSomething && !cursor.failed() ? std::optional(header) : std::nullopt;
}

/// Asks the memory for the bytes that are walked next, while those before are walked. The steps of
/// a walk are of unequal length: no machine sees by itself where the next begins.
class ReadAhead {
public:
    explicit ReadAhead(std::string_view message)
        : _message(message) {}

    void from(const char* position) noexcept {
        const auto walked = static_cast<std::size_t>(position - _message.data());
        const std::size_t end = std::min(walked + Distance, _message.size());
        for (; _asked < end; _asked += CacheLine)
            __builtin_prefetch(&_message[_asked]);
    }

private:
    static constexpr std::size_t CacheLine = 64;
    static constexpr std::size_t Distance = std::size_t{8} * 1024;

    std::string_view _message;
    std::size_t _asked = 0;
};

} // namespace

std::optional<AlertMessage>
AlertReader::read(std::span<const std::uint8_t> data,
                  std::shared_ptr<NSError>* error,
                  const std::function<void(std::string_view entity)>& visit) {
    const std::string_view bytes(reinterpret_cast<const char*>(data.data()), data.size());
    if (bytes.empty())
        return failure(error, AlertErrorCode::Empty, "it is empty");
    AlertMessage message;
    message.entities.reserve(bytes.size() / UsualEntity);
    bool hasHeader = false;
    ReadAhead ahead(bytes);
    WireCursor cursor(bytes);
    while (cursor.next()) {
        if (cursor.key() == WireCursor::bytes(MessageField::Header)) {
            const auto header = readHeader(cursor.bytes());
            if (!header)
                return failure(error, AlertErrorCode::NotAlerts, appearance(bytes));
            if (!header->isWhole)
                return failure(error,
                               AlertErrorCode::Difference,
                               "it tells only what changed since an earlier message");
            message.timestamp = header->timestamp;
            hasHeader = true;
        } else if (cursor.key() == WireCursor::bytes(MessageField::Entity)) {
            if (message.entities.size() == MostEntities)
                return failure(
                    error, AlertErrorCode::NotAlerts, "it has more entries than any feed");
            message.entities.push_back(cursor.bytes());
            ahead.from(cursor.bytes().data() + cursor.bytes().size());
            if (visit)
                visit(cursor.bytes());
        } else if (cursor.field() == MessageField::Header ||
                   cursor.field() == MessageField::Entity) {
            return failure(error, AlertErrorCode::NotAlerts, appearance(bytes));
        }
    }
    if (cursor.failed())
        return failedWalk(error,
                          bytes,
                          cursor,
                          message.entities.empty() ? "its header or first entry" : "an entry");
    if (!hasHeader)
        return failure(error, AlertErrorCode::NoHeader, "it has no GTFS-Realtime header");
    return message;
}

} // namespace orvo
