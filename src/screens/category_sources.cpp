#include "screens/category_sources.h"

#include <algorithm>
#include <array>

#include "intake/metric_table.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_classes.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

namespace {

using namespace metrics;

/// The latest record of a metric.
template <auto record>
constexpr CategorySource latest(std::string_view area, std::string_view category) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::metricRecord,
          .latestRecord = [](const Stores& stores) { return stores.*record; },
          .metric = kMetricOfRecord<record>};
}

/// A record of a technology store, which the metric changes.
template <auto store, auto field>
constexpr CategorySource record(std::string_view area, std::string_view category, std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::storeRecord,
          .storeRecord = [](const Stores& stores) { return stores.*store.*field; },
          .metric = metric};
}

/// A list of a technology store, with a section for each element: what the metric has under `listKey`.
template <auto store, auto field, class Element>
constexpr CategorySource list(std::string_view area, std::string_view category, std::string_view headerPrefix,
                              std::string_view listKey, std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::storeList,
          .list = [](const Stores& stores) { return stores.*store.*field; },
          .headerPrefix = headerPrefix,
          .elementClass = Element::kClassName,
          .listKey = listKey,
          .metric = metric};
}

/// The first element of such a list.
template <auto store, auto field, class Element>
constexpr CategorySource first(std::string_view area, std::string_view category, std::string_view listKey,
                               std::int64_t metric) {
  CategorySource source = list<store, field, Element>(area, category, {}, listKey, metric);
  source.kind = SourceKind::firstElement;
  return source;
}

constexpr CategorySource placeholder(std::string_view area, std::string_view category) {
  return {.area = area, .category = category, .kind = SourceKind::placeholder};
}

constexpr auto lte = &Stores::myLTE;
constexpr auto umts = &Stores::myUMTS;
constexpr auto gsm = &Stores::myGSM;
constexpr auto common = &Stores::myCommon;

