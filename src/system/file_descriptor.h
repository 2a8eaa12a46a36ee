#pragma once

#include <unistd.h>
#include <utility>

namespace vesk {

/// A file descriptor that is closed with its owner, or a borrowed one that is left open.
class FileDescriptor {
 public:
  FileDescriptor() = default;
  /// Takes over `descriptor`; a negative one, as open(2) returns on failure, makes an empty object.
  explicit FileDescriptor(int descriptor) : descriptor_(descriptor), isOwned_(true) {}
  static FileDescriptor borrowed(int descriptor) {
    FileDescriptor made(descriptor);
    made.isOwned_ = false;
    return made;
  }

  FileDescriptor(FileDescriptor&& other) noexcept
      : descriptor_(std::exchange(other.descriptor_, -1)), isOwned_(other.isOwned_) {}
  FileDescriptor& operator=(FileDescriptor&& other) noexcept {
    std::swap(descriptor_, other.descriptor_);
    std::swap(isOwned_, other.isOwned_);
    return *this;
  }
  ~FileDescriptor() {
    if (isOwned_ && descriptor_ >= 0) close(descriptor_);
  }

  [[nodiscard]] bool isOpen() const { return descriptor_ >= 0; }
  [[nodiscard]] int get() const { return descriptor_; }

 private:
  int descriptor_ = -1;
  bool isOwned_ = false;
};

}  // namespace vesk
