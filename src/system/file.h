#pragma once

#include <optional>
#include <string>

#include "system/file_descriptor.h"
#include "values/data.h"

namespace vesk {

/// The whole content of the file at `path`. Absent when it cannot be read or is larger than 256 MiB; errno then says
/// why.
[[nodiscard]] std::optional<Data> readFile(const std::string& path);

/// Opens the terminal behind `descriptor` once more, for writing without blocking: a write takes what there is room
/// for. Not open when `descriptor` is no terminal.
[[nodiscard]] FileDescriptor openUnblocked(int descriptor);

}  // namespace vesk
