#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "diag/packet.h"

namespace vesk::diag {

/// Reads log packets that follow each other without frames and checksums (DLF), from bytes that come in any pieces.
/// Nothing marks where a packet begins: the first that is damaged ends the reading.
class PacketListReader {
 public:
  /// What is to be read next; next() must have used up what came before. Must stay until next() has.
  void take(std::span<const std::uint8_t> bytes) { rest_ = bytes; }
  /// The next packet, valid until the next call; absent when the bytes are used up, or when it is damaged. What is not
  /// whole yet is kept.
  [[nodiscard]] std::optional<LogPacket> next();
  /// Whether a damaged packet has ended the reading.
  [[nodiscard]] bool isDamaged() const { return isDamaged_; }
  /// No more bytes come: a packet that is not whole now is damaged.
  void end() { isDamaged_ = isDamaged_ || (!isBegunDone_ && !begun_.empty()); }

 private:
  /// Fills begun_ up to `size` bytes, where there are as many.
  void keepUpTo(std::size_t size);

  std::span<const std::uint8_t> rest_;
  /// The start of a packet whose end has not come.
  std::vector<std::uint8_t> begun_;
  bool isBegunDone_ = false;
  bool isDamaged_ = false;
};

}  // namespace vesk::diag
