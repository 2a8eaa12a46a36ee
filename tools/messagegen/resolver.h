#pragma once

#include <functional>
#include <optional>
#include <string>

#include "schema.h"

namespace messagegen {

/// Gives the text of a .proto file by its path below the schema's root; absent when there is none.
using ReadSource = std::function<std::optional<std::string>(const std::string& path)>;

/// Parses the file and what it imports, and resolves the types of its fields. A type may be declared in the
/// file itself or in one that it imports. Throws SchemaError, also for fields whose accessors would clash.
[[nodiscard]] ProtoFile loadProto(const std::string& path, const ReadSource& readSource);

}  // namespace messagegen
