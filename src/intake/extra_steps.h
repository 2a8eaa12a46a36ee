#pragma once

#include "intake/stores.h"

/// What the intake does with some metrics beyond storing their record: one function a metric, named in its row of the
/// table of metrics. A step lifts lists of the record into fields of the technology stores, where every element is
/// converted to the units that an engineer reads and stamped with the record's "timestamp". The field of a list that
/// the record lacks, or that holds anything but records, stays as it was.
namespace vesk {

class DateFormat;

/// A metric that has just been stored.
struct StoredMetric {
  /// The latest record of the metric: one of the stores' own.
  Record& record;
  Stores& stores;
  DateFormat& dates;
};

using ExtraStep = void (*)(const StoredMetric& metric);

/// Halves the bandwidths of the record itself.
void takeLteServingCell(const StoredMetric& metric);
/// Puts the list of bands into words, and prints it; refreshes every key of SelReselCellInfo, with an empty text for
/// what the record lacks. The elements of the list are stamped with the timestamp that SelReselCellInfo shows.
void takeLteSelectionParameters(const StoredMetric& metric);
void takeLteTxPower(const StoredMetric& metric);
/// The elements are stamped with the date; the record keeps the number.
void takeLteRsrpRsrqSinr(const StoredMetric& metric);
void takeLteCarrierAggregation(const StoredMetric& metric);
void takeLteInterRatNeighbors(const StoredMetric& metric);
void takeLteNeighbors(const StoredMetric& metric);
void takeActiveBearers(const StoredMetric& metric);
/// Puts the temporary identity and the tracking areas of the record into words.
void takeEmmContext(const StoredMetric& metric);
/// The elements take over "connected_mode" as well.
void takeUmtsServingCellMeasurement(const StoredMetric& metric);
void takeUmtsTxPower(const StoredMetric& metric);
/// As for LTE.
void takeUmtsSelectionParameters(const StoredMetric& metric);
void takeUmtsNeighbors(const StoredMetric& metric);
void takeGsmNeighbors(const StoredMetric& metric);
void takeSimFiles(const StoredMetric& metric);

}  // namespace vesk
