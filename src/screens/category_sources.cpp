#include "screens/category_sources.h"

#include <algorithm>
#include <array>

namespace vesk {

namespace {

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

template <auto store, auto field>
constexpr CategorySource list(std::string_view area, std::string_view category, std::string_view headerPrefix,
                              std::int64_t metric) {
  return {.area = area,
          .category = category,
          .kind = SourceKind::storeList,
          .list = [](const Intake& intake) { return intake.*store.*field; },
          .headerPrefix = headerPrefix,
          .metric = metric};
}

template <auto store, auto field>
constexpr CategorySource first(std::string_view area, std::string_view category, std::int64_t metric) {
  CategorySource source = list<store, field>(area, category, {}, metric);
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
    list<common, &Common::simContents>("Device Info", "SIM Files", "SIM Content ", K_SIM_FILE_INFO),

    latest<&Intake::myLTEEMMContextDict>("LTE", "NAS", K_LTE_EMM_CTXT),
    latest<&Intake::myLTERRCStateDict>("LTE", "RRC State", K_LTE_RRC_STATE),
    latest<&Intake::myLTESCellInfoDict>("LTE", "Serving Cell Info", K_LTE_SCELL_INFO),
    first<lte, &LTE::RsrpRsrqSinr>("LTE", "Serving Cell Meas", K_LTE_RSRP_RSRQ_SINR),
    list<lte, &LTE::TxPower>("LTE", "Tx Power", "TxPowerInfo ", K_LTE_TX_POWER),
    record<lte, &LTE::SelReselCellInfo>("LTE", "Sel Resel Parameters", K_LTE_SEL_RESEL_INFO),
    list<lte, &LTE::EutraNbrs>("LTE", "EUTRA Neighbor Info", "EUTRA Neighbor ", K_LTE_SEL_RESEL_INFO),
    latest<&Intake::myLTECDRXConfigDict>("LTE", "C-DRX", K_LTE_CDRX_CONFIG),
    list<lte, &LTE::EutraNbrsMeas>("LTE", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_LTE_INTRARAT_MEAS),
    list<lte, &LTE::UtraNbrsMeas>("LTE", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::GeraNbrsMeas>("LTE", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_LTE_INTERRAT_MEAS),
    list<lte, &LTE::CAStatusList>("LTE", "CA Status", "Component Carrier ", K_LTE_CA_STATUS),
    list<common, &Common::activeBearer>("LTE", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),

    latest<&Intake::myGMMContextDict>("UMTS", "NAS GMM", K_CELLULAR_GMM_CTXT),
    latest<&Intake::myMMContextDict>("UMTS", "NAS MM", K_CELLULAR_MM_CTXT),
    latest<&Intake::myUMTSRRCStateDict>("UMTS", "RRC State", K_UMTS_RRC_STATE),
    latest<&Intake::myUMTSRRCConfigDict>("UMTS", "RRC Configuration", K_UMTS_RRC_CONFIG),
    latest<&Intake::myUMTSCellInfoDict>("UMTS", "Serving Cell Info", K_UMTS_SCELL_INFO),
    list<umts, &UMTS::rXInfo>("UMTS", "Serving Cell Meas", "RxInfo ", K_UMTS_SCELL_MEAS),
    list<umts, &UMTS::TxPower>("UMTS", "Tx Power", "TxPowerInfo ", K_UMTS_TX_POWER),
    record<umts, &UMTS::SelReselCellInfo>("UMTS", "Sel Resel Parameters", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrs>("UMTS", "EUTRA Neighbor Info", "EUTRA Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::utraNbrs>("UMTS", "UTRA Neighbor Info", "UTRA Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::geraNbrs>("UMTS", "GSM Neighbor Info", "GSM Neighbor ", K_UMTS_SEL_RESEL_INFO),
    list<umts, &UMTS::eUtraNbrMeas>("UMTS", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::utraNbrMeas>("UMTS", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_UMTS_NCELL_MEAS),
    list<umts, &UMTS::geraNbrMeas>("UMTS", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_UMTS_NCELL_MEAS),
    list<common, &Common::activeBearer>("UMTS", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),

    latest<&Intake::myGMMContextDict>("GSM", "NAS GMM", K_CELLULAR_GMM_CTXT),
    latest<&Intake::myMMContextDict>("GSM", "NAS MM", K_CELLULAR_MM_CTXT),
    latest<&Intake::myGSMScellInfoDict>("GSM", "Serving Cell Info", K_GSM_SCELL_INFO),
    latest<&Intake::myGSMIdleConfigInfoDict>("GSM", "Idle Config", K_GSM_IDLE_CONFIG),
    latest<&Intake::myGSMIdleScellMeasDict>("GSM", "Idle Serv Cell Meas", K_GSM_IDLE_SCELL_MEAS),
    latest<&Intake::myGSMConnRfMeasDict>("GSM", "Connected Serv Cell Meas", K_GSM_CS_RF_MEAS),
    latest<&Intake::myGSMGPRSConfigDict>("GSM", "GSM GPRS Config", K_GSM_GPRS_CONFIG),
    list<gsm, &GSM::eUtraNbrMeas>("GSM", "LTE Neighbor Cell Meas", "LTE Neighbor ", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::utraNbrMeas>("GSM", "UMTS Neighbor Cell Meas", "UMTS Neighbor ", K_GSM_NCELL_MEAS),
    list<gsm, &GSM::geraNbrMeas>("GSM", "GSM Neighbor Cell Meas", "GSM Neighbor ", K_GSM_NCELL_MEAS),
    list<common, &Common::activeBearer>("GSM", "Active Bearers", "PDP ", K_CELLULAR_ACTIVE_BEARER),
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

}  // namespace vesk
