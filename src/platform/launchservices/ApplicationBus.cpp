#include "platform/launchservices/ApplicationBus.h"

#include <algorithm>

namespace orvo::ApplicationBus {

std::string pathOfApplication(const std::string& applicationIdentifier) {
    std::string path = "/" + applicationIdentifier;
    std::ranges::replace(path, '.', '/');
    std::ranges::replace(path, '-', '_');
    return path;
}

} // namespace orvo::ApplicationBus
