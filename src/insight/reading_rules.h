#pragma once

#include <cstdint>
#include <limits>
#include <optional>
#include <string_view>

#include "insight/quantities.h"
#include "insight/reading.h"
#include "values/value.h"

/// The rules by which values are read: plain values, so that tables of them cost nothing to make.
namespace vesk::insight {

struct Rule;

/// Reads a value of a record by a rule. Absent when the value is of another type than the rule reads, or says no more
/// than it does itself.
using ReadValue = std::optional<Reading>(const Rule& rule, const Value& value, const Dictionary& record);
/// Reads a whole number that is in the rule's range.
using ReadCode = std::optional<Reading>(std::int64_t code);

struct Rule {
  ReadValue* read;
  ReadCode* readCode = nullptr;
  /// The possible numbers.
  std::int64_t lowest = std::numeric_limits<std::int64_t>::min();
  std::int64_t highest = std::numeric_limits<std::int64_t>::max();
  /// What a number stands for: number * scale + offset.
  double scale = 1;
  double offset = 0;
  std::string_view unit{};
  const Quantity* quantity = nullptr;
  /// Another key of the record, which has its part in the reading.
  std::string_view sibling{};
};

ReadValue readLevel, readNumber, readBandwidth, readByCode;
ReadValue readEarfcn, readUplinkEarfcn, readBand, readUarfcn, readArfcn;
ReadValue readNetworkCode, readArea, readName, readCause, readAddress;

ReadCode readMilliseconds, readSeconds, readSixMinutes, readBlocks, readBandwidthCode;
ReadCode readPci, readPsc, readBsic, readEci, readUci, readCountryCode, readAreaCode, readHexadecimal;
ReadCode readNothing, readYes, readBarred, readDrx, readTransmissionMode, readTddSubframes, readSpecialSubframe;
ReadCode readSpecialClasses, readBitErrors, readBandNumber, readSimFile, readOperationMode, readControlOrder;

/// A level, or a code that stands for code * scale + offset: "-96 dBm, fair".
constexpr Rule level(const Quantity& quantity, double scale = 1, double offset = 0) {
  return {.read = readLevel, .scale = scale, .offset = offset, .quantity = &quantity};
}
/// A number with its unit: "320 ms".
constexpr Rule number(std::string_view unit) {
  return {.read = readNumber, .unit = unit};
}
constexpr Rule number(std::string_view unit, std::int64_t lowest, std::int64_t highest) {
  return {.read = readNumber, .lowest = lowest, .highest = highest, .unit = unit};
}
/// A code that stands for code * scale + offset: "-122 dBm".
constexpr Rule code(std::string_view unit, std::int64_t lowest, std::int64_t highest, double scale, double offset = 0) {
  return {.read = readNumber, .lowest = lowest, .highest = highest, .scale = scale, .offset = offset, .unit = unit};
}
constexpr Rule byCode(ReadCode* read, std::int64_t lowest, std::int64_t highest) {
  return {.read = readByCode, .readCode = read, .lowest = lowest, .highest = highest};
}
/// An LTE band; where `earfcn` is the key of a channel, compared with its band: "B12 FDD, EARFCN is B17".
constexpr Rule band(std::string_view earfcn = {}) {
  return {.read = readBand, .sibling = earfcn};
}
/// A mobile network code, with the country code under the key `countryCode`: "608-03".
constexpr Rule networkCode(std::string_view countryCode) {
  return {.read = readNetworkCode, .lowest = 0, .highest = 999, .sibling = countryCode};
}

inline constexpr std::int64_t kHighestInteger = std::numeric_limits<std::int64_t>::max();
inline constexpr std::int64_t kHighestCellIdentity = (1 << 28) - 1;

// clang-format off
inline constexpr Rule kMilliseconds = byCode(readMilliseconds, 0, kHighestInteger);
inline constexpr Rule kSeconds = byCode(readSeconds, 0, kHighestInteger);
/// A timer in steps of 6 minutes.
inline constexpr Rule kSixMinutes = byCode(readSixMinutes, 0, 255);
/// Blocks of 480 ms.
inline constexpr Rule kBlocks = byCode(readBlocks, 4, 64);

inline constexpr Rule kEarfcn{readEarfcn};
inline constexpr Rule kUplinkEarfcn{readUplinkEarfcn};
inline constexpr Rule kUarfcn{readUarfcn};
inline constexpr Rule kArfcn{readArfcn};
/// An LTE bandwidth in MHz, and as a code.
inline constexpr Rule kBandwidth{readBandwidth};
inline constexpr Rule kBandwidthCode = byCode(readBandwidthCode, 0, 5);

inline constexpr Rule kPci = byCode(readPci, 0, 503);
inline constexpr Rule kPsc = byCode(readPsc, 0, 511);
inline constexpr Rule kBsic = byCode(readBsic, 0, 63);
inline constexpr Rule kEci = byCode(readEci, 0, kHighestCellIdentity);
inline constexpr Rule kUci = byCode(readUci, 0, kHighestCellIdentity);
inline constexpr Rule kCountryCode = byCode(readCountryCode, 0, 999);
inline constexpr Rule kAreaCode = byCode(readAreaCode, 0, 0xFFFF);
inline constexpr Rule kHexadecimal = byCode(readHexadecimal, 0, 0xFFFFFFFF);
/// A location area and a routing area, records of their own.
inline constexpr Rule kLocationArea{readArea};
inline constexpr Rule kRoutingArea{.read = readArea, .sibling = "rac"};

/// The value of an enumeration.
inline constexpr Rule kName{readName};
inline constexpr Rule kCause{readCause};
inline constexpr Rule kAddress{readAddress};
/// The number of a band of any technology.
inline constexpr Rule kBandNumber = byCode(readBandNumber, 0, kHighestInteger);
inline constexpr Rule kYes = byCode(readYes, 0, 1);
inline constexpr Rule kBarred = byCode(readBarred, 0, 1);
inline constexpr Rule kDrx = byCode(readDrx, 0, 1);
inline constexpr Rule kTransmissionMode = byCode(readTransmissionMode, 1, 10);
inline constexpr Rule kTddSubframes = byCode(readTddSubframes, 0, 6);
inline constexpr Rule kSpecialSubframe = byCode(readSpecialSubframe, 0, 9);
/// Which of the access classes 11 to 15 are barred.
inline constexpr Rule kSpecialClasses = byCode(readSpecialClasses, 0, 31);
inline constexpr Rule kBitErrors = byCode(readBitErrors, 0, 7);
inline constexpr Rule kOperationMode = byCode(readOperationMode, 0, 2);
inline constexpr Rule kControlOrder = byCode(readControlOrder, 0, 2);
inline constexpr Rule kBearerIdentity = byCode(readNothing, 5, 15);
inline constexpr Rule kSimFile = byCode(readSimFile, 0, kHighestInteger);
// clang-format on

}  // namespace vesk::insight
