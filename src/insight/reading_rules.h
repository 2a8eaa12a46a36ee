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

struct ReadingRule;

/// Reads a value of a record by a rule. Absent when the value is of another type than the rule reads, or says no more
/// than it does itself.
using ReadValue = std::optional<Reading>(const ReadingRule& rule, const Value& value, const Dictionary& record);
/// Reads a whole number that is in the rule's range.
using ReadCode = std::optional<Reading>(std::int64_t code);

struct ReadingRule {
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
constexpr ReadingRule level(const Quantity& quantity, double scale = 1, double offset = 0) {
  return {.read = readLevel, .scale = scale, .offset = offset, .quantity = &quantity};
}
/// A number with its unit: "320 ms".
constexpr ReadingRule number(std::string_view unit) {
  return {.read = readNumber, .unit = unit};
}
constexpr ReadingRule number(std::string_view unit, std::int64_t lowest, std::int64_t highest) {
  return {.read = readNumber, .lowest = lowest, .highest = highest, .unit = unit};
}
/// A code that stands for code * scale + offset: "-122 dBm".
constexpr ReadingRule code(std::string_view unit, std::int64_t lowest, std::int64_t highest, double scale,
                           double offset = 0) {
  return {.read = readNumber, .lowest = lowest, .highest = highest, .scale = scale, .offset = offset, .unit = unit};
}
constexpr ReadingRule byCode(ReadCode* read, std::int64_t lowest, std::int64_t highest) {
  return {.read = readByCode, .readCode = read, .lowest = lowest, .highest = highest};
}
/// An LTE band; where `earfcn` is the key of a channel, compared with its band: "B12 FDD, EARFCN is B17".
constexpr ReadingRule band(std::string_view earfcn = {}) {
  return {.read = readBand, .sibling = earfcn};
}
/// A mobile network code, with the country code under the key `countryCode`: "608-03".
constexpr ReadingRule networkCode(std::string_view countryCode) {
  return {.read = readNetworkCode, .lowest = 0, .highest = 999, .sibling = countryCode};
}

inline constexpr std::int64_t kHighestInteger = std::numeric_limits<std::int64_t>::max();
inline constexpr std::int64_t kHighestCellIdentity = (1 << 28) - 1;

// clang-format off
inline constexpr ReadingRule kMilliseconds = byCode(readMilliseconds, 0, kHighestInteger);
inline constexpr ReadingRule kSeconds = byCode(readSeconds, 0, kHighestInteger);
/// A timer in steps of 6 minutes.
inline constexpr ReadingRule kSixMinutes = byCode(readSixMinutes, 0, 255);
/// Blocks of 480 ms.
inline constexpr ReadingRule kBlocks = byCode(readBlocks, 4, 64);

inline constexpr ReadingRule kEarfcn{readEarfcn};
inline constexpr ReadingRule kUplinkEarfcn{readUplinkEarfcn};
inline constexpr ReadingRule kUarfcn{readUarfcn};
inline constexpr ReadingRule kArfcn{readArfcn};
/// An LTE bandwidth in MHz, and as a code.
inline constexpr ReadingRule kBandwidth{readBandwidth};
inline constexpr ReadingRule kBandwidthCode = byCode(readBandwidthCode, 0, 5);

inline constexpr ReadingRule kPci = byCode(readPci, 0, 503);
inline constexpr ReadingRule kPsc = byCode(readPsc, 0, 511);
inline constexpr ReadingRule kBsic = byCode(readBsic, 0, 63);
inline constexpr ReadingRule kEci = byCode(readEci, 0, kHighestCellIdentity);
inline constexpr ReadingRule kUci = byCode(readUci, 0, kHighestCellIdentity);
inline constexpr ReadingRule kCountryCode = byCode(readCountryCode, 0, 999);
inline constexpr ReadingRule kAreaCode = byCode(readAreaCode, 0, 0xFFFF);
inline constexpr ReadingRule kHexadecimal = byCode(readHexadecimal, 0, 0xFFFFFFFF);
/// A location area and a routing area, records of their own.
inline constexpr ReadingRule kLocationArea{readArea};
inline constexpr ReadingRule kRoutingArea{.read = readArea, .sibling = "rac"};

/// The value of an enumeration.
inline constexpr ReadingRule kName{readName};
inline constexpr ReadingRule kCause{readCause};
inline constexpr ReadingRule kAddress{readAddress};
/// The number of a band of any technology.
inline constexpr ReadingRule kBandNumber = byCode(readBandNumber, 0, kHighestInteger);
inline constexpr ReadingRule kYes = byCode(readYes, 0, 1);
inline constexpr ReadingRule kBarred = byCode(readBarred, 0, 1);
inline constexpr ReadingRule kDrx = byCode(readDrx, 0, 1);
inline constexpr ReadingRule kTransmissionMode = byCode(readTransmissionMode, 1, 10);
inline constexpr ReadingRule kTddSubframes = byCode(readTddSubframes, 0, 6);
inline constexpr ReadingRule kSpecialSubframe = byCode(readSpecialSubframe, 0, 9);
/// Which of the access classes 11 to 15 are barred.
inline constexpr ReadingRule kSpecialClasses = byCode(readSpecialClasses, 0, 31);
inline constexpr ReadingRule kBitErrors = byCode(readBitErrors, 0, 7);
inline constexpr ReadingRule kOperationMode = byCode(readOperationMode, 0, 2);
inline constexpr ReadingRule kControlOrder = byCode(readControlOrder, 0, 2);
inline constexpr ReadingRule kBearerIdentity = byCode(readNothing, 5, 15);
inline constexpr ReadingRule kSimFile = byCode(readSimFile, 0, kHighestInteger);
// clang-format on

}  // namespace vesk::insight
