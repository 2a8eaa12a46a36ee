#pragma once

#include "insight/report.h"
#include "intake/stores.h"

/// What each kind of metric says: one function for each, from its record and from the lists that the intake made of it.
namespace vesk::insight {

void readLteServingCell(Report& report, const Dictionary& record, const Stores& stores);
void readUmtsServingCell(Report& report, const Dictionary& record, const Stores& stores);
void readGsmServingCell(Report& report, const Dictionary& record, const Stores& stores);
void readLteRrcState(Report& report, const Dictionary& record, const Stores& stores);
void readUmtsRrcState(Report& report, const Dictionary& record, const Stores& stores);
void readLteMeasurement(Report& report, const Dictionary& record, const Stores& stores);
void readLteTxPower(Report& report, const Dictionary& record, const Stores& stores);
void readUmtsTxPower(Report& report, const Dictionary& record, const Stores& stores);
void readUmtsMeasurement(Report& report, const Dictionary& record, const Stores& stores);
void readGsmIdleMeasurement(Report& report, const Dictionary& record, const Stores& stores);
void readGsmConnectedMeasurement(Report& report, const Dictionary& record, const Stores& stores);
void readCarriers(Report& report, const Dictionary& record, const Stores& stores);
void readNeighborsOfLte(Report& report, const Dictionary& record, const Stores& stores);
void readOtherNeighborsOfLte(Report& report, const Dictionary& record, const Stores& stores);
void readNeighborsOfUmts(Report& report, const Dictionary& record, const Stores& stores);
void readNeighborsOfGsm(Report& report, const Dictionary& record, const Stores& stores);
void readGmmContext(Report& report, const Dictionary& record, const Stores& stores);
void readBearers(Report& report, const Dictionary& record, const Stores& stores);
void readLteSelection(Report& report, const Dictionary& record, const Stores& stores);
void readCdrx(Report& report, const Dictionary& record, const Stores& stores);
void readSimFiles(Report& report, const Dictionary& record, const Stores& stores);
template <Registration registration>
void readRegistration(Report& report, const Dictionary& record, const Stores& stores);

}  // namespace vesk::insight
