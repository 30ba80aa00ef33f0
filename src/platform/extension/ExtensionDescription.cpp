#include "platform/extension/ExtensionDescription.h"

#include "platform/foundation/StringsTable.h"

#include <array>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <iterator>
#include <utility>

namespace orvo {

namespace {

std::shared_ptr<NSError>
problemWith(const std::filesystem::path& file, ExtensionErrorCode code, const std::string& reason) {
    return NSError::errorWithMessage(
        ExtensionErrorDomain, static_cast<std::int64_t>(code), file.string() + ": " + reason);
}

/// The text of the whole file; nothing, with the reason, when it cannot be read.
std::optional<std::string> contentOf(const std::filesystem::path& file, std::string* reason) {
    errno = 0;
    std::ifstream stream(file, std::ios::binary);
    // A folder can be opened; reading it is what fails.
    const bool isFolder = stream && std::filesystem::is_directory(file);
    if (stream && !isFolder)
        return std::string{std::istreambuf_iterator<char>(stream), {}};
    *reason = std::strerror(isFolder ? EISDIR : errno);
    return std::nullopt;
}

} // namespace

std::optional<ExtensionDescription> ExtensionDescription::read(const std::filesystem::path& file,
                                                               std::shared_ptr<NSError>* error) {
    const auto fail = [&](ExtensionErrorCode code, const std::string& reason) {
        if (error)
            *error = problemWith(file, code, reason);
        return std::nullopt;
    };
    std::string problem;
    const auto text = contentOf(file, &problem);
    if (!text)
        return fail(ExtensionErrorCode::NoDescription, problem);
    const auto entries = StringsTable::parse(*text, &problem);
    if (!entries)
        return fail(ExtensionErrorCode::WrongDescription, problem);

    ExtensionDescription description;
    const auto needed = std::to_array<std::pair<const char*, std::string*>>(
        {{"BundleIdentifier", &description.bundleIdentifier},
         {"ContainingApplication", &description.containingApplication},
         {"DisplayName", &description.displayName},
         {"NSExtensionPrincipalClass", &description.principalClass}});
    for (const auto& [key, target] : needed) {
        *target = entries->text(key).value_or("");
        if (target->empty())
            return fail(ExtensionErrorCode::WrongDescription, std::string("has no entry ") + key);
    }
    description.iconName = entries->text("IconName");
    return description;
}

} // namespace orvo
