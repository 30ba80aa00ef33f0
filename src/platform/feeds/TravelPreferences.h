#pragma once

#include "platform/foundation/NSError.h"

#include <memory>

/// What the person asked for about travelling, kept in the app group's user defaults.
namespace orvo::TravelPreferences {

inline constexpr const char* SuiteName = "group.com.zentu.Orvo";
inline constexpr const char* StepFreeKey = "Orvo.travel.stepFree";

/// Whether incidents of lifts and ramps count. Default: no.
[[nodiscard]] bool asksForStepFree();
/// Why the answer may not be the person's: what they chose is there and cannot be read. Nil
/// otherwise.
[[nodiscard]] std::shared_ptr<NSError> unreadable();
/// Nil, or why it could not be kept.
std::shared_ptr<NSError> setAsksForStepFree(bool stepFree);

} // namespace orvo::TravelPreferences
