#pragma once

#include "insight/report.h"
#include "intake/metric_validator.h"

/// What each kind of metric says: one function for each, from its record and from the lists that the intake made of it.
namespace vesk::insight {

void readLteServingCell(Report& report, const Dictionary& record, const MetricValidator& intake);
void readUmtsServingCell(Report& report, const Dictionary& record, const MetricValidator& intake);
void readGsmServingCell(Report& report, const Dictionary& record, const MetricValidator& intake);
void readLteRrcState(Report& report, const Dictionary& record, const MetricValidator& intake);
void readUmtsRrcState(Report& report, const Dictionary& record, const MetricValidator& intake);
void readLteMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake);
void readLteTxPower(Report& report, const Dictionary& record, const MetricValidator& intake);
void readUmtsTxPower(Report& report, const Dictionary& record, const MetricValidator& intake);
void readUmtsMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake);
void readGsmIdleMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake);
void readGsmConnectedMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake);
void readCarriers(Report& report, const Dictionary& record, const MetricValidator& intake);
void readNeighborsOfLte(Report& report, const Dictionary& record, const MetricValidator& intake);
void readOtherNeighborsOfLte(Report& report, const Dictionary& record, const MetricValidator& intake);
void readNeighborsOfUmts(Report& report, const Dictionary& record, const MetricValidator& intake);
void readNeighborsOfGsm(Report& report, const Dictionary& record, const MetricValidator& intake);
void readGmmContext(Report& report, const Dictionary& record, const MetricValidator& intake);
void readBearers(Report& report, const Dictionary& record, const MetricValidator& intake);
void readCdrx(Report& report, const Dictionary& record, const MetricValidator& intake);
void readSimFiles(Report& report, const Dictionary& record, const MetricValidator& intake);
template <Registration registration>
void readRegistration(Report& report, const Dictionary& record, const MetricValidator& intake);

}  // namespace vesk::insight
