#include "intake/extra_steps.h"

#include <algorithm>
#include <array>

#include "intake/metric_validator.h"
#include "intake/value_conversions.h"
#include "system/output_lines.h"
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

/// The entry under `key`, looked for from `from` on, and then before it; the end when there is none.
const Dictionary::Entry* findFrom(const Record& record, const Dictionary::Entry* from, const Text& key) {
  const auto isMeant = [&](const Dictionary::Entry& entry) { return entry.key == key; };
  const auto* found = std::find_if(from, record.end(), isMeant);
  if (found != record.end()) return found;
  found = std::find_if(record.begin(), from, isMeant);
  return found == from ? record.end() : found;
}

/// Refreshes every key of the store's record; what the source does not have becomes the empty text.
void fillTemplate(Record& store, const Record& source) {
  Record filled;
  filled.reserve(store.size());
  // Both have their keys in much the same order.
  const auto* next = source.begin();
  for (const auto& [key, value] : store) {
    const auto* found = findFrom(source, next, key);
    if (found == source.end()) {
      filled.append(key, ""_text);
    } else {
      filled.append(key, found->value);
      next = found + 1;
    }
  }
  store = std::move(filled);
}

}  // namespace

void takeLteServingCell(MetricValidator& intake) {
  convertFields(*intake.myLTESCellInfoDict, kServingCellConversions);
}

void takeLteSelectionParameters(MetricValidator& intake) {
  Record& source = *intake.myLTESelReselDict;
  Record& parameters = intake.myLTE.SelReselCellInfo;
  replaceMultiBandInfo(source);
  fillTemplate(parameters, source);
  intake.formatTimestampOf(parameters);
  liftList(source, "nbr_eutra"_text, intake.myLTE.EutraNbrs, {timestampOf(parameters)}, kBroadcastNeighborConversions);
}

void takeLteTxPower(MetricValidator& intake) {
  const Record& source = *intake.myLTETxPowerDict;
  liftList(source, "tx_power_info"_text, intake.myLTE.TxPower, {timestampOf(source)});
}

void takeLteRsrpRsrqSinr(MetricValidator& intake) {
  const Record& source = *intake.myLTERsrpRsrqSinrDict;
  Record parent;
  if (const Value* timestamp = source.find("timestamp"_text)) parent.set("timestamp"_text, *timestamp);
  intake.formatTimestampOf(parent);
  liftList(source, "inst_values"_text, intake.myLTE.RsrpRsrqSinr, {timestampOf(parent)}, kSinrConversions);
}

void takeLteCarrierAggregation(MetricValidator& intake) {
  const Record& source = *intake.myLTECAStatusDict;
  liftList(source, "scc_list"_text, intake.myLTE.CAStatusList, {timestampOf(source)}, kCarrierConversions);
}

void takeLteInterRatNeighbors(MetricValidator& intake) {
  const Record& source = *intake.myLTEInterRatMeasDict;
  liftList(source, "meas_nbr_utra"_text, intake.myLTE.UtraNbrsMeas, {timestampOf(source)}, kUtraConversions);
  liftList(source, "meas_nbr_geran"_text, intake.myLTE.GeraNbrsMeas, {timestampOf(source)}, kGeranConversions);
}

void takeLteNeighbors(MetricValidator& intake) {
  const Record& source = *intake.myLTEIntraRatMeasDict;
  liftList(source, "meas_nbr_eutra"_text, intake.myLTE.EutraNbrsMeas, {timestampOf(source)}, kLteNeighborConversions);
}

void takeActiveBearers(MetricValidator& intake) {
  const Record& source = *intake.myCellularActiveBearerDict;
  liftList(source, "bearer_contexts"_text, intake.myCommon.activeBearer, {timestampOf(source)});
}

void takeEmmContext(MetricValidator& intake) {
  Record& source = *intake.myLTEEMMContextDict;
  replaceByText(source, "guti"_text, [](const Value& value) { return value.dictionary() != nullptr; });
  replaceByText(source, "tai_list"_text, [](const Value& value) { return isRecordList(&value); });
}

void takeUmtsServingCellMeasurement(MetricValidator& intake) {
  const Record& source = *intake.myUMTSCellMeasDict;
  liftList(source, "rx_info"_text, intake.myUMTS.rXInfo,
           {timestampOf(source), {"connected_mode"_text, source.find("connected_mode"_text)}});
}

void takeUmtsTxPower(MetricValidator& intake) {
  const Record& source = *intake.myUMTSTxPowerDict;
  liftList(source, "tx_power_info"_text, intake.myUMTS.TxPower, {timestampOf(source)});
}

void takeUmtsSelectionParameters(MetricValidator& intake) {
  Record& source = *intake.myUMTSSelReselDict;
  Record& parameters = intake.myUMTS.SelReselCellInfo;
  replaceMultiBandInfo(source);
  fillTemplate(parameters, source);
  liftList(source, "eutra_prio_info"_text, intake.myUMTS.eUtraNbrs, {timestampOf(parameters)});
  liftList(source, "utra_prio_info"_text, intake.myUMTS.utraNbrs, {timestampOf(parameters)});
  liftList(source, "gsm_prio_info"_text, intake.myUMTS.geraNbrs, {timestampOf(parameters)});
}

void takeUmtsNeighbors(MetricValidator& intake) {
  const Record& source = *intake.myUMTSNbrMeasDict;
  liftList(source, "meas_utra_result"_text, intake.myUMTS.utraNbrMeas, {timestampOf(source)}, kUtraConversions);
  liftList(source, "meas_gsm_result"_text, intake.myUMTS.geraNbrMeas, {timestampOf(source)}, kGeranConversions);
  liftList(source, "meas_lte_result"_text, intake.myUMTS.eUtraNbrMeas, {timestampOf(source)}, kEutraConversions);
}

void takeGsmNeighbors(MetricValidator& intake) {
  const Record& source = *intake.myGSMNbrMeasDict;
  liftList(source, "gsm_ncell_meas"_text, intake.myGSM.geraNbrMeas, {timestampOf(source)}, kGeranConversions);
  liftList(source, "umts_ncell_meas"_text, intake.myGSM.utraNbrMeas, {timestampOf(source)}, kCpichConversions);
  liftList(source, "lte_ncell_meas"_text, intake.myGSM.eUtraNbrMeas, {timestampOf(source)}, kEutraConversions);
}

void takeSimFiles(MetricValidator& intake) {
  const Record& source = *intake.mySIMFileInfoDict;
  liftList(source, "ef_list"_text, intake.myCommon.simContents, {timestampOf(source)});
}

}  // namespace vesk
