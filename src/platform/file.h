#pragma once

#include <optional>
#include <string>

#include "platform/data.h"

namespace vesk {

/// The whole content of the file at `path`; absent, with errno telling why, when it cannot be read, as for a
/// directory, or when it is beyond 256 MiB.
[[nodiscard]] std::optional<Data> readFile(const std::string& path);

}  // namespace vesk
