#include "orvo/DamageWatch.h"

#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/PropertyList.h"

#include <fmt/format.h>

namespace orvo {

namespace {

// Favourites are no list: whoever opens them tells of their damage.
constexpr std::string_view Mark = ".plist.damaged-";

std::string reasonOf(const std::filesystem::path& aside) {
    std::shared_ptr<NSError> error;
    const auto bytes = AtomicFile::read(aside, &error);
    if (bytes)
        (void)PropertyList::read(bytes->bytes(), &error);
    return error ? error->localizedDescription() : "it does not hold what it should";
}

std::string cureOf(const std::filesystem::path& path) {
    return path.filename().string().starts_with("feeds")
               ? "Put a good copy in its place, or add your feeds anew with: orvo feeds add"
               : "Put a good copy in its place, or choose anew with: orvo settings";
}

} // namespace

DamageWatch::DamageWatch()
    : _folder(Environment::profile().get().data)
    , _before(setAside()) {}

DamageWatch::Files DamageWatch::setAside() const {
    Files files;
    std::error_code ignored;
    for (const auto& entry : std::filesystem::directory_iterator(_folder, ignored)) {
        if (entry.path().filename().string().find(Mark) != std::string::npos)
            files.insert(entry.path());
    }
    return files;
}

std::vector<DamageWatch::Damage> DamageWatch::found() const {
    std::vector<Damage> found;
    for (const auto& aside : setAside()) {
        if (_before.contains(aside))
            continue;
        const auto path = std::filesystem::path(aside).replace_extension();
        found.push_back({fmt::format("{} is damaged ({}) and was set aside as {}",
                                     path.string(),
                                     reasonOf(aside),
                                     aside.string()),
                         cureOf(path)});
    }
    return found;
}

} // namespace orvo
