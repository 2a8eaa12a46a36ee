#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

namespace vesk::diag {

/// Reads a message of the air interface bit by bit, bit 0 being the most significant of its first byte. Bits behind the
/// end read as 0, and are remembered: read first, then ask isCutOff(), then use what was read.
class BitReader {
 public:
  explicit BitReader(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  /// `count` bits, at most 32, from bit `first` on.
  [[nodiscard]] std::uint32_t at(std::size_t first, unsigned count) {
    std::uint32_t value = 0;
    for (std::size_t bit = first; bit < first + count; ++bit)
      value = value << 1 | bitAt(bit);
    return value;
  }

  /// The next `count` bits, at most 32, which are then behind the reader.
  [[nodiscard]] std::uint32_t next(unsigned count) {
    const std::uint32_t value = at(position_, count);
    position_ += count;
    return value;
  }
  [[nodiscard]] bool nextFlag() { return next(1) != 0; }
  void skip(std::size_t count) { position_ += count; }
  void seek(std::size_t position) { position_ = position; }
  [[nodiscard]] std::size_t position() const { return position_; }

  [[nodiscard]] bool isCutOff() const { return isCutOff_; }

 private:
  [[nodiscard]] std::uint32_t bitAt(std::size_t bit) {
    if (bit / 8 < bytes_.size()) return bytes_[bit / 8] >> (7 - bit % 8) & 1U;
    isCutOff_ = true;
    return 0;
  }

  std::span<const std::uint8_t> bytes_;
  std::size_t position_ = 0;
  bool isCutOff_ = false;
};

}  // namespace vesk::diag
