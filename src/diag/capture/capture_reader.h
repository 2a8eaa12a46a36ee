#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "diag/capture/content.h"
#include "diag/framing/frame_reader.h"
#include "diag/framing/packet_list_reader.h"
#include "diag/modem_clock.h"
#include "diag/receiver.h"
#include "recording/byte_input.h"
#include "recording/timed_events.h"

namespace vesk::diag {

/// Reads a capture event by event, as the recording it becomes: a file, or a pipe while it is being written. Memory
/// does not grow with the capture.
class CaptureReader final : public TimedEvents {
 public:
  /// Reads on in `input`; `sim` is the one whose packets are wanted, absent for all.
  CaptureReader(ByteInput input, CaptureForm form, std::optional<std::uint32_t> sim);
  CaptureReader(const CaptureReader&) = delete;
  CaptureReader& operator=(const CaptureReader&) = delete;

  void setBeforeRead(BeforeRead beforeRead) override { input_.setBeforeRead(std::move(beforeRead)); }
  /// What is damaged is passed over, and counted.
  [[nodiscard]] Step next() override;
  [[nodiscard]] bool rewind() override;
  /// Absent until it was measured.
  [[nodiscard]] std::optional<double> duration() const override { return duration_; }

  /// Reads all of it to learn how long it takes, where there is a way back.
  void measure();

  [[nodiscard]] const PacketCounts& counts() const { return receiver_.counts(); }
  /// Whether the capture ends within a packet, as where the program that wrote it was ended.
  [[nodiscard]] bool isCutOff() const { return isCutOff_; }
  [[nodiscard]] const std::string& name() const { return input_.name(); }

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
  std::optional<double> duration_;
  bool hasEnded_ = false;
  bool isCutOff_ = false;
  /// Of the packet that was taken last.
  std::span<const Event> waiting_;
};

}  // namespace vesk::diag
