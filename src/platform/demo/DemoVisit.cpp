#include "platform/demo/DemoVisit.h"

#include "platform/demo/DemoError.h"
#include "platform/demo/DemoProfile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <fmt/format.h>
#include <string_view>
#include <system_error>

namespace orvo {

namespace {

using Path = std::filesystem::path;

/// Whether the file belongs to what a city is written into.
bool isOfCity(const std::string& name) {
    constexpr std::array<std::string_view, 3> Beginnings = {
        "feeds", "schedules.sqlite", "favorites.sqlite"};
    return std::any_of(Beginnings.begin(), Beginnings.end(), [&](const auto beginning) {
        return name.rfind(beginning, 0) == 0;
    });
}

/// Settings and saved state, as far as they can be read.
void copyTheRest(const Path& from, const Path& to) {
    std::error_code ignored;
    for (const auto& entry : std::filesystem::directory_iterator(from, ignored)) {
        const Path name = entry.path().filename();
        if (entry.is_regular_file(ignored) && !isOfCity(name.string()))
            std::filesystem::copy_file(entry.path(), to / name, ignored);
    }
}

} // namespace

std::unique_ptr<DemoVisit> DemoVisit::begin(Purpose purpose, std::shared_ptr<NSError>* error) {
    std::unique_ptr<DemoVisit> visit(new DemoVisit(purpose));
    const auto failure = visit->renew();
    if (!failure)
        return visit;
    if (error)
        *error = failure;
    return nullptr;
}

DemoVisit::DemoVisit(Purpose purpose)
    : _purpose(purpose)
    , _profile(Environment::profile().overrideWith(ProfileFolders::demonstration())) {}

std::shared_ptr<NSError> DemoVisit::renew() {
    if (DemoProfile::isCurrent())
        return nullptr;
    if (!_aside.empty())
        return DemoProfile::write();
    const bool keepsNothing = Environment::keepsWritesInMemory().get();
    auto failure = keepsNothing ? nullptr : DemoProfile::write();
    if (keepsNothing || (failure && _purpose == Purpose::Look))
        failure = moveAside();
    return failure;
}

// NOLINTNEXTLINE(readability-convert-member-functions-to-static): it is the visit's own city
double DemoVisit::secondsLeft() const {
    return DemoProfile::secondsLeft();
}

DemoVisit::~DemoVisit() {
    std::error_code ignored;
    if (!_aside.empty())
        std::filesystem::remove_all(_aside, ignored);
}

std::shared_ptr<NSError> DemoVisit::moveAside() {
    std::error_code failed;
    std::string pattern =
        (std::filesystem::temp_directory_path(failed) / "orvo-demo-XXXXXX").string();
    if (!failed && !mkdtemp(pattern.data()))
        failed = std::error_code(errno, std::generic_category());
    if (failed)
        return NSError::errorWithMessage(
            DemoErrorDomain,
            static_cast<std::int64_t>(DemoErrorCode::CannotWrite),
            fmt::format("{} cannot be made: {}", pattern, failed.message()));
    _aside = pattern;
    auto folders = Environment::profile().get();
    copyTheRest(folders.data, _aside);
    folders.data = _aside;
    _profileAside.emplace(Environment::profile().overrideWith(std::move(folders)));
    return DemoProfile::write();
}

} // namespace orvo
