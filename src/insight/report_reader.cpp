#include "insight/report_reader.h"

#include <algorithm>
#include <array>
#include <limits>

#include "insight/channels.h"
#include "insight/plmn.h"
#include "insight/rrc_states.h"
#include "messages/registry/metric_identifiers.h"

namespace vesk::insight {

namespace {

using Integer = std::optional<std::int64_t>;
using Number = std::optional<double>;

constexpr std::int64_t kLastPci = 503;
constexpr std::int64_t kLastPsc = 511;
constexpr std::int64_t kLastBsic = 63;
/// Of 28 bits, on LTE and UMTS.
constexpr std::int64_t kLastCellIdentity = 268'435'455;
constexpr std::int64_t kLastAreaCode = 65'535;
constexpr std::int64_t kFirstBearer = 5;
constexpr std::int64_t kLastBearer = 15;

/// A number of the record, unless it is one of those that stand for no value in 32 bits.
Integer integerOf(const Dictionary& record, const Text& key) {
  constexpr std::array<std::int64_t, 3> kNoValues{std::numeric_limits<std::uint32_t>::max(),
                                                  std::numeric_limits<std::int32_t>::max(),
                                                  std::numeric_limits<std::int32_t>::min()};
  const Value* value = record.find(key);
  const Integer number = value == nullptr ? std::nullopt : value->integer();
  const bool isValue = number && std::find(kNoValues.begin(), kNoValues.end(), *number) == kNoValues.end();
  return isValue ? number : std::nullopt;
}

Integer integerIn(const Dictionary& record, const Text& key, std::int64_t first, std::int64_t last) {
  const Integer number = integerOf(record, key);
  return number && *number >= first && *number <= last ? number : std::nullopt;
}

/// A new band may have any EARFCN: one that lies in no known band is a channel all the same.
Integer earfcnOf(const Dictionary& record, const Text& key) {
  return integerOf(record, key);
}

Integer uarfcnOf(const Dictionary& record, const Text& key) {
  const Integer number = integerOf(record, key);
  return number && umtsChannel(*number) ? number : std::nullopt;
}

Integer arfcnOf(const Dictionary& record) {
  const Integer number = integerOf(record, "arfcn"_text);
  const auto indicated = sharedGsmBand(record.find("gsm_band"_text));
  return number && gsmChannel(*number, indicated) ? number : std::nullopt;
}

Integer pciOf(const Dictionary& record, const Text& key) {
  return integerIn(record, key, 0, kLastPci);
}
Integer pscOf(const Dictionary& record, const Text& key) {
  return integerIn(record, key, 0, kLastPsc);
}
Integer bsicOf(const Dictionary& record) {
  return integerIn(record, "bsic"_text, 0, kLastBsic);
}

Number levelOf(const Quantity& quantity, const Dictionary& record, const Text& key) {
  return possibleValue(quantity, record.find(key));
}

/// What a code in steps of `step` above `offset` stands for.
Number decodedLevel(const Quantity& quantity, const Value* code, double step, double offset) {
  const Number number = code == nullptr ? std::nullopt : code->number();
  if (!number) return std::nullopt;
  const double level = *number * step + offset;
  return isPossible(quantity, level) ? Number(level) : std::nullopt;
}

Number greater(const Number& one, const Number& other) {
  if (!one || !other) return one ? one : other;
  return std::max(*one, *other);
}

/// The greatest of what `levelIn` finds in the records.
template <class Records, class LevelIn>
Number greatest(const Records& records, LevelIn levelIn) {
  Number found;
  for (const auto& record : records)
    found = greater(found, levelIn(record));
  return found;
}

std::optional<Text> nameIn(const Dictionary& record, const Text& key) {
  const Value* value = record.find(key);
  const Text* name = value == nullptr ? nullptr : value->text();
  return name == nullptr ? std::nullopt : std::optional(*name);
}

std::optional<std::string> plmnOf(const Dictionary& record, const Text& mcc, const Text& mnc) {
  return plmnText(record.find(mcc), record.find(mnc), record.find("num_mnc_digits"_text));
}

void readArea(Report& report, Area area, const std::optional<std::string>& plmn, const Integer& code) {
  if (plmn && code) report.area = {area, *plmn + " " + std::to_string(*code)};
}

void readLteServingCell(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  report.technology = Technology::lte;
  report.servingCell = {Technology::lte,
                        {earfcnOf(record, "dl_freq"_text), pciOf(record, "phy_cell_id"_text),
                         integerIn(record, "cell_id"_text, 0, kLastCellIdentity)}};
  readArea(report, Area::tracking, plmnOf(record, "sel_plmn_mcc"_text, "sel_plmn_mnc"_text),
           integerIn(record, "tracking_area_code"_text, 0, kLastAreaCode));
}

void readUmtsServingCell(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  report.technology = Technology::umts;
  report.servingCell = {Technology::umts,
                        {uarfcnOf(record, "dl_uarfcn"_text), pscOf(record, "psc"_text),
                         integerIn(record, "cell_id"_text, 0, kLastCellIdentity)}};
  readArea(report, Area::location, plmnOf(record, "mcc"_text, "mnc"_text),
           integerIn(record, "lac"_text, 0, kLastAreaCode));
}

void readGsmServingCell(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  report.technology = Technology::gsm;
  const Value* cellId = record.find("cell_id"_text);
  report.servingCell = {Technology::gsm,
                        {arfcnOf(record), bsicOf(record), cellId == nullptr ? std::nullopt : cellId->integer()}};
  readArea(report, Area::location, plmnOf(record, "mcc"_text, "mnc"_text),
           integerIn(record, "lac"_text, 0, kLastAreaCode));
  if (const auto state = nameIn(record, "state"_text)) report.rrc = {.technology = Technology::gsm, .state = *state};
}

void readLteRrcState(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  const auto state = nameIn(record, "state"_text);
  if (!state) return;
  if (state == "KLTE_RRC_STATE_ATMPT_CONNECTION"_text || state == "KLTE_RRC_STATE_CONNECTED"_text)
    report.technology = Technology::lte;
  auto cause = nameIn(record, "cause"_text);
  if (cause == "KLTE_RRC_CAUSE_NA"_text) cause.reset();
  report.rrc = {.technology = Technology::lte,
                .state = *state,
                .previous = nameIn(record, "prev_state"_text),
                .previousDuration = integerOf(record, "prev_state_dur_ms"_text),
                .cause = std::move(cause)};
}

void readUmtsRrcState(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
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

void readLteMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("inst_values"_text) == nullptr || intake.myLTE.RsrpRsrqSinr.size() == 0) return;
  const Record& sample = intake.myLTE.RsrpRsrqSinr[0];
  const auto better = [&](const Quantity& quantity, const Text& first, const Text& second) {
    return greater(levelOf(quantity, sample, first), levelOf(quantity, sample, second));
  };
  const Number level = better(kRsrp, "rsrp0"_text, "rsrp1"_text);
  report.kpis.add(Kpi::lteRsrp, level);
  report.kpis.add(Kpi::lteRsrq, better(kRsrq, "rsrq0"_text, "rsrq1"_text));
  report.kpis.add(Kpi::lteSinr, better(kSinr, "sinr0"_text, "sinr1"_text));
  report.samplePci = pciOf(sample, "phy_cell_id"_text);
  if (level) report.technology = Technology::lte;
}

void readLteTxPower(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("tx_power_info"_text) == nullptr) return;
  const auto strongest = [&](const Text& key) {
    return greatest(intake.myLTE.TxPower, [&](const Record& each) { return levelOf(kTxPower, each, key); });
  };
  report.kpis.add(Kpi::ltePuschTxPower, strongest("pusch_tx_power"_text));
  report.kpis.add(Kpi::ltePucchTxPower, strongest("pucch_tx_power"_text));
}

