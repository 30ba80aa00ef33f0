#include "platform/extension/Extension.h"

#include "platform/uikit/UIViewController.h"

namespace orvo {

EnvironmentSlot<PrincipalClassTable>& principalClasses() {
    static EnvironmentSlot<PrincipalClassTable> slot([] { return PrincipalClassTable(); });
    return slot;
}

std::optional<Extension> Extension::extensionInFolder(const std::filesystem::path& folder,
                                                      std::shared_ptr<NSError>* error) {
    const auto file = folder / ExtensionDescription::FileName;
    auto description = ExtensionDescription::read(file, error);
    if (!description)
        return std::nullopt;
    const auto classes = principalClasses().get();
    const auto found = classes.find(description->principalClass);
    if (found == classes.end()) {
        if (error)
            *error = NSError::errorWithMessage(
                ExtensionErrorDomain,
                static_cast<std::int64_t>(ExtensionErrorCode::NoPrincipalClass),
                file.string() + ": this program has no class " + description->principalClass);
        return std::nullopt;
    }
    return Extension(*std::move(description), found->second);
}

} // namespace orvo
