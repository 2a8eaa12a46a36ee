#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

#include "system/clock.h"
#include "system/file_descriptor.h"
#include "system/wake_up.h"

namespace vesk {

/// How long a reader is waited for that takes nothing: by default as long as it takes.
struct WaitingPolicy {
  /// Until then; absent for ever.
  std::optional<Clock::Instant> end{};
  /// A reader that has taken something is waited for this long again. Absent: `end` holds for all of it.
  std::optional<Clock::Duration> renewal{};
  /// While this is signalled nobody is waited for.
  const WakeUp* interrupt = nullptr;
};

/// Writes bytes to a descriptor whose reader may be slow. Usable by one thread at a time.
class DescriptorWriter {
 public:
  enum class Outcome { done, interrupted, timedOut, failed };

  struct Written {
    /// How many bytes the reader has taken.
    std::size_t count = 0;
    Outcome outcome = Outcome::done;
    /// Of write(2), when it failed.
    int error = 0;
  };

  explicit DescriptorWriter(FileDescriptor descriptor);

  /// Writes the bytes, waiting for room as `policy` says.
  Written write(std::string_view bytes, WaitingPolicy policy) const;

 private:
  enum class Room { some, interrupted, noneInTime };

  /// `wasRefused` says that there was room just now, but too little.
  [[nodiscard]] Room waitForRoom(const WaitingPolicy& policy, bool wasRefused) const;

  FileDescriptor descriptor_;
  /// The most that is written at once where a write may block.
  std::size_t chunk_;
};

}  // namespace vesk