void readUmtsTxPower(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("tx_power_info"_text) == nullptr) return;
  report.kpis.add(Kpi::umtsTxPower, greatest(intake.myUMTS.TxPower, [](const Record& each) {
                    return levelOf(kTxPower, each, "pusch_tx_power"_text);
                  }));
}

Number ecNoOf(const Record& chain) {
  return decodedLevel(kEcNo, chain.find("rsrq_range"_text), 0.5, -24.5);
}

/// Ec/N0 is RSCP / RSSI: where the RSCP is not reported, the two tell it.
Number rscpOf(const Record& chain) {
  if (const Value* code = chain.find("rsrp_range"_text)) return decodedLevel(kRscp, code, 1, -116);
  const Number power = levelOf(kRssi, chain, "rssi"_text);
  const Number ecNo = ecNoOf(chain);
  return power && ecNo && isPossible(kRscp, *power + *ecNo) ? Number(*power + *ecNo) : std::nullopt;
}

void readUmtsMeasurement(Report& report, const Dictionary& record, const MetricValidator& intake) {
  const Value* isConnected = record.find("connected_mode"_text);
  if (isConnected != nullptr && isConnected->boolean() != nullptr) report.isConnectedMode = *isConnected->boolean();
  if (record.find("rx_info"_text) == nullptr) return;
  const RecordList& chains = intake.myUMTS.rXInfo;
  report.kpis.add(Kpi::umtsRscp, greatest(chains, rscpOf));
  report.kpis.add(Kpi::umtsEcNo, greatest(chains, ecNoOf));
  report.kpis.add(Kpi::umtsRssi,
                  greatest(chains, [](const Record& each) { return levelOf(kRssi, each, "rssi"_text); }));
  if (!report.kpis.empty()) report.technology = Technology::umts;
}

