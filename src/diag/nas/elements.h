#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>

#include "diag/layout/byte_reader.h"
#include "messages/nas/nas.h"

/// The pieces that messages of the NAS protocols are made of.
namespace vesk::diag {

class EventBatch;
struct SimState;

/// A plain message, and what it changes.
struct NasMessage {
  ByteSpan bytes;
  SimState& sim;
  EventBatch& events;
};

/// An element whose value has a size of its own, and so no length byte.
struct FixedElement {
  std::uint8_t id;
  std::uint8_t size;
};
/// Those of LTE's messages, and of location updating.
inline constexpr FixedElement kEpsElements[] = {{0x13, 5}, {0x53, 1}, {0x17, 1}, {0x59, 1},
                                                {0x5A, 1}, {0x58, 1}, {0x32, 1}};
/// Those of GPRS's messages.
inline constexpr FixedElement kGprsElements[] = {{0x19, 3}, {0x17, 1}, {0x25, 1}, {0x2B, 1}};

/// The optional elements at the end of a message.
class Elements {
 public:
  /// `fixed` must outlive this.
  Elements(ByteSpan bytes, std::span<const FixedElement> fixed) : bytes_(bytes), fixed_(fixed) {}

  /// The value of the first element with this identifier, below 0x80, which may be empty. None when there is no such
  /// element, or none before one that is cut off.
  [[nodiscard]] std::optional<ByteSpan> find(std::uint8_t id) const;

 private:
  [[nodiscard]] std::optional<std::uint8_t> fixedSize(std::uint8_t id) const;

  ByteSpan bytes_;
  std::span<const FixedElement> fixed_;
};

/// A number of up to 4 bytes, the highest first.
[[nodiscard]] std::uint32_t bigEndian(ByteSpan bytes);

/// A PLMN of 3 bytes and a location area of 2.
[[nodiscard]] std::shared_ptr<metrics::KCellularLocationAreaId> locationArea(std::span<const std::uint8_t, 5> bytes);
/// The temporary identity of a mobile identity element: none when it has not 5 bytes, or is of another type.
[[nodiscard]] std::optional<std::uint32_t> temporaryIdentity(ByteSpan element);
/// Adds what an accept says of equivalent networks, if anything; a rest of fewer than 3 bytes is dropped.
void addEquivalentNetworks(const Elements& elements, EventBatch& events);

/// Reads a list of tracking areas; none when it is cut off.
struct TrackingAreas {
  MessageList<metrics::KCellularTrackingAreaId> list;
};
[[nodiscard]] std::optional<TrackingAreas> readTrackingAreas(ByteSpan bytes);

/// The causes of a reject that forbid the network, its area or the phone: trying again there is of no use.
[[nodiscard]] bool forbidsRegistration(std::uint8_t packetServiceCause);

/// Sets the cause of a reject, which is its third byte, and the status `forbidden` where the cause `forbids` to try
/// again, else `refused`. False, and nothing is set, when the message is cut off.
template <class Cause, class Context, class Status>
[[nodiscard]] bool setReject(ByteSpan message, bool (*forbids)(std::uint8_t cause), Status forbidden, Status refused,
                             Context& context) {
  ByteReader reader(message);
  const std::uint8_t cause = reader.byte(2);
  if (reader.isCutOff()) return false;
  context.setRejectCause(static_cast<Cause>(cause));
  context.setUpdateStatus(forbids(cause) ? forbidden : refused);
  return true;
}

}  // namespace vesk::diag
