#pragma once

#include "handoff/OWOpenable.h"
#include "platform/foundation/NSDictionary.h"

#include <optional>
#include <string>

namespace orvo {

inline constexpr const char* OWUserActivityErrorDomain = "OWUserActivityErrorDomain";
/// User-info key: the `OWUserActivityData` from which no activity could be made.
inline constexpr const char* OWUserActivityErrorMissingActivityKey =
    "OWUserActivityErrorMissingActivityKey";

/// A user activity that a row hands to the map application. Immutable.
class OWUserActivityData final : public OWOpenable {
public:
    /// Shares the user's session with the application, here already and not only at opening, and
    /// amends `userInfo` with it. Both may be nil.
    [[nodiscard]] static std::shared_ptr<OWUserActivityData>
    initWithActivityType_userInfo(std::optional<std::string> activityType,
                                  const std::shared_ptr<NSDictionary>& userInfo);

    [[nodiscard]] const std::optional<std::string>& activityType() const noexcept {
        return _activityType;
    }
    [[nodiscard]] const std::shared_ptr<NSDictionary>& userInfo() const noexcept {
        return _userInfo;
    }

    /// The context is not used. The handler goes to the platform as it is.
    void openInContext_completionHandler(const std::shared_ptr<NSObject>& context,
                                         CompletionHandler completionHandler) override;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] bool isEqualToUserActivityData(const OWUserActivityData& other) const;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    std::optional<std::string> _activityType;
    std::shared_ptr<NSDictionary> _userInfo;
};

} // namespace orvo