void readGsmIdleMeasurement(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  report.kpis.add(Kpi::gsmRxLev, levelOf(kRxLev, record, "idle_rxlev_dBm"_text));
  if (!report.kpis.empty()) report.technology = Technology::gsm;
}

void readGsmConnectedMeasurement(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  const Number level = decodedLevel(kRxLev, record.find("cs_rxlev_sub"_text), 1, -110);
  report.kpis.add(Kpi::gsmRxLev, level);
  report.kpis.add(Kpi::gsmRxQual, levelOf(kRxQual, record, "cs_rxqual_sub"_text));
  if (level) report.technology = Technology::gsm;
  const Value* powers = record.find("cs_tx_pwr"_text);
  if (powers == nullptr || powers->array() == nullptr) return;
  report.kpis.add(Kpi::gsmTxPower,
                  greatest(*powers->array(), [](const Value& each) { return possibleValue(kTxPower, &each); }));
}

std::optional<CarrierState> carrierStateOf(const Dictionary& record) {
  const auto name = nameIn(record, "state"_text);
  if (name == "SCC_STATE_DECONFIGURED"_text) return CarrierState::released;
  if (name == "SCC_STATE_CONFIGURED_DEACTIVATED"_text) return CarrierState::configured;
  if (name == "SCC_STATE_ACTIVATED"_text) return CarrierState::activated;
  return std::nullopt;
}

Number bandwidthOf(const Dictionary& record) {
  constexpr std::array kBandwidths{1.4F, 3.0F, 5.0F, 10.0F, 15.0F, 20.0F};
  const Value* value = record.find("dl_bandwidth"_text);
  const std::optional<float> bandwidth = value == nullptr ? std::nullopt : value->exactFloat();
  const bool isPossible =
      bandwidth && std::find(kBandwidths.begin(), kBandwidths.end(), *bandwidth) != kBandwidths.end();
  return isPossible ? Number(*bandwidth) : std::nullopt;
}

void readCarriers(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("scc_list"_text) == nullptr) return;
  Number level;
  for (const Record& each : intake.myLTE.CAStatusList) {
    const Value* index = each.find("index"_text);
    report.carriers.push_back({.index = index == nullptr ? std::nullopt : index->integer(),
                               .state = carrierStateOf(each),
                               .channel = earfcnOf(each, "dl_earfcn"_text),
                               .code = pciOf(each, "pci"_text),
                               .bandwidth = bandwidthOf(each),
                               .level = levelOf(kRsrp, each, "rsrp"_text),
                               .quality = levelOf(kRsrq, each, "rsrq"_text)});
    if (!level) level = report.carriers.back().level;
  }
  report.kpis.add(Kpi::lteSccRsrp, level);
}

/// Under which keys a list has what is known of a cell.
struct NeighborKeys {
  Text channel;
  Text code;
  Text level;
  Text quality;
};

void readLteNeighbors(Report& report, const RecordList& list, const NeighborKeys& keys) {
  for (const Record& each : list)
    report.neighbors.push_back({Technology::lte, earfcnOf(each, keys.channel), pciOf(each, keys.code),
                                levelOf(kRsrp, each, keys.level), levelOf(kRsrq, each, keys.quality)});
}

