#include <algorithm>
#include <array>

#include "insight/plmn.h"
#include "insight/report_fields.h"
#include "insight/report_steps.h"
#include "insight/rrc_states.h"

namespace vesk::insight {

namespace {

/// Of 28 bits, on LTE and UMTS.
constexpr std::int64_t kLastCellIdentity = 268'435'455;
constexpr std::int64_t kLastAreaCode = 65'535;
constexpr std::int64_t kFirstBearer = 5;
constexpr std::int64_t kLastBearer = 15;

std::optional<Plmn> plmnIn(OrderedLookup& record, const Text& mccKey, const Text& mncKey) {
  const Value* mcc = record.find(mccKey);
  const Value* mnc = record.find(mncKey);
  return plmnOf(mcc, mnc, record.find("num_mnc_digits"_text));
}

void readArea(Report& report, Area area, const std::optional<Plmn>& plmn, const Integer& code) {
  if (plmn && code) report.area = {area, {*plmn, *code}};
}

void readLocationArea(Report& report, OrderedLookup& record) {
  const auto plmn = plmnIn(record, "mcc"_text, "mnc"_text);
  readArea(report, Area::location, plmn, integerIn(record, "lac"_text, 0, kLastAreaCode));
}

std::optional<CarrierState> carrierStateOf(OrderedLookup& record) {
  const auto name = nameIn(record, "state"_text);
  if (name == "SCC_STATE_DECONFIGURED"_text) return CarrierState::released;
  if (name == "SCC_STATE_CONFIGURED_DEACTIVATED"_text) return CarrierState::configured;
  if (name == "SCC_STATE_ACTIVATED"_text) return CarrierState::activated;
  return std::nullopt;
}

Number carrierBandwidthOf(OrderedLookup& record) {
  constexpr std::array kCarrierBandwidths{1.4F, 3.0F, 5.0F, 10.0F, 15.0F, 20.0F};
  const Value* value = record.find("dl_bandwidth"_text);
  const std::optional<float> bandwidth = value == nullptr ? std::nullopt : value->exactFloat();
  const bool isPossible = bandwidth && std::find(kCarrierBandwidths.begin(), kCarrierBandwidths.end(), *bandwidth) !=
                                           kCarrierBandwidths.end();
  return isPossible ? Number(*bandwidth) : std::nullopt;
}

/// The serving cell's comes in whole MHz.
Number bandwidthOf(OrderedLookup& record) {
  constexpr std::array kServingBandwidths{1, 3, 5, 10, 15, 20};
  const Integer bandwidth = integerOf(record, "dl_bw"_text);
  if (!bandwidth ||
      std::find(kServingBandwidths.begin(), kServingBandwidths.end(), *bandwidth) == kServingBandwidths.end())
    return {};
  return *bandwidth == 1 ? 1.4 : static_cast<double>(*bandwidth);
}

}  // namespace

void readLteServingCell(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  report.technology = Technology::lte;
  const Integer pci = pciOf(record, "phy_cell_id"_text);
  const Integer earfcn = earfcnOf(record, "dl_freq"_text);
  report.bandwidth = bandwidthOf(record);
  const Integer cellId = integerIn(record, "cell_id"_text, 0, kLastCellIdentity);
  report.servingCell = {Technology::lte, {earfcn, pci, cellId}};
  const Integer areaCode = integerIn(record, "tracking_area_code"_text, 0, kLastAreaCode);
  readArea(report, Area::tracking, plmnIn(record, "sel_plmn_mcc"_text, "sel_plmn_mnc"_text), areaCode);
}

void readUmtsServingCell(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  report.technology = Technology::umts;
  readLocationArea(report, record);
  const Integer cellId = integerIn(record, "cell_id"_text, 0, kLastCellIdentity);
  const Integer uarfcn = uarfcnOf(record, "dl_uarfcn"_text);
  report.servingCell = {Technology::umts, {uarfcn, pscOf(record, "psc"_text), cellId}};
}

void readGsmServingCell(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  report.technology = Technology::gsm;
  readLocationArea(report, record);
  const Integer cellId = anyInteger(record, "cell_id"_text);
  const auto band = sharedGsmBand(record.find("gsm_band"_text));
  const Integer arfcn = arfcnOf(record, band);
  report.servingCell = {Technology::gsm, {arfcn, bsicOf(record), cellId}};
  if (const auto state = nameIn(record, "state"_text)) report.rrc = {.technology = Technology::gsm, .state = *state};
}

void readLteRrcState(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  const auto state = nameIn(record, "state"_text);
  if (!state) return;
  if (state == "KLTE_RRC_STATE_ATMPT_CONNECTION"_text || state == "KLTE_RRC_STATE_CONNECTED"_text)
    report.technology = Technology::lte;
  report.rrc = {.technology = Technology::lte,
                .state = *state,
                .previous = nameIn(record, "prev_state"_text),
                .previousDuration = integerOf(record, "prev_state_dur_ms"_text),
                .cause = nameIn(record, "cause"_text)};
  if (report.rrc->cause == "KLTE_RRC_CAUSE_NA"_text) report.rrc->cause.reset();
}

void readUmtsRrcState(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  static const std::array kInUse{
      "KWCDMA_RRC_CONN_STATE_CELL_DCH"_text,  "KWCDMA_RRC_CONN_STATE_CELL_FACH"_text,
      "KWCDMA_RRC_CONN_STATE_CELL_PCH"_text,  "KWCDMA_RRC_CONN_STATE_URA_PCH"_text,
      "KWCDMA_RRC_CONN_STATE_ESTABLISH"_text,
  };
  const auto state = nameIn(record, "state"_text);
  if (!state) return;
  if (std::find(kInUse.begin(), kInUse.end(), *state) != kInUse.end()) report.technology = Technology::umts;
  const bool isIdle = rrcClassOf(Technology::umts, *state) == RrcClass::idle;
  report.rrc = {.technology = Technology::umts,
                .state = *state,
                .cause = nameIn(record, isIdle ? "release_cause"_text : "establishment_cause"_text)};
}

void readCarriers(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("scc_list"_text) == nullptr) return;
  Number level;
  for (const Record& element : stores.myLTE.CAStatusList) {
    OrderedLookup each(element);
    report.carriers.push_back({.index = anyInteger(each, "index"_text),
                               .state = carrierStateOf(each),
                               .code = pciOf(each, "pci"_text),
                               .channel = earfcnOf(each, "dl_earfcn"_text),
                               .bandwidth = carrierBandwidthOf(each),
                               .level = levelOf(kRsrp, each, "rsrp"_text),
                               .quality = levelOf(kRsrq, each, "rsrq"_text)});
    if (!level) level = report.carriers.back().level;
  }
  report.kpis.add(Kpi::lteSccRsrp, level);
}

