#include "platform/foundation/FolderBundle.h"

#include "platform/foundation/Log.h"
#include "platform/foundation/Text.h"

#include <fstream>
#include <iterator>
#include <vector>

namespace orvo {

namespace {

/// Nothing where the file is not there: a bundle need not have every language.
std::optional<StringsTable> readTable(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file)
        return std::nullopt;
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    std::string problem;
    auto table = StringsTable::parse(text, &problem);
    if (!table)
        Log::findOrCreate("Bundle")->error("%s: %s", path.string(), problem);
    return table;
}

} // namespace

std::vector<std::string> languagesToTry(const std::string& tag) {
    std::vector<std::string> languages;
    for (std::string language = tag; !language.empty();) {
        languages.push_back(language);
        const auto dash = language.rfind('-');
        language.erase(dash == std::string::npos ? 0 : dash);
    }
    if (languages.empty() || languages.back() != "en")
        languages.emplace_back("en");
    return languages;
}

std::optional<std::string> FolderBundle::textIn(const std::string& language,
                                                const std::string& table,
                                                const std::string& key) const {
    const auto name = language + ".lproj/" + table + ".strings";
    const std::lock_guard lock(_mutex);
    auto found = _tables.find(name);
    if (found == _tables.end())
        found = _tables.emplace(name, readTable(_folder / name).value_or(StringsTable())).first;
    return found->second.text(key);
}

std::string
FolderBundle::localizedStringForKey_value_table(const std::string& key,
                                                const std::optional<std::string>& value,
                                                const std::optional<std::string>& table) const {
    for (const auto& language : languagesToTry(Text::locale().get()))
        if (auto text = textIn(language, table.value_or("Localizable"), key))
            return *text;
    return value && !value->empty() ? *value : key;
}

} // namespace orvo