void readUmtsNeighbors(Report& report, const RecordList& list, const NeighborKeys& keys) {
  for (const Record& each : list)
    report.neighbors.push_back({Technology::umts, uarfcnOf(each, keys.channel), pscOf(each, keys.code),
                                levelOf(kRscp, each, keys.level), levelOf(kEcNo, each, keys.quality)});
}

void readGsmNeighbors(Report& report, const RecordList& list) {
  for (const Record& each : list)
    report.neighbors.push_back(
        {Technology::gsm, arfcnOf(each), bsicOf(each), levelOf(kRxLev, each, "rxlev"_text), std::nullopt});
}

void readNeighborsOfLte(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("meas_nbr_eutra"_text) == nullptr) return;
  static const NeighborKeys kKeys{"nbr_earfcn"_text, "nbr_phys_cell_id"_text, "nbr_rsrp"_text, "nbr_rsrq"_text};
  readLteNeighbors(report, intake.myLTE.EutraNbrsMeas, kKeys);
  report.kpis.add(Kpi::lteNbrRsrp, greatest(report.neighbors, [](const NeighborReport& each) { return each.level; }));
}

const NeighborKeys& utraKeys() {
  static const NeighborKeys kKeys{"uarfcn"_text, "psc"_text, "rscp"_text, "ecno"_text};
  return kKeys;
}

void readOtherNeighborsOfLte(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("meas_nbr_utra"_text) != nullptr) readUmtsNeighbors(report, intake.myLTE.UtraNbrsMeas, utraKeys());
  if (record.find("meas_nbr_geran"_text) != nullptr) readGsmNeighbors(report, intake.myLTE.GeraNbrsMeas);
}

void readNeighborsOfUmts(Report& report, const Dictionary& record, const MetricValidator& intake) {
  static const NeighborKeys kEutraKeys{"earfcn"_text, "phy_cell_id"_text, "rsrp"_text, "rsrq"_text};
  if (record.find("meas_utra_result"_text) != nullptr) readUmtsNeighbors(report, intake.myUMTS.utraNbrMeas, utraKeys());
  if (record.find("meas_gsm_result"_text) != nullptr) readGsmNeighbors(report, intake.myUMTS.geraNbrMeas);
  if (record.find("meas_lte_result"_text) != nullptr) readLteNeighbors(report, intake.myUMTS.eUtraNbrMeas, kEutraKeys);
}

void readNeighborsOfGsm(Report& report, const Dictionary& record, const MetricValidator& intake) {
  static const NeighborKeys kUtraKeys{"dl_uarfcn"_text, "cpich_sc"_text, "cpich_rscp"_text, "cpich_ecn0"_text};
  static const NeighborKeys kEutraKeys{"earfcn"_text, "physical_cell_id"_text, "rsrp"_text, "rsrq"_text};
  if (record.find("gsm_ncell_meas"_text) != nullptr) readGsmNeighbors(report, intake.myGSM.geraNbrMeas);
  if (record.find("umts_ncell_meas"_text) != nullptr) readUmtsNeighbors(report, intake.myGSM.utraNbrMeas, kUtraKeys);
  if (record.find("lte_ncell_meas"_text) != nullptr) readLteNeighbors(report, intake.myGSM.eUtraNbrMeas, kEutraKeys);
}

template <Registration registration>
void readRegistration(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  report.registration = {registration, nameIn(record, "reg_status"_text), nameIn(record, "reg_proc"_text),
                         nameIn(record, "reject_cause"_text)};
}

void readGmmContext(Report& report, const Dictionary& record, const MetricValidator& intake) {
  readRegistration<Registration::gmm>(report, record, intake);
  const Value* value = record.find("rai"_text);
  const Dictionary* rai = value == nullptr ? nullptr : value->dictionary();
  if (rai == nullptr) return;
  const auto plmn = encodedPlmnText(*rai);
  const Value* lac = rai->find("lac"_text);
  const Value* rac = rai->find("rac"_text);
  if (!plmn || lac == nullptr || rac == nullptr || !lac->integer() || !rac->integer()) return;
  report.area = {Area::routing, *plmn + " " + std::to_string(*lac->integer()) + " " + std::to_string(*rac->integer())};
}

