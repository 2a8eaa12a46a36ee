#include "diag/capture/capture_remarks.h"

#include <algorithm>
#include <cstdint>
#include <optional>

#include "diag/count_remarks.h"

namespace vesk::diag {

namespace {

/// "1 frame", "2 frames".
std::string counted(std::uint64_t count, const std::string& what) {
  return std::to_string(count) + ' ' + what + (count == 1 ? "" : "s");
}

using Remark = std::optional<std::string>;

Remark onEnd(const CaptureReader& capture) {
  if (!capture.isCutOff()) return std::nullopt;
  return "it ends within a packet, which is left out: was the program that wrote it ended?";
}

Remark onDamage(const CaptureReader& capture) {
  const PacketCounts& counts = capture.counts();
  const std::uint64_t cutOff = capture.isCutOff() ? 1 : 0;
  // In a list of packets, what is cut off is no frame.
  const std::uint64_t frames = counts.damagedFrames() - std::min(cutOff, counts.damagedFrames());
  constexpr const char* kAdvice =
      "did another program read the port meanwhile, as ModemManager does? Stop it, and capture anew";
  if (Remark remark = remarkOnFrames(frames, counts.frames(), kAdvice)) return remark;
  const std::uint64_t count = counts.damaged() - cutOff;
  if (count == 0) return std::nullopt;
  return counted(count, "damaged packet") + (count == 1 ? " was" : " were") + " passed over";
}

Remark onEncryption(const CaptureReader& capture) {
  const std::uint64_t count = capture.counts().of(PacketKind::encryptedLog);
  if (count == 0) return std::nullopt;
  return counted(count, "log packet") + (count == 1 ? " is" : " are") +
         " encrypted and cannot be read: the modem's maker has the key";
}

Remark onSims(const CaptureReader& capture) {
  const PacketCounts& counts = capture.counts();
  if (counts.sims().empty() && counts.ofOtherSims() > 0) return "no packet is of the SIM that --sim chooses";
  return remarkOnSims(counts);
}

Remark onClock(const CaptureReader& capture) {
  if (!capture.counts().hasUnsetClock()) return std::nullopt;
  return "the modem's clock was not set by a network: dates are of 1980, and only the time between events is right";
}

Remark onNothingRead(const CaptureReader& capture) {
  const PacketCounts& counts = capture.counts();
  if (counts.logs().read > 0 || counts.passedOver() == 0) return std::nullopt;
  return "nothing in it could be read; vesk import --count tells what it holds";
}

}  // namespace

std::vector<std::string> remarksOn(const CaptureReader& capture) {
  std::vector<std::string> remarks;
  for (const auto remarkOn : {onEnd, onDamage, onEncryption, onSims, onClock, onNothingRead}) {
    if (const Remark remark = remarkOn(capture)) remarks.push_back(capture.name() + ": " + *remark);
  }
  return remarks;
}

}  // namespace vesk::diag
