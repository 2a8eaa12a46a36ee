#pragma once

#include <optional>
#include <string>

#include "system/file_descriptor.h"
#include "values/data.h"

namespace vesk {

/// The whole content of the file at `path`; absent, with errno telling why, when it cannot be read, as for a
/// directory, or when it is beyond 256 MiB.
[[nodiscard]] std::optional<Data> readFile(const std::string& path);

/// A way of one's own to the terminal behind `descriptor`, where no write ever blocks: a terminal that has room takes
/// no more than that, however little. Not open when no terminal is there.
[[nodiscard]] FileDescriptor openUnblocked(int descriptor);

}  // namespace vesk
