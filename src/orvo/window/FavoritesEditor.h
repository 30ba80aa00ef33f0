#pragma once

#include "orvo/window/LineMark.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/foundation/Environment.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace orvo {

class ScheduleStore;

/// The person's favourites while they are edited in a window: what is shown, and each change, which
/// is kept at once. It keeps to the profile that was in use when it was made. What the store holds
/// is read anew after each change, since others may write it too. Main thread.
class FavoritesEditor {
public:
    /// Opens the favourites of the profile in use; nil, with the reason in `error`, when it cannot.
    using StoreOpener = std::function<std::shared_ptr<FavoritesStore>(
        FavoritesStore::Access access, std::shared_ptr<NSError>& error)>;

    /// A line that a search found.
    struct Result {
        LineMark line;
        bool isFavorite = false;
    };
    struct Search {
        std::vector<Result> lines; ///< the best first, at most `MostResults`
        bool hasSchedules = true;  ///< whether there is any to be searched
        std::shared_ptr<NSError> error;
    };
    static constexpr std::size_t MostResults = 50;

    /// Nothing is read before `reload()`. @throws NSInvalidArgumentException for an empty opener
    explicit FavoritesEditor(StoreOpener opener);
    FavoritesEditor(const FavoritesEditor&) = delete;
    FavoritesEditor& operator=(const FavoritesEditor&) = delete;
    ~FavoritesEditor();

    /// Lines and places in the person's order, as last read.
    [[nodiscard]] const std::vector<LineMark>& favorites() const noexcept { return _favorites; }
    /// Nil, or why they cannot be read; then there are none.
    [[nodiscard]] std::shared_ptr<NSError> reload();

    /// Lines by words of their names, or all of a feed by its name. No lines for a text of blanks.
    [[nodiscard]] Search search(const std::string& text);

    /// Each answers nil, or why nothing was changed. An index of no favourite changes nothing.
    ///
    /// At the end; one that is a favourite already stays where it is.
    [[nodiscard]] std::shared_ptr<NSError> add(std::uint64_t muid);
    /// `to` is the index that it has afterwards; beyond the last is the last.
    [[nodiscard]] std::shared_ptr<NSError> move(std::size_t index, std::size_t to);
    [[nodiscard]] std::shared_ptr<NSError> remove(std::size_t index);
    /// Puts the one that was removed last, and not yet put back, in its former place.
    [[nodiscard]] std::shared_ptr<NSError> undoRemoval();
    [[nodiscard]] bool canUndoRemoval() const noexcept { return !_removed.empty(); }

    /// The index of a line; the number of favourites where it is none.
    [[nodiscard]] std::size_t indexOfLine(std::uint64_t muid) const;

private:
    struct Removed {
        std::shared_ptr<NSObject> favorite;
        std::size_t index = 0;
    };
    using Change = std::function<std::shared_ptr<NSError>(FavoritesStore& store)>;

    [[nodiscard]] std::shared_ptr<NSError> change(const Change& change);
    [[nodiscard]] std::shared_ptr<NSError> read();
    [[nodiscard]] std::shared_ptr<ScheduleStore> schedules(std::shared_ptr<NSError>* error);
    [[nodiscard]] LineMark markOf(const NSObject& favorite);

    StoreOpener _opener;
    ProfileFolders _profile;
    std::shared_ptr<ScheduleStore> _schedules;
    std::vector<FavoritesStore::Entry> _entries;
    std::vector<LineMark> _favorites; ///< of `_entries`, one by one
    std::vector<Removed> _removed;    ///< the latest last
};

} // namespace orvo
