#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <variant>
#include <vector>

#include "diag/framing/frame_reader.h"
#include "diag/framing/packet_list_reader.h"
#include "diag/modem_clock.h"
#include "diag/receiver.h"
#include "recording/byte_input.h"
#include "recording/recorded_event.h"

namespace vesk::diag {

/// How the packets of a capture stand in it.
enum class CaptureForm { frames, packetList };

/// Reads a capture event by event, as the recording it becomes: a file, or a pipe while it is being written. Memory
/// does not grow with the capture. One thread at a time.
class CaptureReader {
 public:
  /// Reads on in `input`; `sim` is the one whose packets are wanted, absent for all.
  CaptureReader(ByteInput input, CaptureForm form, std::optional<std::uint32_t> sim);
  CaptureReader(const CaptureReader&) = delete;
  CaptureReader& operator=(const CaptureReader&) = delete;

  /// The next event, whose payload is valid until the next call; absent at the end, and when the input cannot be read
  /// on: see input(). What is damaged is passed over, and counted.
  [[nodiscard]] std::optional<RecordedEvent> next();

  [[nodiscard]] const PacketCounts& counts() const { return receiver_.counts(); }
  /// Whether the capture ends within a packet, as where the program that wrote it was ended.
  [[nodiscard]] bool isCutOff() const { return isCutOff_; }
  [[nodiscard]] const ByteInput& input() const { return input_; }
  [[nodiscard]] ByteInput& input() { return input_; }
  /// Back to the first event, all forgotten but the counts; false when there is no way back.
  [[nodiscard]] bool rewind();

 private:
  using Events = std::optional<std::span<const Event>>;

  /// The events of the next packet; absent when there are no more packets.
  [[nodiscard]] Events takePacket();
  /// The same of those in the bytes that were read last.
  [[nodiscard]] Events takeFrom(FrameReader& frames);
  [[nodiscard]] Events takeFrom(PacketListReader& list);
  void end(FrameReader& frames);
  void end(PacketListReader& list);

  ByteInput input_;
  Receiver receiver_;
  std::vector<std::uint8_t> buffer_;
  std::variant<FrameReader, PacketListReader> packets_;
  RecordingTime time_;
  bool hasEnded_ = false;
  bool isCutOff_ = false;
  /// Of the packet that was taken last.
  std::span<const Event> waiting_;
};

}  // namespace vesk::diag
