#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <sys/types.h>

#include "system/file_descriptor.h"

namespace vesk {

/// A file that is written while something goes on, piece by piece. Every piece is handed to the system at once and
/// whole: a program that is killed, and a disk that is full, leave whole pieces behind. One thread at a time.
class RecordFile {
 public:
  /// A new file at `path`, or one that is there and empty; a pipe or a device is as good. Null, and `reason` becomes
  /// PATH: reason, when it cannot be written, or holds something: nothing is ever written over.
  [[nodiscard]] static std::unique_ptr<RecordFile> create(const std::string& path, std::string& reason);

  /// False when the piece could not be written, and all pieces from then on: see failure().
  bool append(std::string_view piece);
  bool append(std::span<const std::uint8_t> piece) {
    return append(std::string_view(reinterpret_cast<const char*>(piece.data()), piece.size()));
  }
  /// As PATH: reason.
  [[nodiscard]] const std::optional<std::string>& failure() const { return failure_; }

 private:
  RecordFile(FileDescriptor descriptor, std::string path);

  FileDescriptor descriptor_;
  std::string path_;
  /// How much of it is whole pieces.
  off_t size_ = 0;
  std::optional<std::string> failure_;
};

}  // namespace vesk
