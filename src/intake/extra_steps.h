#pragma once

/// What the intake does with a record beyond keeping it: it converts values in place and lifts lists into the
/// technology stores. One function for each kind of metric that has more to it, on the record just stored.
namespace vesk {

class MetricValidator;

void takeLteServingCell(MetricValidator& intake);
void takeLteSelectionParameters(MetricValidator& intake);
void takeLteTxPower(MetricValidator& intake);
void takeLteRsrpRsrqSinr(MetricValidator& intake);
void takeLteCarrierAggregation(MetricValidator& intake);
void takeLteInterRatNeighbors(MetricValidator& intake);
void takeLteNeighbors(MetricValidator& intake);
void takeActiveBearers(MetricValidator& intake);
void takeEmmContext(MetricValidator& intake);
void takeUmtsServingCellMeasurement(MetricValidator& intake);
void takeUmtsTxPower(MetricValidator& intake);
void takeUmtsSelectionParameters(MetricValidator& intake);
void takeUmtsNeighbors(MetricValidator& intake);
void takeGsmNeighbors(MetricValidator& intake);
void takeSimFiles(MetricValidator& intake);

}  // namespace vesk
