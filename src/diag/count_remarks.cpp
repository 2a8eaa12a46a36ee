#include "diag/count_remarks.h"

#include <cstddef>

namespace vesk::diag {

namespace {

std::string listed(const std::vector<std::uint32_t>& sims) {
  std::string text;
  for (std::size_t index = 0; index < sims.size(); ++index) {
    if (index > 0) text += index + 1 == sims.size() ? " and " : ", ";
    text += std::to_string(sims[index]);
  }
  return text;
}

}  // namespace

std::optional<std::string> remarkOnSims(const PacketCounts& counts) {
  if (counts.sims().size() < 2) return std::nullopt;
  if (counts.hasMoreSims())
    return "it names more than " + std::to_string(kMostSims) +
           " SIMs, as no handset does: what is known of one is forgotten for the next; --sim N takes one";
  return "it holds the SIMs " + listed(counts.sims()) + ", and all are taken; --sim N takes one";
}

std::optional<std::string> remarkOnFrames(std::uint64_t damaged, std::uint64_t all, std::string_view advice) {
  // Now and then a byte is lost on a line. Where two programs read a port, each gets a part of most frames.
  constexpr std::uint64_t kFewest = 10;
  constexpr std::uint64_t kOneIn = 20;
  if (damaged < kFewest || damaged * kOneIn < all) return std::nullopt;
  return std::to_string(damaged) + " of " + std::to_string(all) + " frames are damaged: " + std::string(advice);
}

}  // namespace vesk::diag