template <Registration registration>
void readRegistration(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  report.registration = {registration, nameIn(record, "reg_status"_text), nameIn(record, "reject_cause"_text),
                         nameIn(record, "reg_proc"_text)};
}

template void readRegistration<Registration::emm>(Report&, OrderedLookup&, const Stores&);
template void readRegistration<Registration::mm>(Report&, OrderedLookup&, const Stores&);

void readGmmContext(Report& report, OrderedLookup& record, const Stores& stores) {
  readRegistration<Registration::gmm>(report, record, stores);
  const Value* value = record.find("rai"_text);
  const Dictionary* rai = value == nullptr ? nullptr : value->dictionary();
  if (rai == nullptr) return;
  OrderedLookup routing(*rai);
  const auto plmn = encodedPlmnOf(*rai);
  const Integer lac = anyInteger(routing, "lac"_text);
  const Integer rac = anyInteger(routing, "rac"_text);
  if (plmn && lac && rac) report.area = {Area::routing, {*plmn, *lac, rac}};
}

void readBearers(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("bearer_contexts"_text) == nullptr) {
    if (anyInteger(record, "bearer_context_count"_text) == 0) report.bearers.emplace();
    return;
  }
  std::vector<Bearer>& bearers = report.bearers.emplace();
  for (const Record& element : stores.myCommon.activeBearer) {
    OrderedLookup each(element);
    Integer number = integerIn(each, "nsapi"_text, kFirstBearer, kLastBearer);
    if (!number) number = anyInteger(each, "cid"_text);
    if (number) bearers.push_back({*number, nameIn(each, "apn"_text), nameIn(each, "pdp_type"_text)});
  }
}

void readLteSelection(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  const Integer code = integerIn(record, "QRxLevMin"_text, -70, -22);
  if (code) report.leastLevel = 2.0 * static_cast<double>(*code);
}

void readCdrx(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  const CdrxParameters parameters{integerOf(record, "on_duration_ms"_text), integerOf(record, "drx_inactivity_ms"_text),
                                  integerOf(record, "long_drx_cycle_ms"_text),
                                  integerOf(record, "short_drx_cycle_ms"_text)};
  if (const auto state = nameIn(record, "rrc_state"_text))
    report.rrc = {.technology = Technology::lte, .state = *state, .isMention = true};
  if (const Integer status = integerIn(record, "cdrx_config_status"_text, 0, 1))
    report.cdrx = {*status == 1, parameters};
  report.transmissionMode = integerIn(record, "transmission_mode"_text, 1, 10);
}

void readSimFiles(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  const Value* files = record.find("ef_list"_text);
  if (files != nullptr && files->array() != nullptr) report.simFiles = files->array()->size();
}

}  // namespace vesk::insight
