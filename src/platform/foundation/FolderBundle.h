#pragma once

#include "platform/foundation/NSBundle.h"
#include "platform/foundation/StringsTable.h"

#include <map>
#include <mutex>

namespace orvo {

/// A bundle that is a folder. Any thread.
class FolderBundle final : public NSBundle {
public:
    explicit FolderBundle(std::filesystem::path folder)
        : _folder(std::move(folder)) {}

    [[nodiscard]] std::filesystem::path bundlePath() const override { return _folder; }
    [[nodiscard]] std::string
    localizedStringForKey_value_table(const std::string& key,
                                      const std::optional<std::string>& value,
                                      const std::optional<std::string>& table) const override;

private:
    [[nodiscard]] std::optional<std::string>
    textIn(const std::string& language, const std::string& table, const std::string& key) const;

    std::filesystem::path _folder;
    mutable std::mutex _mutex;
    mutable std::map<std::string, StringsTable> _tables; // by path below the folder
};

/// The languages in which to look for a person's texts, best first: `pt-Latn-BR` gives itself,
/// `pt-Latn`, `pt`, then `en`.
[[nodiscard]] std::vector<std::string> languagesToTry(const std::string& tag);

} // namespace orvo
