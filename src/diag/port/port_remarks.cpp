#include "diag/port/port_remarks.h"

#include <optional>
#include <utility>

#include "diag/count_remarks.h"

namespace vesk::diag {

namespace {

/// Frames among which damaged ones are counted.
constexpr std::uint64_t kFramesTogether = 1000;
/// By then a SIM that is in and on has been heard of.
constexpr std::uint64_t kPacketsOfOtherSims = 200;
constexpr const char* kAdviceOnDamage =
    "does another program read the port? Stop it; mmcli --inhibit-device=UID keeps ModemManager away";

}  // namespace

std::vector<std::string> PortRemarks::take(const PacketCounts& counts) {
  std::vector<std::string> remarks;
  const std::uint64_t frames = counts.frames() - framesBefore_;
  const std::uint64_t damaged = counts.damagedFrames() - damagedBefore_;
  if (const auto remark = isDamageSaid_ ? std::nullopt : remarkOnFrames(damaged, frames, kAdviceOnDamage)) {
    isDamageSaid_ = true;
    remarks.push_back(*remark);
  }
  if (frames >= kFramesTogether) {
    framesBefore_ = counts.frames();
    damagedBefore_ = counts.damagedFrames();
  }
  bool& areSaid = counts.hasMoreSims() ? areMoreSimsSaid_ : areSimsSaid_;
  if (const auto remark = areSaid ? std::nullopt : remarkOnSims(counts)) {
    areSaid = true;
    remarks.push_back(*remark);
  }
  const bool areOnlyOtherSims = counts.sims().empty() && counts.ofOtherSims() >= kPacketsOfOtherSims;
  if (areOnlyOtherSims && !std::exchange(areOnlyOtherSimsSaid_, true))
    remarks.emplace_back("so far no packet is of the SIM that --sim chooses; leave it out to see which there are");
  if (counts.hasUnsetClock() && !std::exchange(isClockSaid_, true))
    remarks.emplace_back("the modem's clock is not set yet: until a network sets it, dates are of 1980");
  return remarks;
}

}  // namespace vesk::diag
