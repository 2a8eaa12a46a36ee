#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "diag/framing/frame.h"

namespace vesk::diag {

/// What stands between two frame ends.
struct Frame {
  /// Whether it is whole: of a length that may be, with every escape followed by its byte, its checksum right.
  bool isSound;
  /// Without escapes and checksum; empty where the frame is not sound.
  std::span<const std::uint8_t> content;
};

/// Finds the frames in bytes that come in any pieces. Damage never reaches beyond the next frame's end, and no more
/// than the longest frame is kept.
class FrameReader {
 public:
  /// What is to be read next; next() must have used up what came before. Must stay until next() has.
  void take(std::span<const std::uint8_t> bytes) { rest_ = bytes; }
  /// The next frame, valid until the next call; absent when the bytes are used up. What an end has not closed yet is
  /// kept.
  [[nodiscard]] std::optional<Frame> next();
  /// No more bytes come. Whether a frame was cut off, which is damage; it is forgotten.
  [[nodiscard]] bool endsWithinFrame();

 private:
  void keep(std::span<const std::uint8_t> bytes);
  [[nodiscard]] Frame read(std::span<const std::uint8_t> piece);
  /// Absent where an escape is followed by nothing, or by another.
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> unescape(std::span<const std::uint8_t> piece);

  std::span<const std::uint8_t> rest_;
  /// The start of a frame that has not ended within the bytes it came with, and no more than is needed to see that it
  /// is too long.
  std::vector<std::uint8_t> begun_;
  /// Whether begun_ was handed on.
  bool isBegunDone_ = false;
  std::vector<std::uint8_t> unescaped_;
};

}  // namespace vesk::diag
