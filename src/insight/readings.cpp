#include "insight/readings.h"

#include <algorithm>
#include <array>
#include <span>

#include "insight/reading_rules.h"

namespace vesk::insight {

namespace {

struct RowRule {
  std::string_view key;
  ReadingRule rule;
};

constexpr ReadingRule kPercent = number("%", 0, 100);
/// As broadcast: levels in steps of 2 dB, qualities in dB.
constexpr ReadingRule kLeastLevel = code("dBm", -70, -22, 2);
constexpr ReadingRule kLeastQuality = number("dB", -34, -3);
constexpr ReadingRule kLevelThreshold = code("dB", 0, 31, 2);
constexpr ReadingRule kQualityThreshold = number("dB", 0, 31);

// clang-format off
constexpr RowRule kEmmContextRows[] = {
    {"reg_status", kName},
    {"update_status", kName},
    {"ue_op_mode", kName},
    {"reg_proc", kName},
    {"reject_cause", kCause},
    {"t3412_dur_s", kSeconds},
};

constexpr RowRule kMmContextRows[] = {
    {"reg_status", kName},
    {"update_status", kName},
    {"proc_failure_cause", kName},
    {"reject_cause", kCause},
    {"lai", kLocationArea},
    {"tmsi", kHexadecimal},
    {"t3212_dur_s", kSeconds},
};

constexpr RowRule kGmmContextRows[] = {
    {"reg_status", kName},
    {"update_status", kName},
    {"proc_failure_cause", kName},
    {"reg_proc", kName},
    {"reject_cause", kCause},
    {"rai", kRoutingArea},
    {"p_tmsi", kHexadecimal},
    {"t3312_dur_s", kSeconds},
};

constexpr RowRule kLteRrcStateRows[] = {
    {"state", kName},
    {"prev_state", kName},
    {"cause", kName},
    {"prev_state_dur_ms", kMilliseconds},
};

constexpr RowRule kLteScellInfoRows[] = {
    {"phy_cell_id", kPci},
    {"dl_freq", kEarfcn},
    {"ul_freq", kUplinkEarfcn},
    {"dl_bw", kBandwidth},
    {"ul_bw", kBandwidth},
    {"cell_id", kEci},
    {"freq_band_ind", band("dl_freq")},
    {"tracking_area_code", kAreaCode},
    {"sel_plmn_mcc", kCountryCode},
    {"sel_plmn_mnc", networkCode("sel_plmn_mcc")},
    {"tdd_sf_assignment", kTddSubframes},
    {"tdd_ssf_patterns", kSpecialSubframe},
};

constexpr RowRule kRsrpRsrqSinrRows[] = {
    {"phy_cell_id", kPci},
    {"rsrp0", level(kRsrp)},
    {"rsrp1", level(kRsrp)},
    {"rsrq0", level(kRsrq)},
    {"rsrq1", level(kRsrq)},
    {"sinr0", level(kSinr)},
    {"sinr1", level(kSinr)},
};

constexpr RowRule kTxPowerInfoRows[] = {
    {"pucch_tx_power", level(kTxPower)},
    {"pusch_tx_power", level(kTxPower)},
};

constexpr RowRule kLteSelReselCellInfoRows[] = {
    {"ims_emergency_support", kYes},
    {"ac_barring_for_emergency", kBarred},
    {"mo_signalling_ac_barring_factor", kPercent},
    {"mo_data_ac_barring_factor", kPercent},
    {"mo_signalling_ac_barring_time", number("s")},
    {"mo_data_ac_barring_time", number("s")},
    {"mo_signalling_ac_barring_for_special_ac", kSpecialClasses},
    {"mo_data_ac_barring_for_special_ac", kSpecialClasses},
    {"QRxLevMin", kLeastLevel},
    {"QQualMin", kLeastQuality},
    {"Q_hyst", number("dB", 0, 24)},
    {"S_non_intra_search_P", kLevelThreshold},
    {"S_intra_search_P", kLevelThreshold},
    {"Thresh_serving_lowP", kLevelThreshold},
    {"S_non_intra_search_Q", kQualityThreshold},
    {"S_intra_search_Q", kQualityThreshold},
    {"Thresh_serving_lowQ", kQualityThreshold},
};

constexpr RowRule kNbrEutraRows[] = {
    {"earfcn", kEarfcn},
    {"Q_rxlev_min", kLeastLevel},
    {"Q_qual_min", kLeastQuality},
    {"Q_offset", number("dB", -24, 24)},
    {"Pmax", number("dBm", -30, 33)},
    {"dl_bw", kBandwidth},
    {"Thres_X_highP", kLevelThreshold},
    {"Thres_X_lowP", kLevelThreshold},
    {"Thres_X_highQ", kQualityThreshold},
    {"Thres_X_lowQ", kQualityThreshold},
    {"band", band("earfcn")},
};

constexpr RowRule kLteCdrxConfigRows[] = {
    {"on_duration_ms", number("ms")},
    {"drx_inactivity_ms", number("ms")},
    {"drx_retx_timer_ms", number("ms")},
    {"long_drx_cycle_ms", number("ms")},
    {"short_drx_cycle_ms", number("ms")},
    {"rrc_state", kName},
    {"cdrx_config_status", kDrx},
    {"transmission_mode", kTransmissionMode},
};

constexpr RowRule kEgwErrcNbrEutraMeasRows[] = {
    {"nbr_earfcn", kEarfcn},
    {"nbr_phys_cell_id", kPci},
    {"freq_band_ind", band("nbr_earfcn")},
    {"nbr_rsrp", level(kRsrp)},
    {"nbr_rsrq", level(kRsrq)},
};

constexpr RowRule kEgwErrcNbrUtraMeasRows[] = {
    {"uarfcn", kUarfcn},
    {"psc", kPsc},
    {"rscp", level(kRscp)},
    {"ecno", level(kEcNo)},
};

constexpr RowRule kEgwErrcNbrGeranMeasRows[] = {
    {"arfcn", kArfcn},
    {"bsic", kBsic},
    {"rxlev", level(kRxLev)},
};

constexpr RowRule kSecondaryComponentCarrierRows[] = {
    {"state", kName},
    {"pci", kPci},
    {"dl_earfcn", kEarfcn},
    {"dl_rf_band", band("dl_earfcn")},
    {"dl_bandwidth", kBandwidth},
    {"ul_earfcn", kUplinkEarfcn},
    {"ul_rf_band", band()},
    {"ul_bandwidth", kBandwidthCode},
    {"rsrp", level(kRsrp)},
    {"rsrq", level(kRsrq)},
    {"snr", level(kSinr)},
    {"rssi", level(kRssi)},
};

constexpr RowRule kBearerContextRows[] = {
    {"nsapi", kBearerIdentity},
    {"pdp_type", kName},
    {"primary_dns_type", kName},
    {"secondary_dns_type", kName},
    {"pdp_addr", kAddress},
    {"primary_dns_addr", kAddress},
    {"secondary_dns_addr", kAddress},
};

constexpr RowRule kWcdmaRrcConnectionStateRows[] = {
    {"state", kName},
    {"establishment_cause", kName},
    {"release_cause", kName},
};

constexpr RowRule kWcdmaRrcConfigurationRows[] = {
    {"drx_cycle_length_ms", number("ms")},
};

constexpr RowRule kWcdmaCellInfoRows[] = {
    {"mcc", kCountryCode},
    {"mnc", networkCode("mcc")},
    {"lac", kAreaCode},
    {"cell_id", kUci},
    {"wcdma_band", kName},
    {"hspa", kName},
    {"dl_uarfcn", kUarfcn},
    {"psc", kPsc},
};

constexpr RowRule kRxInfoRows[] = {
    {"rssi", level(kRssi)},
    {"rsrp_range", level(kRscp, 1, -116)},
    {"rsrq_range", level(kEcNo, 0.5, -24.5)},
    {"snr", level(kSinr)},
};

constexpr RowRule kWcdmaSelReselCellInfoRows[] = {
    {"ims_emergency_support", kYes},
    {"hsdpa_capable", kYes},
    {"edch_capable", kYes},
    {"cell_barred", kBarred},
    {"s_rxlev", number("dB")},
    {"s_qual", number("dB")},
    {"s_intrasearch", number("dB")},
    {"s_intersearch", number("dB")},
    {"s_search_rat", number("dB")},
};

constexpr RowRule kEutraFreqInfoRows[] = {
    {"earfcn", kEarfcn},
};

constexpr RowRule kUtraFreqInfoRows[] = {
    {"uarfcn", kUarfcn},
};

constexpr RowRule kGsmFreqInfoRows[] = {
    {"arfcn", kArfcn},
};

constexpr RowRule kLteCellMeasResultRows[] = {
    {"earfcn", kEarfcn},
    {"phy_cell_id", kPci},
    {"eutra_band", band("earfcn")},
    {"rsrp", level(kRsrp)},
    {"rsrq", level(kRsrq)},
};

constexpr RowRule kGsmScellInfoRows[] = {
    {"mcc", kCountryCode},
    {"mnc", networkCode("mcc")},
    {"lac", kAreaCode},
    {"gsm_band", kName},
    {"state", kName},
    {"arfcn", kArfcn},
    {"bsic", kBsic},
};

constexpr RowRule kGsmIdleConfigRows[] = {
    {"arfcn_bcch", kArfcn},
    {"mcc", kCountryCode},
    {"mnc", networkCode("mcc")},
    {"lac", kAreaCode},
    {"bsic", kBsic},
    {"gsm_band", kBandNumber},
    {"radio_link_timeout", kBlocks},
    {"rx_acc_min", code("dBm", 0, 63, 1, -110)},
    {"cba", kBarred},
    {"cr_offset", code("dB", 0, 63, 2)},
    {"t3212", kSixMinutes},
};

constexpr RowRule kGsmIdleScellMeasurementRows[] = {
    {"scell_arfcn", kArfcn},
    {"idle_rxlev_dBm", level(kRxLev)},
};

constexpr RowRule kGsmCsRfMeasurementRows[] = {
    {"scell_arfcn", kArfcn},
    {"cs_rxlev_sub", level(kRxLev, 1, -110)},
    {"cs_rxqual_sub", kBitErrors},
    {"scell_band", kBandNumber},
};

constexpr RowRule kGsmGprsConfigRows[] = {
    {"nom", kOperationMode},
    {"nco", kControlOrder},
    {"cr_hyst", code("dB", 0, 7, 2)},
};

constexpr RowRule kGsmNcellMeasRows[] = {
    {"mcc", kCountryCode},
    {"mnc", networkCode("mcc")},
    {"lac", kAreaCode},
    {"arfcn", kArfcn},
    {"bsic", kBsic},
    {"rxlev", level(kRxLev)},
};

constexpr RowRule kUmtsNcellMeasRows[] = {
    {"cpich_sc", kPsc},
    {"dl_uarfcn", kUarfcn},
    {"cpich_rscp", level(kRscp)},
    {"cpich_ecn0", level(kEcNo)},
};

constexpr RowRule kLteNcellMeasRows[] = {
    {"physical_cell_id", kPci},
    {"earfcn", kEarfcn},
    {"rsrp", level(kRsrp)},
    {"rsrq", level(kRsrq)},
};

constexpr RowRule kElementaryFileRows[] = {
    {"ef_id", kSimFile},
};

struct MessageRules {
  std::string_view messageClass;
  std::span<const RowRule> rows;
};

constexpr std::array<MessageRules, 35> kMessages{{
    {"KCellularEmmContext", kEmmContextRows},
    {"KCellularMmContext", kMmContextRows},
    {"KCellularGmmContext", kGmmContextRows},
    {"KCellularLteRrcState", kLteRrcStateRows},
    {"KCellularLteScellInfo", kLteScellInfoRows},
    {"RsrpRsrqSinr", kRsrpRsrqSinrRows},
    {"TxPowerInfo", kTxPowerInfoRows},
    {"KCellularLteSelReselCellInfo", kLteSelReselCellInfoRows},
    {"NbrEutra", kNbrEutraRows},
    {"KCellularLteCdrxConfig", kLteCdrxConfigRows},
    {"EgwErrcNbrEutraMeas", kEgwErrcNbrEutraMeasRows},
    {"EgwErrcNbrUtraMeas", kEgwErrcNbrUtraMeasRows},
    {"EgwErrcNbrGeranMeas", kEgwErrcNbrGeranMeasRows},
    {"GsmCellMeasResult", kEgwErrcNbrGeranMeasRows},
    {"SecondaryComponentCarrier", kSecondaryComponentCarrierRows},
    {"BearerContext", kBearerContextRows},
    {"KCellularWcdmaRrcConnectionState", kWcdmaRrcConnectionStateRows},
    {"KCellularWcdmaRrcConfiguration", kWcdmaRrcConfigurationRows},
    {"KCellularWcdmaCellInfo", kWcdmaCellInfoRows},
    {"RxInfo", kRxInfoRows},
    {"KCellularWcdmaSelReselCellInfo", kWcdmaSelReselCellInfoRows},
    {"EutraFreqInfo", kEutraFreqInfoRows},
    {"UtraFreqInfo", kUtraFreqInfoRows},
    {"GsmFreqInfo", kGsmFreqInfoRows},
    {"LteCellMeasResult", kLteCellMeasResultRows},
    {"UtraCellMeasResult", kEgwErrcNbrUtraMeasRows},
    {"KCellularGsmScellInfo", kGsmScellInfoRows},
    {"KCellularGsmIdleConfig", kGsmIdleConfigRows},
    {"KCellularGsmIdleScellMeasurement", kGsmIdleScellMeasurementRows},
    {"KCellularGsmCsRfMeasurement", kGsmCsRfMeasurementRows},
    {"KCellularGsmGprsConfig", kGsmGprsConfigRows},
    {"GsmNcellMeas", kGsmNcellMeasRows},
    {"UmtsNcellMeas", kUmtsNcellMeasRows},
    {"LteNcellMeas", kLteNcellMeasRows},
    {"ElementaryFile", kElementaryFileRows},
}};
// clang-format on

/// The whole numbers that 32 bits hold for want of a value.
bool isNoValue(const Value& value) {
  constexpr std::array<std::int64_t, 3> kNoValues{4294967295, 2147483647, -2147483648};
  const std::optional<std::int64_t> number = value.integer();
  return number && std::find(kNoValues.begin(), kNoValues.end(), *number) != kNoValues.end();
}

const ReadingRule* findRule(std::string_view messageClass, std::string_view key) {
  const auto* message = std::find_if(kMessages.begin(), kMessages.end(),
                                     [&](const MessageRules& each) { return each.messageClass == messageClass; });
  if (message == kMessages.end()) return nullptr;
  const auto row =
      std::find_if(message->rows.begin(), message->rows.end(), [&](const RowRule& each) { return each.key == key; });
  return row == message->rows.end() ? nullptr : &row->rule;
}

std::optional<Reading> readingBy(const ReadingRule* rule, const Value& value, const Dictionary& record) {
  if (rule == nullptr) return std::nullopt;
  return isNoValue(value) ? impossibleReading() : rule->read(*rule, value, record);
}

}  // namespace

std::optional<Reading> readingOf(std::string_view messageClass, const Dictionary& record, std::string_view key) {
  const Value* value = record.find(key);
  return value == nullptr ? std::nullopt : readingBy(findRule(messageClass, key), *value, record);
}

std::optional<Reading> readingOf(std::string_view messageClass, const Dictionary& record,
                                 const Dictionary::Entry& entry) {
  return readingBy(findRule(messageClass, entry.key.view()), entry.value, record);
}

}  // namespace vesk::insight
