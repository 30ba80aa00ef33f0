#pragma once

#include "platform/feeds/alerts/Alert.h"
#include "platform/feeds/alerts/AlertStatistics.h"

#include <array>
#include <cstddef>
#include <memory_resource>
#include <optional>
#include <string_view>

namespace orvo {

class SelectorShapes;
class WireCursor;

/// What one entity holds.
struct AlertReading {
    /// Nothing for an entity that holds no alert, was deleted, or breaks off before its alert.
    std::optional<Alert> alert;
    /// Whether selectors may be missing: the entity, its alert or one of its selectors could not be
    /// read, so that it may concern any line of its feed.
    bool mayConcernAnyLine = false;
};

/// Reads the entities of one message. A field that is bad costs only itself and is counted. Text is
/// checked to be UTF-8. What repeats is read up to a limit over the whole message, so that no body
/// costs many times its own size.
class EntityReader {
public:
    /// @param passedOver selectors that need not be read: those that fit these shapes, and name
    /// none of their wanted routes. Nil to read all.
    ///
    /// Statistics and shapes outlive the reader.
    explicit EntityReader(AlertStatistics& statistics, const SelectorShapes* passedOver = nullptr)
        : _statistics(statistics)
        , _passedOver(passedOver) {}
    EntityReader(const EntityReader&) = delete;
    EntityReader& operator=(const EntityReader&) = delete;
    ~EntityReader() = default;

    /// The alert is valid until the next is read: who keeps it, copies it.
    [[nodiscard]] AlertReading read(std::string_view entity);

    /// Reads one informed_entity into an empty selector. False when anything of it could not be
    /// read: all its fields hold together, so that one without a bad field would name more than
    /// the feed meant.
    [[nodiscard]] static bool readSelector(std::string_view bytes, AlertSelector& selector);
    /// Appends the selectors among some fields of alerts, without those that are empty or cannot be
    /// read.
    static void readSelectors(std::string_view fields, AlertSelectors& selectors);
    /// Takes the number of an effect or a severity; an unlisted one changes nothing.
    /// @return whether it is listed
    static bool readEffect(std::uint64_t number, std::int32_t& effect) noexcept;
    static bool readSeverity(std::uint64_t number, std::int32_t& severity) noexcept;

private:
    void readAlert(std::string_view bytes, AlertReading& reading);
    void passOver(WireCursor& cursor, Alert& alert);
    void readPassedOver(Alert& alert);
    void addSelectorFields(const char* begin, const char* end);
    void readAlertField(const WireCursor& field, AlertReading& reading);
    void readPeriod(const WireCursor& field, AlertPeriods& periods);
    void addUnreadPeriod(AlertPeriods& periods);
    void takeSelector(const WireCursor& field, AlertReading& reading);
    void readNumber(const WireCursor& field,
                    bool (*take)(std::uint64_t, std::int32_t&) noexcept,
                    std::int32_t& number);
    void readTexts(const WireCursor& field, AlertTexts& texts);
    void readText(std::string_view bytes, AlertTexts& texts);
    [[nodiscard]] bool takeOne() noexcept;

    AlertStatistics& _statistics;
    const SelectorShapes* _passedOver;
    // Large enough for the lists of most alerts.
    std::array<std::byte, 16384> _firstRoom{};
    std::pmr::monotonic_buffer_resource _room{_firstRoom.data(), _firstRoom.size()};
    // Of the entity being read.
    AlertSelectors _selectors;
    std::string_view _selectorFields;
    bool _mayPassOver = false;
    std::size_t _repeatsLeft = 1'000'000;
};

} // namespace orvo
