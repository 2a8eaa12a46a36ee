#pragma once

#include <map>
#include <string>

#include "schema.h"

namespace vesk {

/// The .proto files themselves, by the names of their messages.
[[nodiscard]] const std::map<std::string, messagegen::MessageType, std::less<>>& schema();

/// The enumeration of a field of `message`.
[[nodiscard]] const messagegen::Enumeration& enumerationOf(const messagegen::MessageType& message,
                                                           const messagegen::Field& field);

}  // namespace vesk
