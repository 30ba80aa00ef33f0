#include "platform/extension/NSExtensionMain.h"

#include "platform/foundation/NSBundle.h"
#include "platform/launchservices/ApplicationProxy.h"
#include "platform/launchservices/PlugInKitProxy.h"

#include <cstdlib>
#include <exception>
#include <filesystem>
#include <iostream>

namespace orvo {

namespace {

int fail(const std::string& program, const std::string& reason) {
    std::cerr << program << ": " << reason << '\n';
    return EXIT_FAILURE;
}

void sayWhatProcessIs(const ExtensionDescription& description) {
    BundleProxy::currentProcess().set(PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
        description.bundleIdentifier,
        ApplicationProxy::applicationProxyForIdentifier(description.containingApplication)));
}

} // namespace

EnvironmentSlot<ExtensionHostProgram>& extensionHostProgram() {
    static EnvironmentSlot<ExtensionHostProgram> slot([] { return ExtensionHostProgram(); });
    return slot;
}

int NSExtensionMain(int argc, char** argv) {
    const auto name =
        argc > 0 ? std::filesystem::path(argv[0]).filename().string() : std::string("extension");
    const std::vector<std::string> arguments(argv + (argc > 0 ? 1 : 0), argv + argc);
    try {
        std::shared_ptr<NSError> error;
        const auto extension =
            Extension::extensionInFolder(NSBundle::mainBundle()->bundlePath(), &error);
        if (!extension)
            return fail(name, error->localizedDescription());
        const auto host = extensionHostProgram().get();
        if (!host)
            return fail(name, "there is no host to run it");
        sayWhatProcessIs(extension->description());
        return host(*extension, arguments);
    } catch (const std::exception& problem) {
        return fail(name, problem.what());
    }
}

} // namespace orvo
