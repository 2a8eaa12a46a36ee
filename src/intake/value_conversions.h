#pragma once

#include <span>

#include "values/value.h"

/// From a value as the handset reports it to the one that an engineer reads.
namespace vesk {

class DateFormat;

/// Turns the record's "timestamp", milliseconds since 1970-01-01 00:00:00 UTC, into a date in words. One that is
/// missing or no number stays as it is.
void formatTimestamp(Dictionary& record, DateFormat& dates);

/// Converts the value under `key`, which is of `record`. One of a type that the conversion is not for stays as it is.
using ConvertValue = void (*)(Dictionary& record, const Text& key);

/// Which field of a record is converted how.
struct FieldConversion {
  Text key;
  ConvertValue convert;
};

void convertFields(Dictionary& record, std::span<const FieldConversion> conversions);

/// Reported RSCP to dBm: an integer, less 116.
void convertRscp(Dictionary& record, const Text& key);
/// Reported Ec/N0 to dB: half of a float, less 24.5.
void convertEcNo(Dictionary& record, const Text& key);
/// Reported RXLEV to dBm: an integer, less 110.
void convertRxLev(Dictionary& record, const Text& key);
/// Reported RSRP to dBm: an integer, less 140.
void convertRsrp(Dictionary& record, const Text& key);
/// Reported RSRQ to dB: half of a float, less 19.5.
void convertRsrq(Dictionary& record, const Text& key);
/// Reported SINR to dB: half of a float.
void convertSinr(Dictionary& record, const Text& key);
/// Hundredths to whole units: an integer, truncated toward zero.
void convertCentiInteger(Dictionary& record, const Text& key);
/// Hundredths to units: a float.
void convertCentiFloat(Dictionary& record, const Text& key);
/// An LTE bandwidth code to MHz: a 32-bit integer to a float. A code that is not in dlbwlookup takes the key away.
void convertBandwidthCode(Dictionary& record, const Text& key);
/// Halves a 32-bit integer, truncated toward zero.
void convertHalf(Dictionary& record, const Text& key);

}  // namespace vesk
