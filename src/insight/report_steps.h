#pragma once

#include "insight/report.h"
#include "intake/stores.h"
#include "values/ordered_lookup.h"

/// What each kind of metric says: one function for each, from its record and from the lists that the intake made of it.
namespace vesk::insight {

void readLteServingCell(Report& report, OrderedLookup& record, const Stores& stores);
void readUmtsServingCell(Report& report, OrderedLookup& record, const Stores& stores);
void readGsmServingCell(Report& report, OrderedLookup& record, const Stores& stores);
void readLteRrcState(Report& report, OrderedLookup& record, const Stores& stores);
void readUmtsRrcState(Report& report, OrderedLookup& record, const Stores& stores);
void readLteMeasurement(Report& report, OrderedLookup& record, const Stores& stores);
void readLteTxPower(Report& report, OrderedLookup& record, const Stores& stores);
void readUmtsTxPower(Report& report, OrderedLookup& record, const Stores& stores);
void readUmtsMeasurement(Report& report, OrderedLookup& record, const Stores& stores);
void readGsmIdleMeasurement(Report& report, OrderedLookup& record, const Stores& stores);
void readGsmConnectedMeasurement(Report& report, OrderedLookup& record, const Stores& stores);
void readCarriers(Report& report, OrderedLookup& record, const Stores& stores);
void readNeighborsOfLte(Report& report, OrderedLookup& record, const Stores& stores);
void readOtherNeighborsOfLte(Report& report, OrderedLookup& record, const Stores& stores);
void readNeighborsOfUmts(Report& report, OrderedLookup& record, const Stores& stores);
void readNeighborsOfGsm(Report& report, OrderedLookup& record, const Stores& stores);
void readGmmContext(Report& report, OrderedLookup& record, const Stores& stores);
void readBearers(Report& report, OrderedLookup& record, const Stores& stores);
void readLteSelection(Report& report, OrderedLookup& record, const Stores& stores);
void readCdrx(Report& report, OrderedLookup& record, const Stores& stores);
void readSimFiles(Report& report, OrderedLookup& record, const Stores& stores);
template <Registration registration>
void readRegistration(Report& report, OrderedLookup& record, const Stores& stores);

}  // namespace vesk::insight