void readBearers(Report& report, const Dictionary& record, const MetricValidator& intake) {
  if (record.find("bearer_contexts"_text) == nullptr) {
    const Value* count = record.find("bearer_context_count"_text);
    if (count != nullptr && count->integer() == 0) report.bearers.emplace();
    return;
  }
  std::vector<Bearer>& bearers = report.bearers.emplace();
  for (const Record& each : intake.myCommon.activeBearer) {
    const Value* cid = each.find("cid"_text);
    Integer number = integerIn(each, "nsapi"_text, kFirstBearer, kLastBearer);
    if (!number && cid != nullptr) number = cid->integer();
    if (number) bearers.push_back({*number, nameIn(each, "apn"_text), nameIn(each, "pdp_type"_text)});
  }
}

void readCdrx(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  if (const auto state = nameIn(record, "rrc_state"_text))
    report.rrc = {.technology = Technology::lte, .state = *state, .isMention = true};
  const Integer status = integerIn(record, "cdrx_config_status"_text, 0, 1);
  if (!status) return;
  report.cdrx = {*status == 1,
                 {integerOf(record, "on_duration_ms"_text), integerOf(record, "drx_inactivity_ms"_text),
                  integerOf(record, "long_drx_cycle_ms"_text), integerOf(record, "short_drx_cycle_ms"_text)}};
}

void readSimFiles(Report& report, const Dictionary& record, const MetricValidator& /*intake*/) {
  const Value* files = record.find("ef_list"_text);
  if (files != nullptr && files->array() != nullptr) report.simFiles = files->array()->size();
}

struct MetricReading {
  std::int64_t metricId;
  void (*read)(Report& report, const Dictionary& record, const MetricValidator& intake);
};

/// The others say nothing here.
constexpr std::array kReadings{
    MetricReading{K_LTE_RSRP_RSRQ_SINR, readLteMeasurement},
    MetricReading{K_LTE_INTRARAT_MEAS, readNeighborsOfLte},
    MetricReading{K_UMTS_SCELL_MEAS, readUmtsMeasurement},
    MetricReading{K_LTE_TX_POWER, readLteTxPower},
    MetricReading{K_UMTS_TX_POWER, readUmtsTxPower},
    MetricReading{K_LTE_CDRX_CONFIG, readCdrx},
    MetricReading{K_LTE_RRC_STATE, readLteRrcState},
    MetricReading{K_LTE_SCELL_INFO, readLteServingCell},
    MetricReading{K_LTE_CA_STATUS, readCarriers},
    MetricReading{K_LTE_INTERRAT_MEAS, readOtherNeighborsOfLte},
    MetricReading{K_CELLULAR_ACTIVE_BEARER, readBearers},
    MetricReading{K_LTE_EMM_CTXT, readRegistration<Registration::emm>},
    MetricReading{K_CELLULAR_MM_CTXT, readRegistration<Registration::mm>},
    MetricReading{K_CELLULAR_GMM_CTXT, readGmmContext},
    MetricReading{K_UMTS_RRC_STATE, readUmtsRrcState},
    MetricReading{K_UMTS_SCELL_INFO, readUmtsServingCell},
    MetricReading{K_UMTS_NCELL_MEAS, readNeighborsOfUmts},
    MetricReading{K_GSM_SCELL_INFO, readGsmServingCell},
    MetricReading{K_GSM_IDLE_SCELL_MEAS, readGsmIdleMeasurement},
    MetricReading{K_GSM_CS_RF_MEAS, readGsmConnectedMeasurement},
    MetricReading{K_GSM_NCELL_MEAS, readNeighborsOfGsm},
    MetricReading{K_SIM_FILE_INFO, readSimFiles},
};

/// Nothing is said; the lists keep their storage.
void clear(Report& report) {
  report.technology.reset();
  report.kpis.clear();
  report.samplePci.reset();
  report.isConnectedMode.reset();
  report.servingCell.reset();
  report.area.reset();
  report.rrc.reset();
  report.registration.reset();
  report.carriers.clear();
  report.bearers.reset();
  report.cdrx.reset();
  report.simFiles.reset();
  report.neighbors.clear();
}

}  // namespace

const Report& ReportReader::read(std::int64_t metricId, const Dictionary& record, const MetricValidator& intake) {
  clear(report_);
  const auto* reading = std::find_if(kReadings.begin(), kReadings.end(),
                                     [metricId](const MetricReading& each) { return each.metricId == metricId; });
  if (reading != kReadings.end()) reading->read(report_, record, intake);
  return report_;
}

}  // namespace vesk::insight