// clang-format off
/// The menu, in its order.
constexpr std::array kSources{
    placeholder("Device Info", "IMSI"),
    placeholder("Device Info", "IMEISV"),
    list<common, &Common::simContents, ElementaryFile>(
        "Device Info", "SIM Files", "SIM Content ", "ef_list", K_SIM_FILE_INFO),

    latest<&Stores::myLTEEMMContextDict>("LTE", "NAS"),
    latest<&Stores::myLTERRCStateDict>("LTE", "RRC State"),
    latest<&Stores::myLTESCellInfoDict>("LTE", "Serving Cell Info"),
    first<lte, &LTE::RsrpRsrqSinr, RsrpRsrqSinr>("LTE", "Serving Cell Meas", "inst_values", K_LTE_RSRP_RSRQ_SINR),
    list<lte, &LTE::TxPower, TxPowerInfo>("LTE", "Tx Power", "TxPowerInfo ", "tx_power_info", K_LTE_TX_POWER),
    record<lte, &LTE::SelReselCellInfo>("LTE", "Sel Resel Parameters", K_LTE_SEL_RESEL_INFO),
    list<lte, &LTE::EutraNbrs, NbrEutra>(
        "LTE", "EUTRA Neighbor Info", "EUTRA Neighbor ", "nbr_eutra", K_LTE_SEL_RESEL_INFO),
    latest<&Stores::myLTECDRXConfigDict>("LTE", "C-DRX"),
    list<lte, &LTE::EutraNbrsMeas, EgwErrcNbrEutraMeas>(
        "LTE", "LTE Neighbor Cell Meas", "LTE Neighbor ", "meas_nbr_eutra", K_LTE_INTRARAT_MEAS),
    list<lte, &LTE::UtraNbrsMeas, EgwErrcNbrUtraMeas>(
        "LTE", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", "meas_nbr_utra", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::GeraNbrsMeas, EgwErrcNbrGeranMeas>(
        "LTE", "GSM Neighbor Cell Meas", "GSM Neighbor ", "meas_nbr_geran", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::CAStatusList, SecondaryComponentCarrier>(
        "LTE", "CA Status", "Component Carrier ", "scc_list", K_LTE_CA_STATUS),
    list<common, &Common::activeBearer, BearerContext>(
        "LTE", "Active Bearers", "PDP ", "bearer_contexts", K_CELLULAR_ACTIVE_BEARER),

    latest<&Stores::myGMMContextDict>("UMTS", "NAS GMM"),
    latest<&Stores::myMMContextDict>("UMTS", "NAS MM"),
    latest<&Stores::myUMTSRRCStateDict>("UMTS", "RRC State"),
    latest<&Stores::myUMTSRRCConfigDict>("UMTS", "RRC Configuration"),
    latest<&Stores::myUMTSCellInfoDict>("UMTS", "Serving Cell Info"),
    list<umts, &UMTS::rXInfo, RxInfo>("UMTS", "Serving Cell Meas", "RxInfo ", "rx_info", K_UMTS_SCELL_MEAS),
    list<umts, &UMTS::TxPower, TxPowerInfo>("UMTS", "Tx Power", "TxPowerInfo ", "tx_power_info", K_UMTS_TX_POWER),
    record<umts, &UMTS::SelReselCellInfo>("UMTS", "Sel Resel Parameters", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrs, EutraFreqInfo>(
        "UMTS", "EUTRA Neighbor Info", "EUTRA Neighbor ", "eutra_prio_info", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::utraNbrs, UtraFreqInfo>(
        "UMTS", "UTRA Neighbor Info", "UTRA Neighbor ", "utra_prio_info", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::geraNbrs, GsmFreqInfo>(
        "UMTS", "GSM Neighbor Info", "GSM Neighbor ", "gsm_prio_info", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrMeas, LteCellMeasResult>(
        "UMTS", "LTE Neighbor Cell Meas", "LTE Neighbor ", "meas_lte_result", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::utraNbrMeas, UtraCellMeasResult>(
        "UMTS", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", "meas_utra_result", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::geraNbrMeas, GsmCellMeasResult>(
        "UMTS", "GSM Neighbor Cell Meas", "GSM Neighbor ", "meas_gsm_result", K_UMTS_NCELL_MEAS),
    list<common, &Common::activeBearer, BearerContext>(
        "UMTS", "Active Bearers", "PDP ", "bearer_contexts", K_CELLULAR_ACTIVE_BEARER),

    latest<&Stores::myGMMContextDict>("GSM", "NAS GMM"),
    latest<&Stores::myMMContextDict>("GSM", "NAS MM"),
    latest<&Stores::myGSMScellInfoDict>("GSM", "Serving Cell Info"),
    latest<&Stores::myGSMIdleConfigInfoDict>("GSM", "Idle Config"),
    latest<&Stores::myGSMIdleScellMeasDict>("GSM", "Idle Serv Cell Meas"),
    latest<&Stores::myGSMConnRfMeasDict>("GSM", "Connected Serv Cell Meas"),
    latest<&Stores::myGSMGPRSConfigDict>("GSM", "GSM GPRS Config"),
    list<gsm, &GSM::eUtraNbrMeas, LteNcellMeas>(
        "GSM", "LTE Neighbor Cell Meas", "LTE Neighbor ", "lte_ncell_meas", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::utraNbrMeas, UmtsNcellMeas>(
        "GSM", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", "umts_ncell_meas", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::geraNbrMeas, GsmNcellMeas>(
        "GSM", "GSM Neighbor Cell Meas", "GSM Neighbor ", "gsm_ncell_meas", K_GSM_NCELL_MEAS),
    list<common, &Common::activeBearer, BearerContext>(
        "GSM", "Active Bearers", "PDP ", "bearer_contexts", K_CELLULAR_ACTIVE_BEARER),
};
// clang-format on

constexpr CategorySource kUnknown = placeholder({}, {});

}  // namespace

std::span<const CategorySource> categorySources() {
  return kSources;
}

const CategorySource& sourceOf(std::string_view area, std::string_view category) {
  const auto* found = std::find_if(kSources.begin(), kSources.end(), [&](const CategorySource& source) {
    return source.area == area && source.category == category;
  });
  return found == kSources.end() ? kUnknown : *found;
}

std::string_view messageClassOf(const CategorySource& source) {
  if (!source.elementClass.empty()) return source.elementClass;
  const MetricClass* metricClass = source.metric ? findMetricClass(*source.metric) : nullptr;
  return metricClass == nullptr ? std::string_view{} : metricClass->name;
}

RecordList shownRecords(const CategorySource& source, const Stores& stores) {
  RecordList records;
  switch (source.kind) {
    case SourceKind::metricRecord:
      if (auto record = source.latestRecord(stores)) records.append(*std::move(record));
      break;
    case SourceKind::storeRecord:
      records.append(source.storeRecord(stores));
      break;
    case SourceKind::storeList:
      return source.list(stores);
    case SourceKind::firstElement:
      if (const RecordList list = source.list(stores); list.size() > 0) records.append(list[0]);
      break;
    case SourceKind::placeholder:
      break;
  }
  return records;
}

bool isFilledBy(const CategorySource& source, const Record& record) {
  if (source.list == nullptr) return true;
  const Value* list = record.find(source.listKey);
  return list != nullptr && list->array() != nullptr;
}

bool isListFilled(const CategorySource& source, const Stores& stores) {
  if (source.list == nullptr) return true;
  const RecordList list = source.list(stores);
  return list.size() > 0 && !isWaitingForUpdate(list);
}

}  // namespace vesk
