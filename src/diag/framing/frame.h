#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace vesk::diag {

/// A frame is its content and the content's checksum, low byte first, in which the two bytes below are escaped, and a
/// closing kFrameEnd. Nothing opens it.
inline constexpr std::uint8_t kFrameEnd = 0x7E;
/// Stands before a byte of which one bit was turned.
inline constexpr std::uint8_t kEscape = 0x7D;
inline constexpr std::uint8_t kEscapedBit = 0x20;
inline constexpr std::size_t kChecksumSize = 2;
/// The longest frame that is read, as it stands between two ends.
inline constexpr std::size_t kLongestFrame = std::size_t{128} << 10;

/// Appends the frame of `content`.
void appendFrame(std::vector<std::uint8_t>& out, std::span<const std::uint8_t> content);

}  // namespace vesk::diag
