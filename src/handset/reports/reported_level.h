#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>

/// Levels and qualities as they are reported, kept to the ranges that the standards give them.
namespace vesk::handset {

[[nodiscard]] inline std::int32_t rounded(double value, std::int32_t least, std::int32_t most) {
  return std::clamp(static_cast<std::int32_t>(std::lround(value)), least, most);
}
[[nodiscard]] inline std::uint32_t roundedUnsigned(double value, std::int32_t most) {
  return static_cast<std::uint32_t>(rounded(value, 0, most));
}

/// RSRP in dBm, and as a code: -140 dBm is 0.
[[nodiscard]] inline std::int32_t rsrpDbm(double rsrp) {
  return rounded(rsrp, -140, -44);
}
[[nodiscard]] inline std::uint32_t rsrpCode(double rsrp) {
  return roundedUnsigned(rsrp + 140, 97);
}
/// RSRQ in whole dB, and as a code in half dB: -19.5 dB is 0.
[[nodiscard]] inline std::int32_t rsrqDb(double rsrq) {
  return rounded(rsrq, -19, -3);
}
[[nodiscard]] inline std::uint32_t rsrqCode(double rsrq) {
  return roundedUnsigned(2 * (rsrq + 19.5), 34);
}
[[nodiscard]] inline std::int32_t sinrDb(double sinr) {
  return rounded(sinr, -20, 30);
}
/// In half dB.
[[nodiscard]] inline std::int32_t sinrCode(double sinr) {
  return rounded(2 * sinr, -40, 60);
}
/// CPICH RSCP: -116 dBm is 0.
[[nodiscard]] inline std::uint32_t rscpCode(double rscp) {
  return roundedUnsigned(rscp + 116, 91);
}
/// CPICH Ec/N0 in half dB: -24.5 dB is 0.
[[nodiscard]] inline std::uint32_t ecNoCode(double ecNo) {
  return roundedUnsigned(2 * (ecNo + 24.5), 49);
}
/// RXLEV: -110 dBm is 0.
[[nodiscard]] inline std::uint32_t rxLevCode(double rxLev) {
  return roundedUnsigned(rxLev + 110, 63);
}
/// RSSI of LTE and UMTS in dBm.
[[nodiscard]] inline std::int32_t rssiDbm(double rssi) {
  return rounded(rssi, -115, -25);
}

}  // namespace vesk::handset
