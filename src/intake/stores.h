#pragma once

#include <cstdint>
#include <optional>
#include <type_traits>

#include "intake/technology_stores.h"

namespace vesk {

/// The latest record of a kind of metric; absent until the first one.
using LatestRecord = std::optional<Record>;

/// All that the intake keeps: what each technology's lists hold, and the latest record of every kind of metric,
/// myLTERRCStateDict and its like. A plain value: a copy is cheap and stays as it is, and two can be compared.
struct Stores {
  LTE myLTE;
  UMTS myUMTS;
  GSM myGSM;
  Common myCommon;

#define DECODED_METRIC(constant, identifier, Message, record) LatestRecord record{};
#include "messages/registry/metrics.def"

  friend bool operator==(const Stores&, const Stores&) = default;
};

/// The latest record of that metric; null where no event of it was stored.
[[nodiscard]] inline const Record* latestRecordOf(const Stores& stores, std::int64_t metric) {
#define DECODED_METRIC(constant, identifier, Message, record) \
  if (metric == (identifier)) return stores.record ? &*stores.record : nullptr;
#include "messages/registry/metrics.def"
  return nullptr;
}

/// Calls `visit(name, record)` for the latest record of each kind of metric, in the order of the table of metrics.
template <SameButConst<Stores> S, class Visit>
void visitLatestRecords(S& stores, Visit visit) {
#define DECODED_METRIC(constant, identifier, Message, record) visit(#record, stores.record);
#include "messages/registry/metrics.def"
}

/// Calls `visit(name, field)` for each field of all technology stores.
template <SameButConst<Stores> S, class Visit>
void visitTechnologyFields(S& stores, Visit visit) {
  visitFields(stores.myLTE, visit);
  visitFields(stores.myUMTS, visit);
  visitFields(stores.myGSM, visit);
  visitFields(stores.myCommon, visit);
}

}  // namespace vesk
