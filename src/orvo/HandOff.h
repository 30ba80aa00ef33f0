#pragma once

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace orvo {

/// What another program handed over to be shown, as it came: a URL, or the bytes of an activity.
/// They may come from anybody, and are believed only as far as they prove true. Immutable.
class HandOff {
public:
    /// Of an activity's bytes, of what they unfold to, and of a message in them. The widget's are a
    /// hundredth of it.
    static constexpr std::size_t MaximumBytes = std::size_t{4} << 20U;
    /// Incidents, and the lines and stops that each concerns.
    static constexpr std::size_t MaximumRecords = 500'000;

    /// The favourites, for they are what the map has here, or how to add one.
    struct Favorites {};
    /// A line with its incidents. Never nil.
    struct Line {
        std::shared_ptr<TransitStorageLineItem> line;
    };
    /// None is nil.
    struct Incidents {
        std::vector<std::shared_ptr<TransitStorageIncident>> incidents;
    };
    using Content = std::variant<Favorites, Line, Incidents>;

    [[nodiscard]] static HandOff ofURL(std::string url);
    /// An activity as it travels (`encodedUserActivity`); not nil.
    [[nodiscard]] static HandOff ofActivity(std::shared_ptr<NSData> bytes);

    /// Nothing for an activity.
    [[nodiscard]] const std::optional<std::string>& url() const noexcept { return _url; }
    /// Nil for a URL.
    [[nodiscard]] const std::shared_ptr<NSData>& activity() const noexcept { return _activity; }

    /// What it asks to be shown. Nothing, with an error of `HandOffErrorDomain` that names what is
    /// wrong, for anything that the widget would not hand over.
    [[nodiscard]] std::optional<Content> content(std::shared_ptr<NSError>* error) const;

private:
    std::optional<std::string> _url;
    std::shared_ptr<NSData> _activity;
};

} // namespace orvo
