#include "screens/category_sources.h"

#include <algorithm>
#include <array>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_classes.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

namespace {

using namespace metrics;
using Intake = MetricValidator;

/// A latest record.
template <auto record>
constexpr CategorySource latest(std::string_view area, std::string_view category, std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::metricRecord,
          .latestRecord = [](const Intake& intake) { return intake.*record; },
          .metric = metric};
}

template <auto store, auto field>
constexpr CategorySource record(std::string_view area, std::string_view category, std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::storeRecord,
          .storeRecord = [](const Intake& intake) { return intake.*store.*field; },
          .metric = metric};
}

template <auto store, auto field, class Element>
constexpr CategorySource list(std::string_view area, std::string_view category, std::string_view headerPrefix,
                              std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::storeList,
          .list = [](const Intake& intake) { return intake.*store.*field; },
          .headerPrefix = headerPrefix,
          .elementClass = Element::kClassName,
          .metric = metric};
}

template <auto store, auto field, class Element>
constexpr CategorySource first(std::string_view area, std::string_view category, std::int64_t metric) {
  CategorySource source = list<store, field, Element>(area, category, {}, metric);
  source.kind = SourceKind::firstElement;
  return source;
}

constexpr CategorySource placeholder(std::string_view area, std::string_view category) {
  return {.area = area, .category = category, .kind = SourceKind::placeholder};
}

constexpr auto lte = &Intake::myLTE;
constexpr auto umts = &Intake::myUMTS;
constexpr auto gsm = &Intake::myGSM;
constexpr auto common = &Intake::myCommon;

// clang-format off
constexpr std::array kSources{
    placeholder("Device Info", "IMSI"),
    placeholder("Device Info", "IMEISV"),
    list<common, &Common::simContents, ElementaryFile>("Device Info", "SIM Files", "SIM Content ", K_SIM_FILE_INFO),

    latest<&Intake::myLTEEMMContextDict>("LTE", "NAS", K_LTE_EMM_CTXT),
    latest<&Intake::myLTERRCStateDict>("LTE", "RRC State", K_LTE_RRC_STATE),
    latest<&Intake::myLTESCellInfoDict>("LTE", "Serving Cell Info", K_LTE_SCELL_INFO),
    first<lte, &LTE::RsrpRsrqSinr, RsrpRsrqSinr>("LTE", "Serving Cell Meas", K_LTE_RSRP_RSRQ_SINR),
    list<lte, &LTE::TxPower, TxPowerInfo>("LTE", "Tx Power", "TxPowerInfo ", K_LTE_TX_POWER),
    record<lte, &LTE::SelReselCellInfo>("LTE", "Sel Resel Parameters", K_LTE_SEL_RESEL_INFO),
    list<lte, &LTE::EutraNbrs, NbrEutra>("LTE", "EUTRA Neighbor Info", "EUTRA Neighbor ", K_LTE_SEL_RESEL_INFO),
    latest<&Intake::myLTECDRXConfigDict>("LTE", "C-DRX", K_LTE_CDRX_CONFIG),
    list<lte, &LTE::EutraNbrsMeas, EgwErrcNbrEutraMeas>("LTE", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_LTE_INTRARAT_MEAS),
    list<lte, &LTE::UtraNbrsMeas, EgwErrcNbrUtraMeas>("LTE", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::GeraNbrsMeas, EgwErrcNbrGeranMeas>("LTE", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::CAStatusList, SecondaryComponentCarrier>("LTE", "CA Status", "Component Carrier ", K_LTE_CA_STATUS),
    list<common, &Common::activeBearer, BearerContext>("LTE", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),

    latest<&Intake::myGMMContextDict>("UMTS", "NAS GMM", K_CELLULAR_GMM_CTXT),
    latest<&Intake::myMMContextDict>("UMTS", "NAS MM", K_CELLULAR_MM_CTXT),
    latest<&Intake::myUMTSRRCStateDict>("UMTS", "RRC State", K_UMTS_RRC_STATE),
    latest<&Intake::myUMTSRRCConfigDict>("UMTS", "RRC Configuration", K_UMTS_RRC_CONFIG),
    latest<&Intake::myUMTSCellInfoDict>("UMTS", "Serving Cell Info", K_UMTS_SCELL_INFO),
    list<umts, &UMTS::rXInfo, RxInfo>("UMTS", "Serving Cell Meas", "RxInfo ", K_UMTS_SCELL_MEAS),
    list<umts, &UMTS::TxPower, TxPowerInfo>("UMTS", "Tx Power", "TxPowerInfo ", K_UMTS_TX_POWER),
    record<umts, &UMTS::SelReselCellInfo>("UMTS", "Sel Resel Parameters", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrs, EutraFreqInfo>("UMTS", "EUTRA Neighbor Info", "EUTRA Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::utraNbrs, UtraFreqInfo>("UMTS", "UTRA Neighbor Info", "UTRA Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::geraNbrs, GsmFreqInfo>("UMTS", "GSM Neighbor Info", "GSM Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrMeas, LteCellMeasResult>("UMTS", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::utraNbrMeas, UtraCellMeasResult>("UMTS", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::geraNbrMeas, GsmCellMeasResult>("UMTS", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_UMTS_NCELL_MEAS),
    list<common, &Common::activeBearer, BearerContext>("UMTS", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),

    latest<&Intake::myGMMContextDict>("GSM", "NAS GMM", K_CELLULAR_GMM_CTXT),
    latest<&Intake::myMMContextDict>("GSM", "NAS MM", K_CELLULAR_MM_CTXT),
    latest<&Intake::myGSMScellInfoDict>("GSM", "Serving Cell Info", K_GSM_SCELL_INFO),
    latest<&Intake::myGSMIdleConfigInfoDict>("GSM", "Idle Config", K_GSM_IDLE_CONFIG),
    latest<&Intake::myGSMIdleScellMeasDict>("GSM", "Idle Serv Cell Meas", K_GSM_IDLE_SCELL_MEAS),
    latest<&Intake::myGSMConnRfMeasDict>("GSM", "Connected Serv Cell Meas", K_GSM_CS_RF_MEAS),
    latest<&Intake::myGSMGPRSConfigDict>("GSM", "GSM GPRS Config", K_GSM_GPRS_CONFIG),
    list<gsm, &GSM::eUtraNbrMeas, LteNcellMeas>("GSM", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::utraNbrMeas, UmtsNcellMeas>("GSM", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::geraNbrMeas, GsmNcellMeas>("GSM", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_GSM_NCELL_MEAS),
    list<common, &Common::activeBearer, BearerContext>("GSM", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),
};
// clang-format on
static_assert(kSources.size() == 42);

constexpr CategorySource kUnknown = placeholder({}, {});

}  // namespace

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

RecordList shownRecords(const CategorySource& source, const MetricValidator& intake) {
  RecordList records;
  switch (source.kind) {
    case SourceKind::metricRecord:
      if (auto record = source.latestRecord(intake)) records.append(*std::move(record));
      break;
    case SourceKind::storeRecord:
      records.append(source.storeRecord(intake));
      break;
    case SourceKind::storeList:
      return source.list(intake);
    case SourceKind::firstElement:
      if (const RecordList list = source.list(intake); list.size() > 0) records.append(list[0]);
      break;
    case SourceKind::placeholder:
      break;
  }
  return records;
}

}  // namespace vesk
