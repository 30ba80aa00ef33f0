#pragma once

#include "platform/feeds/http/NetworkConnection.h"

/// What a library that is opened at run time is asked for (`orvo::MakeNetworkConnection`): over the
/// toolkit's sockets, with its TLS and proxies.
extern "C" __attribute__((visibility("default"))) orvo::NetworkConnection*
OrvoMakeNetworkConnection(const std::string& url,
                          const orvo::NetworkConnection::Handlers& handlers);
