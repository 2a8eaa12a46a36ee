#pragma once

#include <cstddef>
#include <cstdint>

#include "diag/layout/byte_reader.h"
#include "diag/packet.h"

namespace vesk::diag {

/// A part of a packet with a version of its own.
struct Subpacket {
  std::uint8_t id;
  std::uint8_t version;
  ByteSpan content;
};

/// Gives each subpacket of a packet of version 1 to `read`, which says what became of it, as a reader of packets does.
/// The packet is damaged when one is, and passed over when none can be read.
template <class Read>
[[nodiscard]] Reading readSubpackets(const LogPacket& packet, Read read) {
  using namespace notation;
  constexpr std::size_t kHeaderSize = 4;

  ByteReader body(packet.body);
  if (body.byte(0) != 1) return Reading::passedOver;
  const std::uint8_t count = body.byte(1);
  std::size_t start = kHeaderSize;
  Reading reading = Reading::passedOver;
  for (unsigned index = 0; index < count && !body.isCutOff(); ++index) {
    ByteReader header(body.part(start, kHeaderSize));
    const std::size_t size = header.get(h(2));
    if (header.isCutOff() || size < kHeaderSize) return Reading::damaged;
    const Subpacket subpacket{header.byte(0), header.byte(1), body.part(start + kHeaderSize, size - kHeaderSize)};
    if (body.isCutOff()) return Reading::damaged;
    const Reading one = read(subpacket);
    if (one == Reading::damaged) return one;
    if (one == Reading::read) reading = one;
    start += size;
  }
  return body.isCutOff() ? Reading::damaged : reading;
}

}  // namespace vesk::diag
