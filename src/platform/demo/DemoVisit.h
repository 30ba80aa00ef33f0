#pragma once

#include "platform/foundation/Environment.h"
#include "platform/foundation/NSError.h"

#include <filesystem>
#include <memory>
#include <optional>

namespace orvo {

/// The demonstration city's profile is the profile in use while this lives.
///
/// A city that is not current is written anew into that profile. Where nothing may be kept
/// (`Environment::keepsWritesInMemory()`), and for visitors who only look, where nothing can be
/// written, it stands in a temporary folder instead, with the settings of the profile, and is gone
/// at the end. Main thread.
class DemoVisit {
public:
    enum class Purpose {
        Look,
        Change, ///< what is changed must be kept
    };

    /// Nil, with the reason in `error`, when there is no city to be had.
    [[nodiscard]] static std::unique_ptr<DemoVisit> begin(Purpose purpose,
                                                          std::shared_ptr<NSError>* error);
    DemoVisit(const DemoVisit&) = delete;
    DemoVisit& operator=(const DemoVisit&) = delete;
    ~DemoVisit();

    /// Writes the city anew where its time has run out meanwhile, or its server has ended, as at
    /// the beginning. Nil, or why there is no current city; then the one there was stays.
    [[nodiscard]] std::shared_ptr<NSError> renew();
    /// Until the city's time runs out: at most an hour, which is also what a city with a server
    /// has; 0 where there is no current one.
    [[nodiscard]] double secondsLeft() const;

private:
    explicit DemoVisit(Purpose purpose);
    [[nodiscard]] std::shared_ptr<NSError> moveAside();

    Purpose _purpose;
    std::filesystem::path _aside; ///< the temporary folder; empty where there is none
    EnvironmentSlot<ProfileFolders>::Override _profile;
    std::optional<EnvironmentSlot<ProfileFolders>::Override> _profileAside;
};

} // namespace orvo
