#include "diag/layout/lte_bands.h"

#include "messages/shared/lte_bands.h"

namespace vesk::diag {

std::optional<std::uint32_t> lteBandOf(std::uint32_t earfcn) {
  // Of those above band 48, a modem has names for 65 to 71 only.
  constexpr int kLastOfFirst = 48;
  constexpr int kFirstOfOthers = 65;
  constexpr int kLast = 71;
  const LteBand* band = lteBandOfDownlink(earfcn);
  if (band == nullptr || band->number > kLast) return std::nullopt;
  if (band->number > kLastOfFirst && band->number < kFirstOfOthers) return std::nullopt;
  return static_cast<std::uint32_t>(band->number);
}

}  // namespace vesk::diag
