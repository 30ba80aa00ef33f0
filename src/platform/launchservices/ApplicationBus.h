#pragma once

#include <string>

/// What both sides of an application's interface on the bus agree on.
namespace orvo::ApplicationBus {

inline constexpr const char* Interface = "org.freedesktop.Application";
inline constexpr const char* ActivationTokenKey = "activation-token";
inline constexpr const char* StartupIdentifierKey = "desktop-startup-id";
/// A truth value: the request is about the demonstration city's profile.
inline constexpr const char* DemonstrationKey = "com.zentu.Orvo.demo";

/// `com.zentu.Orvo` as the path of its object: `/com/zentu/Orvo`.
[[nodiscard]] std::string pathOfApplication(const std::string& applicationIdentifier);

} // namespace orvo::ApplicationBus
