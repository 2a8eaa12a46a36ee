#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "system/file_descriptor.h"

namespace vesk::web {

/// Listens on an address of either family, or on "localhost", without blocking; port 0 is any that is free. Not open,
/// with the reason, when that cannot be done. Connections that it accepts find out by themselves when nobody is there
/// any more.
[[nodiscard]] FileDescriptor listenOn(const std::string& address, std::uint16_t port, std::string& reason);

/// The port that a listener was given.
[[nodiscard]] std::uint16_t portOf(const FileDescriptor& listener);

/// Whether those alone who are on this machine reach a listener there.
[[nodiscard]] bool isLocal(const std::string& address);

/// The addresses at which others reach a listener there: of all addresses of this machine, where it takes any.
[[nodiscard]] std::vector<std::string> reachableAddresses(const std::string& address);

}  // namespace vesk::web
