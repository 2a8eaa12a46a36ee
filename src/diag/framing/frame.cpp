#include "diag/framing/frame.h"

#include "diag/framing/checksum.h"

namespace vesk::diag {

namespace {

void appendEscaped(std::vector<std::uint8_t>& out, std::uint8_t byte) {
  if (byte == kFrameEnd || byte == kEscape) {
    out.push_back(kEscape);
    byte ^= kEscapedBit;
  }
  out.push_back(byte);
}

}  // namespace

void appendFrame(std::vector<std::uint8_t>& out, std::span<const std::uint8_t> content) {
  for (const std::uint8_t byte : content)
    appendEscaped(out, byte);
  const std::uint16_t sum = checksum(content);
  appendEscaped(out, static_cast<std::uint8_t>(sum));
  appendEscaped(out, static_cast<std::uint8_t>(sum >> 8));
  out.push_back(kFrameEnd);
}

}  // namespace vesk::diag
