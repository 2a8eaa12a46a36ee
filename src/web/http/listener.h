#pragma once

#include <cstdint>
#include <string>

#include "system/file_descriptor.h"

namespace vesk::web {

/// Listens on an address of either family, without blocking; port 0 is any that is free. Not open,
/// with the reason, when that cannot be done. Connections that it accepts find out by themselves when nobody is there
/// any more.
[[nodiscard]] FileDescriptor listenOn(const std::string& address, std::uint16_t port, std::string& reason);

/// The port that a listener was given.
[[nodiscard]] std::uint16_t portOf(const FileDescriptor& listener);

}  // namespace vesk::web
