#pragma once

#include <string>
#include <string_view>

#include "schema.h"

namespace messagegen {

/// Reads the subset of proto2 in which the metrics are written: enumerations, messages with optional and
/// repeated fields, imports. Type names are left as written. Throws SchemaError on anything else.
[[nodiscard]] ProtoFile parseProto(const std::string& path, std::string_view source);

}  // namespace messagegen
