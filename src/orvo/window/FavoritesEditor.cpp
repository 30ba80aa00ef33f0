#include "orvo/window/FavoritesEditor.h"

#include "orvo/console/DisplayText.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/Exceptions.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

/// The favourite that stands last after one was added.
std::int64_t lastNumber(const FavoritesStore& store, std::shared_ptr<NSError>& error) {
    const auto entries = store.entries(&error);
    return entries.empty() ? 0 : entries.back().number;
}

std::shared_ptr<NSError>
addAgain(FavoritesStore& store, const NSObject& favorite, FavoritesStore::Addition& addition) {
    if (const auto* place = dynamic_cast<const FavoritePlace*>(&favorite))
        return store.addPlace(*place, &addition);
    const auto* line = dynamic_cast<const FavoriteTransitLine*>(&favorite);
    return line && line->transitLine() ? store.addLine(*line->transitLine(), &addition) : nullptr;
}

} // namespace

FavoritesEditor::FavoritesEditor(StoreOpener opener)
    : _opener(std::move(opener))
    , _profile(Environment::profile().get()) {
    if (!_opener)
        throw NSInvalidArgumentException("an editor of favourites needs to open them");
}

FavoritesEditor::~FavoritesEditor() = default;

std::shared_ptr<NSError> FavoritesEditor::reload() {
    const auto profile = Environment::profile().overrideWith(_profile);
    _schedules = nullptr; // another program may have replaced the file
    return read();
}

FavoritesEditor::Search FavoritesEditor::search(const std::string& text) {
    const auto profile = Environment::profile().overrideWith(_profile);
    Search found;
    const auto words = DisplayText::oneLine(text);
    const auto store = schedules(&found.error);
    found.hasSchedules = store && !store->feeds().empty();
    if (!store || words.empty())
        return found;
    auto lines = store->lines(words, &found.error);
    if (lines.empty() && !found.error)
        lines = store->search(words, MostResults, &found.error);
    lines.resize(std::min(lines.size(), MostResults));
    for (const auto& line : lines)
        found.lines.push_back({LineMark::ofLine(line), indexOfLine(line.muid) < _favorites.size()});
    return found;
}

std::shared_ptr<NSError> FavoritesEditor::add(std::uint64_t muid) {
    return change([&](FavoritesStore& store) -> std::shared_ptr<NSError> {
        std::shared_ptr<NSError> error;
        const auto known = schedules(&error);
        if (!known)
            return error;
        const auto line = known->line(muid);
        if (!line)
            return favoritesError(FavoritesError::NotFound, "No schedule has that line any more.");
        return store.addLine(*makeTransitLine(*line));
    });
}

std::shared_ptr<NSError> FavoritesEditor::move(std::size_t index, std::size_t to) {
    if (index >= _entries.size())
        return nullptr;
    return change([&](FavoritesStore& store) { return store.move(_entries[index].number, to); });
}

std::shared_ptr<NSError> FavoritesEditor::remove(std::size_t index) {
    if (index >= _entries.size())
        return nullptr;
    const auto entry = _entries[index];
    return change([&](FavoritesStore& store) {
        auto error = store.remove(entry.number);
        if (!error)
            _removed.push_back({entry.favorite, index});
        return error;
    });
}

std::shared_ptr<NSError> FavoritesEditor::undoRemoval() {
    if (_removed.empty())
        return nullptr;
    return change([&](FavoritesStore& store) {
        const auto removed = _removed.back();
        auto addition = FavoritesStore::Addition::Added;
        auto error = addAgain(store, *removed.favorite, addition);
        if (error)
            return error;
        _removed.pop_back();
        if (addition == FavoritesStore::Addition::AlreadyThere)
            return error;
        const auto number = lastNumber(store, error);
        return error ? error : store.move(number, removed.index);
    });
}

std::size_t FavoritesEditor::indexOfLine(std::uint64_t muid) const {
    const auto found = std::ranges::find_if(
        _favorites, [&](const LineMark& mark) { return muid != 0 && mark.muid == muid; });
    return static_cast<std::size_t>(found - _favorites.begin());
}

std::shared_ptr<NSError> FavoritesEditor::change(const Change& change) {
    const auto profile = Environment::profile().overrideWith(_profile);
    std::shared_ptr<NSError> error;
    const auto store = _opener(FavoritesStore::Access::Write, error);
    if (store)
        error = change(*store);
    const auto unreadable = read();
    return error ? error : unreadable;
}

std::shared_ptr<NSError> FavoritesEditor::read() {
    std::shared_ptr<NSError> error;
    _entries.clear();
    _favorites.clear();
    if (const auto store = _opener(FavoritesStore::Access::Read, error))
        _entries = store->entries(&error);
    for (const auto& entry : _entries)
        _favorites.push_back(markOf(*entry.favorite));
    return error;
}

std::shared_ptr<ScheduleStore> FavoritesEditor::schedules(std::shared_ptr<NSError>* error) {
    if (!_schedules)
        _schedules = ScheduleStore::open(ScheduleStore::defaultPath(), error);
    return _schedules;
}

LineMark FavoritesEditor::markOf(const NSObject& favorite) {
    if (const auto* line = dynamic_cast<const FavoriteTransitLine*>(&favorite);
        line && line->transitLine())
        return LineMark::ofLine(*line->transitLine(), schedules(nullptr).get());
    LineMark mark;
    if (const auto* place = dynamic_cast<const FavoritePlace*>(&favorite)) {
        mark.name = mark.title = DisplayText::oneLine(place->name());
        mark.detail = fmt::format("{:.5g}, {:.5g}", place->latitude(), place->longitude());
    }
    return mark;
}

} // namespace orvo
