#include "intake/extra_steps.h"

#include <algorithm>
#include <array>

#include "intake/value_conversions.h"
#include "system/output_lines.h"
#include "values/ordered_lookup.h"
#include "values/text_form.h"

namespace vesk {

namespace {

const std::array kUtraConversions{
    FieldConversion{"rscp"_text, convertRscp},
    FieldConversion{"ecno"_text, convertEcNo},
};
const std::array kGeranConversions{
    FieldConversion{"rxlev"_text, convertRxLev},
};
const std::array kEutraConversions{
    FieldConversion{"rsrp"_text, convertRsrp},
    FieldConversion{"rsrq"_text, convertRsrq},
};
const std::array kCpichConversions{
    FieldConversion{"cpich_rscp"_text, convertRscp},
    FieldConversion{"cpich_ecn0"_text, convertEcNo},
};
const std::array kLteNeighborConversions{
    FieldConversion{"nbr_rsrp"_text, convertRsrp},
    FieldConversion{"nbr_rsrq"_text, convertRsrq},
};
const std::array kSinrConversions{
    FieldConversion{"sinr0"_text, convertSinr},
    FieldConversion{"sinr1"_text, convertSinr},
};
const std::array kCarrierConversions{
    FieldConversion{"rsrp"_text, convertCentiInteger},
    FieldConversion{"rsrq"_text, convertCentiFloat},
    FieldConversion{"rssi"_text, convertCentiInteger},
    FieldConversion{"dl_bandwidth"_text, convertBandwidthCode},
};
const std::array kBroadcastNeighborConversions{
    FieldConversion{"dl_bw"_text, convertBandwidthCode},
};
const std::array kServingCellConversions{
    FieldConversion{"dl_bw"_text, convertHalf},
    FieldConversion{"ul_bw"_text, convertHalf},
};

/// A field that every element of a list takes over from elsewhere.
struct Stamp {
  Text key;
  /// Null takes the field away from the element.
  const Value* value;
};

Stamp timestampOf(const Record& parent) {
  return {"timestamp"_text, parent.find("timestamp"_text)};
}

bool isRecordList(const Value* value) {
  const Array* array = value == nullptr ? nullptr : value->array();
  return array != nullptr &&
         std::all_of(array->begin(), array->end(), [](const Value& each) { return each.dictionary() != nullptr; });
}

/// Fills `field` with the records of the list under `listKey`, stamped and converted. What is no list of records
/// leaves the field as it was.
void liftList(const Record& source, const Text& listKey, RecordList& field, std::initializer_list<Stamp> stamps,
              std::span<const FieldConversion> conversions = {}) {
  const Value* list = source.find(listKey);
  if (!isRecordList(list)) return;
  field.clear();
  field.reserve(list->array()->size());
  for (const Value& element : *list->array()) {
    Record& record = field.append(*element.dictionary());
    for (const auto& [key, value] : stamps) {
      if (value != nullptr) {
        record.set(key, *value);
      } else {
        record.erase(key);
      }
    }
    convertFields(record, conversions);
  }
}

/// The same, with the timestamp of the record that the list is of.
void liftStamped(const StoredMetric& metric, const Text& listKey, RecordList& field,
                 std::span<const FieldConversion> conversions = {}) {
  liftList(metric.record, listKey, field, {timestampOf(metric.record)}, conversions);
}

/// Replaces the value under `key` by its text when it is what `isMeant` asks for; the text, or null.
template <class IsMeant>
const Text* replaceByText(Record& record, const Text& key, IsMeant isMeant) {
  Value* present = record.findForChange(key);
  if (present == nullptr || !isMeant(*present)) return nullptr;
  *present = Text::copy(textOf(*present));
  return present->text();
}

bool isIntegerList(const Value& value) {
  const Array* array = value.array();
  return array != nullptr &&
         std::all_of(array->begin(), array->end(), [](const Value& each) { return each.integer().has_value(); });
}

void replaceMultiBandInfo(Record& record) {
  if (const Text* text = replaceByText(record, "multi_band_info"_text, isIntegerList))
    OutputLines::print({text->view()});
}

/// Refreshes every key of the store's record; what the source does not have becomes the empty text.
void fillTemplate(Record& store, const Record& source) {
  Record filled;
  filled.reserve(store.size());
  OrderedLookup values(source);
  for (const auto& [key, value] : store) {
    const Value* found = values.find(key);
    if (found == nullptr) {
      filled.append(key, ""_text);
    } else {
      filled.append(key, *found);
    }
  }
  store = std::move(filled);
}

}  // namespace

void takeLteServingCell(const StoredMetric& metric) {
  convertFields(metric.record, kServingCellConversions);
}

void takeLteSelectionParameters(const StoredMetric& metric) {
  auto& [record, stores, dates] = metric;
  LTE& lte = stores.myLTE;
  replaceMultiBandInfo(record);
  fillTemplate(lte.SelReselCellInfo, record);
  formatTimestamp(lte.SelReselCellInfo, dates);
  liftList(record, "nbr_eutra"_text, lte.EutraNbrs, {timestampOf(lte.SelReselCellInfo)}, kBroadcastNeighborConversions);
}

void takeLteTxPower(const StoredMetric& metric) {
  liftStamped(metric, "tx_power_info"_text, metric.stores.myLTE.TxPower);
}

void takeLteRsrpRsrqSinr(const StoredMetric& metric) {
  auto& [record, stores, dates] = metric;
  Record parent;
  if (const Value* timestamp = record.find("timestamp"_text)) parent.set("timestamp"_text, *timestamp);
  formatTimestamp(parent, dates);
  liftList(record, "inst_values"_text, stores.myLTE.RsrpRsrqSinr, {timestampOf(parent)}, kSinrConversions);
}

void takeLteCarrierAggregation(const StoredMetric& metric) {
  liftStamped(metric, "scc_list"_text, metric.stores.myLTE.CAStatusList, kCarrierConversions);
}

void takeLteInterRatNeighbors(const StoredMetric& metric) {
  LTE& lte = metric.stores.myLTE;
  liftStamped(metric, "meas_nbr_utra"_text, lte.UtraNbrsMeas, kUtraConversions);
  liftStamped(metric, "meas_nbr_geran"_text, lte.GeraNbrsMeas, kGeranConversions);
}

void takeLteNeighbors(const StoredMetric& metric) {
  liftStamped(metric, "meas_nbr_eutra"_text, metric.stores.myLTE.EutraNbrsMeas, kLteNeighborConversions);
}

void takeActiveBearers(const StoredMetric& metric) {
  liftStamped(metric, "bearer_contexts"_text, metric.stores.myCommon.activeBearer);
}

void takeEmmContext(const StoredMetric& metric) {
  replaceByText(metric.record, "guti"_text, [](const Value& value) { return value.dictionary() != nullptr; });
  replaceByText(metric.record, "tai_list"_text, [](const Value& value) { return isRecordList(&value); });
}

void takeUmtsServingCellMeasurement(const StoredMetric& metric) {
  const Record& record = metric.record;
  liftList(record, "rx_info"_text, metric.stores.myUMTS.rXInfo,
           {timestampOf(record), {"connected_mode"_text, record.find("connected_mode"_text)}});
}

void takeUmtsTxPower(const StoredMetric& metric) {
  liftStamped(metric, "tx_power_info"_text, metric.stores.myUMTS.TxPower);
}

void takeUmtsSelectionParameters(const StoredMetric& metric) {
  Record& record = metric.record;
  UMTS& umts = metric.stores.myUMTS;
  replaceMultiBandInfo(record);
  fillTemplate(umts.SelReselCellInfo, record);
  const Stamp timestamp = timestampOf(umts.SelReselCellInfo);
  liftList(record, "eutra_prio_info"_text, umts.eUtraNbrs, {timestamp});
  liftList(record, "utra_prio_info"_text, umts.utraNbrs, {timestamp});
  liftList(record, "gsm_prio_info"_text, umts.geraNbrs, {timestamp});
}

void takeUmtsNeighbors(const StoredMetric& metric) {
  UMTS& umts = metric.stores.myUMTS;
  liftStamped(metric, "meas_utra_result"_text, umts.utraNbrMeas, kUtraConversions);
  liftStamped(metric, "meas_gsm_result"_text, umts.geraNbrMeas, kGeranConversions);
  liftStamped(metric, "meas_lte_result"_text, umts.eUtraNbrMeas, kEutraConversions);
}

void takeGsmNeighbors(const StoredMetric& metric) {
  GSM& gsm = metric.stores.myGSM;
  liftStamped(metric, "gsm_ncell_meas"_text, gsm.geraNbrMeas, kGeranConversions);
  liftStamped(metric, "umts_ncell_meas"_text, gsm.utraNbrMeas, kCpichConversions);
  liftStamped(metric, "lte_ncell_meas"_text, gsm.eUtraNbrMeas, kEutraConversions);
}

void takeSimFiles(const StoredMetric& metric) {
  liftStamped(metric, "ef_list"_text, metric.stores.myCommon.simContents);
}

}  // namespace vesk
