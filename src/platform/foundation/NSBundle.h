#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <filesystem>
#include <optional>
#include <string>

namespace orvo {

/// The program's own resources: here its texts, a table a language. Any thread.
class NSBundle : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<NSBundle> mainBundle();
    /// What `mainBundle()` answers. Default: the resources of the installation
    /// (`../share/orvo-transit-widget` beside the program's folder), else of the build tree.
    static EnvironmentSlot<std::shared_ptr<NSBundle>>& main();
    /// The bundle of a folder that holds `LANGUAGE.lproj/TABLE.strings`. Tables are read when first
    /// asked for; one that cannot be read is said in the log, once, and counts as empty.
    [[nodiscard]] static std::shared_ptr<NSBundle>
    bundleWithPath(const std::filesystem::path& folder);

    /// The folder that it is; empty for one that is none.
    [[nodiscard]] virtual std::filesystem::path bundlePath() const { return {}; }

    /// The text of a key in the table (nil: `Localizable`) of the bundle's best language for the
    /// person's. A key that is missing there is looked up in English, and then answers `value` (nil
    /// or empty: the key itself).
    [[nodiscard]] virtual std::string
    localizedStringForKey_value_table(const std::string& key,
                                      const std::optional<std::string>& value,
                                      const std::optional<std::string>& table) const = 0;
};

} // namespace orvo
