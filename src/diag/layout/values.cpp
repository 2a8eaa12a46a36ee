#include "diag/layout/values.h"

#include <algorithm>

namespace vesk::diag {

namespace {

/// None for a raw value of 0, else `convert` of it.
template <class Convert>
std::optional<std::int32_t> unlessZero(std::uint32_t raw, Convert convert) {
  if (raw == 0) return std::nullopt;
  return convert(static_cast<std::int32_t>(raw));
}

}  // namespace

// A shift to the right rounds down, of negative numbers too.
std::int32_t dbmOf(std::int32_t sixteenths) {
  return (sixteenths + 8) >> 4;
}

std::optional<std::int32_t> rsrpDbm(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return dbmOf(r) + kRsrpBaseDbm; });
}

std::optional<std::int32_t> rsrqDb(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return dbmOf(r) + kRsrqBaseDb; });
}

std::optional<std::int32_t> hundredthsOfDb(std::uint32_t raw, std::int32_t base) {
  return unlessZero(raw, [base](std::int32_t r) { return (100 * r + 8) / 16 + 100 * base; });
}

std::optional<std::int32_t> neighbourRsrp(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return dbmOf(r) + kRsrpBaseDbm + 140; });
}

std::optional<std::int32_t> neighbourRsrq(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return dbmOf(2 * r) - 21; });
}

std::optional<std::int32_t> sinrHalfDb(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return (2 * r + 5) / 10 - 40; });
}

std::optional<std::int32_t> snrDb(std::uint32_t raw) {
  return unlessZero(raw, [](std::int32_t r) { return (r + 5) / 10 - 20; });
}

std::uint32_t rxlevOf(std::int32_t dbm) {
  return static_cast<std::uint32_t>(std::clamp(dbm + 110, 0, 63));
}

std::optional<std::uint32_t> bandwidthHalfMhz(std::uint32_t resourceBlocks) {
  switch (resourceBlocks) {
    case 6:
      return 3;
    case 15:
      return 6;
    case 25:
      return 10;
    case 50:
      return 20;
    case 75:
      return 30;
    case 100:
      return 40;
    default:
      return std::nullopt;
  }
}

std::optional<std::uint32_t> bandwidthMhz(std::uint32_t resourceBlocks) {
  const auto half = bandwidthHalfMhz(resourceBlocks);
  if (!half) return std::nullopt;
  return *half / 2;
}

std::optional<std::uint32_t> gprsTimerSeconds(std::uint8_t timer) {
  static constexpr std::uint32_t kUnits[] = {2, 60, 360};
  const unsigned unit = timer >> 5;
  if (unit >= std::size(kUnits)) return std::nullopt;
  return kUnits[unit] * (timer & 31U);
}

PlmnDigits plmnDigits(std::span<const std::uint8_t, 3> coded) {
  constexpr unsigned kNoDigit = 15;
  const auto low = [&coded](std::size_t index) { return coded[index] & 15U; };
  const auto high = [&coded](std::size_t index) { return static_cast<unsigned>(coded[index] >> 4); };
  const unsigned mcc = 100 * low(0) + 10 * high(0) + low(1);
  const unsigned twoDigits = 10 * low(2) + high(2);
  if (high(1) == kNoDigit) return {mcc, twoDigits, 2};
  return {mcc, 10 * twoDigits + high(1), 3};
}

}  // namespace vesk::diag
