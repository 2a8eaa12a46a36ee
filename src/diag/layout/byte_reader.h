#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

#include "diag/layout/field.h"

namespace vesk::diag {

using ByteSpan = std::span<const std::uint8_t>;

/// Reads numbers wherever they are said to stand. What lies behind the end reads as 0, or as no bytes, and is
/// remembered: read first, then ask isCutOff(), then use what was read.
class ByteReader {
 public:
  explicit ByteReader(ByteSpan bytes) : bytes_(bytes) {}

  [[nodiscard]] std::uint32_t get(const Field& field) {
    if (!holds(field.at, field.bytes)) return 0;
    std::uint32_t word = 0;
    for (std::size_t index = field.bytes; index-- > 0;)
      word = word << 8 | bytes_[field.at + index];
    return word >> field.bit & ~std::uint32_t{0} >> (32 - field.width);
  }
  /// The same bits in two's complement.
  [[nodiscard]] std::int32_t getSigned(const Field& field) {
    const unsigned unused = 32U - field.width;
    return static_cast<std::int32_t>(get(field) << unused) >> unused;
  }
  [[nodiscard]] std::uint8_t byte(std::size_t at) { return holds(at, 1) ? bytes_[at] : std::uint8_t{0}; }
  /// `count` bytes, at most 4, the highest first.
  [[nodiscard]] std::uint32_t bigEndian(std::size_t at, std::size_t count) {
    std::uint32_t value = 0;
    for (const std::uint8_t byte : part(at, count))
      value = value << 8 | byte;
    return value;
  }
  /// `count` bytes, all or none.
  [[nodiscard]] ByteSpan part(std::size_t at, std::size_t count) {
    return holds(at, count) ? bytes_.subspan(at, count) : ByteSpan{};
  }
  /// All from `at` on.
  [[nodiscard]] ByteSpan rest(std::size_t at) { return holds(at, 0) ? bytes_.subspan(at) : ByteSpan{}; }

  [[nodiscard]] bool isCutOff() const { return isCutOff_; }

 private:
  [[nodiscard]] bool holds(std::size_t at, std::size_t count) {
    if (at <= bytes_.size() && count <= bytes_.size() - at) return true;
    isCutOff_ = true;
    return false;
  }

  ByteSpan bytes_;
  bool isCutOff_ = false;
};

/// Gives each of `count` records of `size` bytes, the first at `first`, to `visit`. False, and none of them is given,
/// when they are not all there.
template <class Visit>
[[nodiscard]] bool forEachRecord(ByteSpan bytes, std::size_t first, std::size_t count, std::size_t size, Visit visit) {
  if (count == 0) return true;
  if (first > bytes.size() || count > (bytes.size() - first) / size) return false;
  for (std::size_t index = 0; index < count; ++index)
    visit(ByteReader(bytes.subspan(first + index * size, size)));
  return true;
}

}  // namespace vesk::diag
