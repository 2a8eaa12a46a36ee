#pragma once

#include "system/file_descriptor.h"

namespace vesk {

/// Ends another thread's poll(2): once signalled, its descriptor is readable until cleared.
class WakeUp {
 public:
  WakeUp();

  /// From any thread, and from a signal handler.
  void signal() const noexcept;
  void clear() const noexcept;
  [[nodiscard]] int descriptor() const { return descriptor_.get(); }

 private:
  FileDescriptor descriptor_;
};

}  // namespace vesk
