#pragma once

#include <concepts>
#include <type_traits>

#include "values/shared_vector.h"
#include "values/value.h"

/// What the program knows of each technology besides the latest record of every metric: lists of cells, carriers,
/// bearers and files, and the selection parameters. Plain values: a copy is cheap and stays as it is.
namespace vesk {

using Record = Dictionary;
using RecordList = SharedVector<Record>;

/// What a list holds until its metric first arrives: one record that says so.
[[nodiscard]] RecordList waitingForUpdate();

/// Whether that is all the list holds.
[[nodiscard]] bool isWaitingForUpdate(const RecordList& list);

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

  friend bool operator==(const LTE&, const LTE&) = default;

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

  friend bool operator==(const UMTS&, const UMTS&) = default;

 private:
  [[nodiscard]] static Record initialSelReselCellInfo();
};

struct GSM {
  RecordList eUtraNbrMeas = waitingForUpdate();
  RecordList utraNbrMeas = waitingForUpdate();
  RecordList geraNbrMeas = waitingForUpdate();

  friend bool operator==(const GSM&, const GSM&) = default;
};

struct Common {
  RecordList activeBearer = waitingForUpdate();
  RecordList simContents = waitingForUpdate();

  friend bool operator==(const Common&, const Common&) = default;
};

/// Whether `T` is `Store`, const or not.
template <class T, class Store>
concept SameButConst = std::same_as<std::remove_const_t<T>, Store>;

/// Calls `visit(name, field)` for each field of a store, in the order of its declaration.
template <SameButConst<LTE> Store, class Visit>
void visitFields(Store& store, Visit visit) {
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

template <SameButConst<UMTS> Store, class Visit>
void visitFields(Store& store, Visit visit) {
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

template <SameButConst<GSM> Store, class Visit>
void visitFields(Store& store, Visit visit) {
  visit("eUtraNbrMeas", store.eUtraNbrMeas);
  visit("utraNbrMeas", store.utraNbrMeas);
  visit("geraNbrMeas", store.geraNbrMeas);
}

template <SameButConst<Common> Store, class Visit>
void visitFields(Store& store, Visit visit) {
  visit("activeBearer", store.activeBearer);
  visit("simContents", store.simContents);
}

}  // namespace vesk
