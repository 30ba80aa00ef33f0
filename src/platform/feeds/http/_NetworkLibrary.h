#pragma once

#include "platform/feeds/http/NetworkConnection.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <filesystem>
#include <memory>
#include <string>

namespace orvo::_NetworkLibrary {

/// Where the library lies that makes connections. Default: that of the installation
/// (`../lib/orvo-transit-widget` beside the program's folder), else of the build tree.
EnvironmentSlot<std::filesystem::path>& file();

/// A connection of the library's, which is opened with the first one and kept: the toolkit's
/// networking, which it brings, would cost every start milliseconds and more than a megabyte. Nil
/// where it cannot be opened: `reason` says why. Any thread.
[[nodiscard]] std::unique_ptr<NetworkConnection> connectionTo(
    const std::string& url, const NetworkConnection::Handlers& handlers, std::string& reason);

} // namespace orvo::_NetworkLibrary
