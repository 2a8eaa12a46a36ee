#pragma once

#include <cstdint>
#include <optional>
#include <span>

/// What the numbers of a packet mean. A number that stands for no value gives none.
namespace vesk::diag {

/// Levels as a modem logs them: steps of 1/16 dB above a base, and 0 for none.
inline constexpr std::int32_t kRsrpBaseDbm = -180;
inline constexpr std::int32_t kRsrqBaseDb = -30;
inline constexpr std::int32_t kRssiBaseDbm = -110;

[[nodiscard]] std::optional<std::int32_t> rsrpDbm(std::uint32_t raw);
[[nodiscard]] std::optional<std::int32_t> rsrqDb(std::uint32_t raw);
/// In hundredths of a dB, above one of the bases.
[[nodiscard]] std::optional<std::int32_t> hundredthsOfDb(std::uint32_t raw, std::int32_t base);
/// dBm + 140.
[[nodiscard]] std::optional<std::int32_t> neighbourRsrp(std::uint32_t raw);
/// Half dB above -19.5 dB.
[[nodiscard]] std::optional<std::int32_t> neighbourRsrq(std::uint32_t raw);

/// SINR is logged in steps of 0.1 dB above -20 dB, and 0 for none. In units of 0.5 dB:
[[nodiscard]] std::optional<std::int32_t> sinrHalfDb(std::uint32_t raw);
[[nodiscard]] std::optional<std::int32_t> snrDb(std::uint32_t raw);

/// A level in 1/16 dBm, rounded, halves up.
[[nodiscard]] std::int32_t dbmOf(std::int32_t sixteenths);
/// The code of a GSM level: dBm + 110, within 0 to 63.
[[nodiscard]] std::uint32_t rxlevOf(std::int32_t dbm);

/// The bandwidth of an LTE carrier in units of 0.5 MHz, from its resource blocks; none for a number that no carrier
/// has.
[[nodiscard]] std::optional<std::uint32_t> bandwidthHalfMhz(std::uint32_t resourceBlocks);
/// In whole MHz, 1.4 as 1.
[[nodiscard]] std::optional<std::uint32_t> bandwidthMhz(std::uint32_t resourceBlocks);

/// A GPRS timer in seconds; none when it is deactivated or counts in another unit.
[[nodiscard]] std::optional<std::uint32_t> gprsTimerSeconds(std::uint8_t timer);

/// A network, from its three coded bytes.
struct PlmnDigits {
  std::uint32_t mcc;
  std::uint32_t mnc;
  std::uint32_t mncDigits;
};
[[nodiscard]] PlmnDigits plmnDigits(std::span<const std::uint8_t, 3> coded);

/// Sets a field of a message when there is a value for it.
template <class Message, class Value>
void setWhenKnown(Message& message, void (Message::*set)(Value), const std::optional<Value>& value) {
  if (value) (message.*set)(*value);
}

/// Sets a field of a message, or takes it out when there is no value.
template <class Message, class Value>
void setOrRemove(Message& message, void (Message::*set)(Value), void (Message::*setPresent)(bool),
                 const std::optional<Value>& value) {
  if (value) {
    (message.*set)(*value);
  } else {
    (message.*setPresent)(false);
  }
}

}  // namespace vesk::diag
