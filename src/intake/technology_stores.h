#pragma once

#include "values/shared_vector.h"
#include "values/value.h"

/// What the program knows of each technology besides the latest record of every metric: lists of cells, carriers,
/// bearers and files, and the selection parameters. Plain values: a copy is cheap and stays as it is.
namespace vesk {

using Record = Dictionary;
using RecordList = SharedVector<Record>;

/// What a list holds until its metric first arrives: one record that says so.
[[nodiscard]] RecordList waitingForUpdate();

struct LTE {
  /// Its keys are fixed; each is the empty text until the metric brings a value.
  Record SelReselCellInfo = initialSelReselCellInfo();
  RecordList EutraNbrs = waitingForUpdate();
  RecordList RsrpRsrqSinr = waitingForUpdate();
  RecordList TxPower = waitingForUpdate();
  RecordList EutraNbrsMeas = waitingForUpdate();
  RecordList UtraNbrsMeas = waitingForUpdate();
  RecordList GeraNbrsMeas = waitingForUpdate();
  RecordList CAStatusList = waitingForUpdate();
  RecordList MMCommonInfo = waitingForUpdate();
  Value IMSI = "Come Back Later"_text;

 private:
  [[nodiscard]] static Record initialSelReselCellInfo();
};

struct UMTS {
  RecordList rXInfo = waitingForUpdate();
  RecordList TxPower = waitingForUpdate();
  /// Its keys are fixed; each is the empty text until the metric brings a value.
  Record SelReselCellInfo = initialSelReselCellInfo();
  RecordList eUtraNbrs = waitingForUpdate();
  RecordList utraNbrs = waitingForUpdate();
  RecordList geraNbrs = waitingForUpdate();
  RecordList eUtraNbrMeas = waitingForUpdate();
  RecordList utraNbrMeas = waitingForUpdate();
  RecordList geraNbrMeas = waitingForUpdate();

 private:
  [[nodiscard]] static Record initialSelReselCellInfo();
};

struct GSM {
  RecordList eUtraNbrMeas = waitingForUpdate();
  RecordList utraNbrMeas = waitingForUpdate();
  RecordList geraNbrMeas = waitingForUpdate();
};

struct Common {
  RecordList activeBearer = waitingForUpdate();
  RecordList simContents = waitingForUpdate();
};

/// Calls `visit(name, field)` for each field of a store, in the order of its declaration.
template <class Visit>
void visitFields(const LTE& store, Visit visit) {
  visit("SelReselCellInfo", store.SelReselCellInfo);
  visit("EutraNbrs", store.EutraNbrs);
  visit("RsrpRsrqSinr", store.RsrpRsrqSinr);
  visit("TxPower", store.TxPower);
  visit("EutraNbrsMeas", store.EutraNbrsMeas);
  visit("UtraNbrsMeas", store.UtraNbrsMeas);
  visit("GeraNbrsMeas", store.GeraNbrsMeas);
  visit("CAStatusList", store.CAStatusList);
  visit("MMCommonInfo", store.MMCommonInfo);
  visit("IMSI", store.IMSI);
}

template <class Visit>
void visitFields(const UMTS& store, Visit visit) {
  visit("rXInfo", store.rXInfo);
  visit("TxPower", store.TxPower);
  visit("SelReselCellInfo", store.SelReselCellInfo);
  visit("eUtraNbrs", store.eUtraNbrs);
  visit("utraNbrs", store.utraNbrs);
  visit("geraNbrs", store.geraNbrs);
  visit("eUtraNbrMeas", store.eUtraNbrMeas);
  visit("utraNbrMeas", store.utraNbrMeas);
  visit("geraNbrMeas", store.geraNbrMeas);
}

template <class Visit>
void visitFields(const GSM& store, Visit visit) {
  visit("eUtraNbrMeas", store.eUtraNbrMeas);
  visit("utraNbrMeas", store.utraNbrMeas);
  visit("geraNbrMeas", store.geraNbrMeas);
}

template <class Visit>
void visitFields(const Common& store, Visit visit) {
  visit("activeBearer", store.activeBearer);
  visit("simContents", store.simContents);
}

}  // namespace vesk
