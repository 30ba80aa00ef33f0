#pragma once

#include "platform/extension/ExtensionDescription.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <functional>
#include <map>

namespace orvo {

class UIViewController;

/// The classes of which a program can make an extension's principal object, by name. The object is
/// also an `NCWidgetProviding`, or shows what it has without being asked.
using PrincipalClassTable =
    std::map<std::string, std::function<std::shared_ptr<UIViewController>()>>;

/// The table of the running program. Default: empty.
EnvironmentSlot<PrincipalClassTable>& principalClasses();

/// An extension that this program can run: what it says of itself, and the class that it names.
/// Immutable.
class Extension {
public:
    /// Nothing, with an error, where the description cannot be read or names a class that is not in
    /// `principalClasses()`.
    [[nodiscard]] static std::optional<Extension>
    extensionInFolder(const std::filesystem::path& folder, std::shared_ptr<NSError>* error);
    /// For what needs no file.
    Extension(ExtensionDescription description,
              std::function<std::shared_ptr<UIViewController>()> makePrincipalObject)
        : _description(std::move(description))
        , _makePrincipalObject(std::move(makePrincipalObject)) {}

    [[nodiscard]] const ExtensionDescription& description() const noexcept { return _description; }
    /// A new one each time.
    [[nodiscard]] std::shared_ptr<UIViewController> makePrincipalObject() const {
        return _makePrincipalObject();
    }

private:
    ExtensionDescription _description;
    std::function<std::shared_ptr<UIViewController>()> _makePrincipalObject;
};

} // namespace orvo
