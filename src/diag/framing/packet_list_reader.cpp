#include "diag/framing/packet_list_reader.h"

#include <algorithm>

#include "diag/framing/packet_reader.h"
#include "diag/little_endian.h"

namespace vesk::diag {

namespace {

constexpr std::size_t kLengthSize = sizeof(std::uint16_t);

}  // namespace

std::optional<LogPacket> PacketListReader::next() {
  if (isBegunDone_) {
    begun_.clear();
    isBegunDone_ = false;
  }
  if (isDamaged_ || rest_.empty()) return std::nullopt;
  if (!begun_.empty() || rest_.size() < kLengthSize) keepUpTo(kLengthSize);
  if (!begun_.empty() && begun_.size() < kLengthSize) return std::nullopt;
  const std::size_t length = readLittleEndian<std::uint16_t>(begun_.empty() ? rest_ : begun_, 0);
  if (length < kLogHeaderSize) {
    isDamaged_ = true;
    return std::nullopt;
  }
  if (begun_.empty() && length <= rest_.size()) {
    const std::span<const std::uint8_t> packet = rest_.first(length);
    rest_ = rest_.subspan(length);
    return readLogPacket(packet, 1);
  }
  keepUpTo(length);
  if (begun_.size() < length) return std::nullopt;
  isBegunDone_ = true;
  return readLogPacket(begun_, 1);
}

void PacketListReader::keepUpTo(std::size_t size) {
  const std::size_t count = std::min(rest_.size(), size - std::min(size, begun_.size()));
  begun_.insert(begun_.end(), rest_.begin(), rest_.begin() + static_cast<std::ptrdiff_t>(count));
  rest_ = rest_.subspan(count);
}

}  // namespace vesk::diag
