#include "insight/readings.h"

#include <array>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace vesk::insight {

namespace {

std::string jsonOf(const std::optional<Reading>& reading) {
  if (!reading) return "null";
  std::string out;
  JsonWriter json(out);
  writeReading(json, *reading);
  json.finish();
  return out;
}

std::string readingOfOne(std::string_view messageClass, const char* key, const Value& value) {
  return jsonOf(readingOf(messageClass, Dictionary{{Text::copy(key), value}}, key));
}

Data bytes(std::vector<std::uint8_t> content) {
  return Data::copy(content);
}

constexpr const char* kImpossible = R"({"text":"impossible","mark":"impossible"})";

struct ReadingCase {
  const char* messageClass;
  const char* key;
  Value value;
  const char* reading;
};

TEST(Readings, OfSingleValues) {
  const std::vector<ReadingCase> cases{
      // Levels: grades, floors, limits.
      {"RsrpRsrqSinr", "rsrp0", -96, R"({"text":"-96 dBm, fair","value":-96,"unit":"dBm","grade":"fair"})"},
      {"RsrpRsrqSinr", "rsrp0", -100, R"({"text":"-100 dBm, fair","value":-100,"unit":"dBm","grade":"fair"})"},
      {"RsrpRsrqSinr", "rsrp1", -80, R"({"text":"-80 dBm, excellent","value":-80,"unit":"dBm","grade":"excellent"})"},
      {"RsrpRsrqSinr", "rsrp1", -140,
       R"({"text":"-140 dBm or below, poor","value":-140,"unit":"dBm","grade":"poor","mark":"floor"})"},
      {"RsrpRsrqSinr", "rsrp1", -141, R"({"text":"-141 dBm, poor","value":-141,"unit":"dBm","grade":"poor"})"},
      {"RsrpRsrqSinr", "rsrp1", -157, kImpossible},
      {"EgwErrcNbrEutraMeas", "nbr_rsrq", -19.5F,
       R"({"text":"-19.5 dB or below, poor","value":-19.5,"unit":"dB","grade":"poor","mark":"floor"})"},
      {"SecondaryComponentCarrier", "rsrq", -9.85F,
       R"({"text":"-9.85 dB, good","value":-9.85,"unit":"dB","grade":"good"})"},
      {"SecondaryComponentCarrier", "rssi", -62, R"({"text":"-62 dBm","value":-62,"unit":"dBm"})"},
      {"TxPowerInfo", "pusch_tx_power", 21, R"({"text":"21 dBm, high","value":21,"unit":"dBm","mark":"high"})"},
      {"TxPowerInfo", "pucch_tx_power", 19, R"({"text":"19 dBm","value":19,"unit":"dBm"})"},
      {"RxInfo", "rsrp_range", 21, R"({"text":"-95 dBm, fair","value":-95,"unit":"dBm","grade":"fair"})"},
      {"RxInfo", "rsrq_range", 43, R"({"text":"-3 dB, excellent","value":-3,"unit":"dB","grade":"excellent"})"},
      {"RxInfo", "rsrq_range", 50, kImpossible},
      {"KCellularGsmCsRfMeasurement", "cs_rxlev_sub", 30,
       R"({"text":"-80 dBm, good","value":-80,"unit":"dBm","grade":"good"})"},
      // Numbers with units.
      {"KCellularLteSelReselCellInfo", "QRxLevMin", -61, R"({"text":"-122 dBm","value":-122,"unit":"dBm"})"},
      {"KCellularLteSelReselCellInfo", "QRxLevMin", -71, kImpossible},
      {"KCellularLteSelReselCellInfo", "Q_hyst", 4, R"({"text":"4 dB","value":4,"unit":"dB"})"},
      {"KCellularLteSelReselCellInfo", "S_intra_search_P", 31, R"({"text":"62 dB","value":62,"unit":"dB"})"},
      {"KCellularLteSelReselCellInfo", "mo_data_ac_barring_factor", 95, R"({"text":"95 %","value":95,"unit":"%"})"},
      {"KCellularLteSelReselCellInfo", "mo_data_ac_barring_factor", 101, kImpossible},
      {"KCellularLteCdrxConfig", "long_drx_cycle_ms", 320, R"({"text":"320 ms","value":320,"unit":"ms"})"},
      {"KCellularLteCdrxConfig", "long_drx_cycle_ms", 4294967295U, kImpossible},
      {"KCellularWcdmaSelReselCellInfo", "s_rxlev", INT32_MIN, kImpossible},
      {"KCellularEmmContext", "t3412_dur_s", 3240, R"({"text":"54 min 00 s","value":3240,"unit":"s"})"},
      {"KCellularLteRrcState", "prev_state_dur_ms", 4799, R"({"text":"4.7 s","value":4799,"unit":"ms"})"},
      {"KCellularGsmIdleConfig", "radio_link_timeout", 32,
       R"({"text":"32 blocks, 15.3 s","value":32,"unit":"blocks"})"},
      {"KCellularGsmIdleConfig", "radio_link_timeout", 3, kImpossible},
      {"KCellularGsmIdleConfig", "rx_acc_min", 5, R"({"text":"-105 dBm","value":-105,"unit":"dBm"})"},
      {"KCellularGsmIdleConfig", "t3212", 10, R"({"text":"1 h 00 min"})"},
      {"KCellularGsmIdleConfig", "t3212", 0, R"({"text":"off"})"},
      {"KCellularLteScellInfo", "dl_bw", 1, R"({"text":"1.4 MHz, 6 RB","value":1.4,"unit":"MHz"})"},
      {"NbrEutra", "dl_bw", 1.4F, R"({"text":"1.4 MHz, 6 RB","value":1.4,"unit":"MHz"})"},
      {"NbrEutra", "dl_bw", 20.0F, R"({"text":"20 MHz, 100 RB","value":20,"unit":"MHz"})"},
      {"KCellularLteScellInfo", "dl_bw", 4, kImpossible},
      {"SecondaryComponentCarrier", "ul_bandwidth", 2, R"({"text":"5 MHz, 25 RB","value":5,"unit":"MHz"})"},
      {"SecondaryComponentCarrier", "ul_bandwidth", 6, kImpossible},
      // Channels.
      {"NbrEutra", "earfcn", 5815,
       R"({"text":"B17 742.5 MHz, UL 712.5 MHz","band":"17","dl_mhz":742.5,"ul_mhz":712.5,"duplex":"FDD"})"},
      {"NbrEutra", "earfcn", 38098,
       R"({"text":"B38 2604.8 MHz TDD","band":"38","dl_mhz":2604.8,"ul_mhz":2604.8,"duplex":"TDD"})"},
      {"NbrEutra", "earfcn", 9660,
       R"({"text":"B29 717.0 MHz SDL","band":"29","dl_mhz":717.0,"ul_mhz":null,"duplex":"SDL"})"},
      {"NbrEutra", "earfcn", 67286,
       R"({"text":"B66 2195.0 MHz","band":"66","dl_mhz":2195.0,"ul_mhz":null,"duplex":"FDD"})"},
      {"NbrEutra", "earfcn", 65535, kImpossible},
      {"KCellularLteScellInfo", "ul_freq", 23815,
       R"({"text":"B17 UL 712.5 MHz","band":"17","ul_mhz":712.5,"duplex":"FDD"})"},
      {"KCellularLteScellInfo", "ul_freq", 38098,
       R"({"text":"B38 2604.8 MHz TDD","band":"38","ul_mhz":2604.8,"duplex":"TDD"})"},
      {"SecondaryComponentCarrier", "ul_rf_band", 17, R"({"text":"B17 FDD","band":"17","duplex":"FDD"})"},
      {"NbrEutra", "band", 15, kImpossible},
      {"UtraCellMeasResult", "uarfcn", 10637,
       R"({"text":"band I 2127.4 MHz, UL 1937.4 MHz","band":"I","dl_mhz":2127.4,"ul_mhz":1937.4})"},
      {"GsmNcellMeas", "arfcn", 61,
       R"({"text":"P-GSM 900 947.2 MHz, UL 902.2 MHz","band":"P-GSM 900","dl_mhz":947.2,"ul_mhz":902.2})"},
      {"GsmNcellMeas", "arfcn", 562,
       R"({"text":"DCS 1800 1815.2 MHz or PCS 1900 1940.2 MHz","mark":"ambiguous","band":"DCS 1800",)"
       R"("dl_mhz":1815.2,"ul_mhz":1720.2})"},
      // Identities.
      {"RsrpRsrqSinr", "phy_cell_id", 338, R"({"text":"group 112, identity 2"})"},
      {"RsrpRsrqSinr", "phy_cell_id", 504, kImpossible},
      {"UmtsNcellMeas", "cpich_sc", 145, R"({"text":"group 18, code 1"})"},
      {"GsmNcellMeas", "bsic", 62, R"({"text":"NCC 7, BCC 6"})"},
      {"KCellularLteScellInfo", "cell_id", 48906257, R"({"text":"eNB 191040 / 17","enb":191040,"sector":17})"},
      {"KCellularLteScellInfo", "cell_id", 268435456, kImpossible},
      {"KCellularWcdmaCellInfo", "cell_id", 141294, R"({"text":"RNC 2 / cell 10222","rnc":2,"cell":10222})"},
      {"KCellularWcdmaCellInfo", "cell_id", 65535, R"({"text":"cell 65535","cell":65535})"},
      {"KCellularWcdmaCellInfo", "mcc", 1, R"({"text":"001"})"},
      {"KCellularWcdmaCellInfo", "mnc", 3, R"({"text":"03"})"},
      {"KCellularWcdmaCellInfo", "lac", 4112, R"({"text":"0x1010"})"},
      {"KCellularWcdmaCellInfo", "lac", 65534, R"({"text":"0xFFFE, reserved","mark":"reserved"})"},
      {"KCellularWcdmaCellInfo", "lac", 0, R"({"text":"0x0000, reserved","mark":"reserved"})"},
      {"KCellularMmContext", "tmsi", 0x1A0DA250, R"({"text":"0x1A0DA250"})"},
      {"KCellularMmContext", "lai", Dictionary{{"encoded_plmn"_text, bytes({0x64, 0xF0, 0})}, {"lac"_text, 4566}},
       R"({"text":"460-00 LAC 4566","plmn":"460-00"})"},
      {"KCellularGmmContext", "rai",
       Dictionary{{"encoded_plmn"_text, bytes({0x64, 0xF0, 0})}, {"lac"_text, 4566}, {"rac"_text, 100}},
       R"({"text":"460-00 LAC 4566 RAC 100","plmn":"460-00"})"},
      {"KCellularGmmContext", "rai", Dictionary{{"encoded_plmn"_text, bytes({0x64, 0xF0, 0})}, {"lac"_text, 4566}},
       "null"},
      // Words.
      {"KCellularLteRrcState", "cause", "KLTE_RRC_CAUSE_EST_MO_DATA"_text, R"({"text":"EST MO DATA"})"},
      {"KCellularLteRrcState", "cause", "(unknown: 77)"_text, "null"},
      {"KCellularGsmScellInfo", "state", "DEDICATED_STATE"_text, R"({"text":"DEDICATED STATE"})"},
      {"KCellularEmmContext", "reject_cause", "EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA"_text,
       R"({"text":"#15 NO SUITABLE CELLS IN TRACKING AREA","code":15})"},
      {"KCellularMmContext", "reject_cause", "KNAS_MM_REJ_CAUSE_NONE"_text, R"({"text":"none","code":0})"},
      {"KCellularGsmIdleConfig", "gsm_band", 44, R"({"text":"GSM EGSM 900"})"},
      {"KCellularGsmIdleConfig", "gsm_band", 99, "null"},
      {"KCellularLteSelReselCellInfo", "ims_emergency_support", 1, R"({"text":"yes"})"},
      {"KCellularLteSelReselCellInfo", "ims_emergency_support", 2, kImpossible},
      {"KCellularGsmIdleConfig", "cba", 0, R"({"text":"not barred"})"},
      {"KCellularLteCdrxConfig", "cdrx_config_status", 1, R"({"text":"set up"})"},
      {"KCellularLteCdrxConfig", "transmission_mode", 3, R"({"text":"TM3 open loop MIMO"})"},
      {"KCellularLteCdrxConfig", "transmission_mode", 0, kImpossible},
      {"KCellularLteScellInfo", "tdd_sf_assignment", 6, R"({"text":"DSUUUDSUUD"})"},
      {"KCellularLteScellInfo", "tdd_ssf_patterns", 9, R"({"text":"6/6/2"})"},
      {"KCellularLteSelReselCellInfo", "mo_data_ac_barring_for_special_ac", 20, R"({"text":"11 13 barred"})"},
      {"KCellularLteSelReselCellInfo", "mo_data_ac_barring_for_special_ac", 0, R"({"text":"none barred"})"},
      {"KCellularLteSelReselCellInfo", "mo_data_ac_barring_for_special_ac", 32, kImpossible},
      {"KCellularGsmCsRfMeasurement", "cs_rxqual_sub", 7, R"({"text":"BER above 12.8 %"})"},
      {"KCellularGsmGprsConfig", "nom", 2, R"({"text":"NMO III"})"},
      {"KCellularGsmGprsConfig", "nco", 3, kImpossible},
      {"BearerContext", "nsapi", 5, "null"},
      {"BearerContext", "nsapi", 4, kImpossible},
      {"BearerContext", "pdp_addr", bytes({10, 160, 211, 105}), R"({"text":"10.160.211.105"})"},
      {"BearerContext", "pdp_addr", bytes({0, 1, 0, 1, 0xD7, 0x9B, 0xDD, 0x52}), R"({"text":"IID 1:1:d79b:dd52"})"},
      {"BearerContext", "pdp_addr", bytes({0, 1, 0, 1, 0xD7, 0x9B, 0xDD, 0x52, 10, 0, 0, 1}),
       R"({"text":"IID 1:1:d79b:dd52 10.0.0.1"})"},
      {"BearerContext", "pdp_addr", bytes({0x20, 1, 0xD, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1}),
       R"({"text":"2001:db8:0:0:0:0:0:1"})"},
      {"BearerContext", "pdp_addr", bytes({10}), "null"},
      {"ElementaryFile", "ef_id", 0x6F07, R"({"text":"EF_IMSI"})"},
      {"ElementaryFile", "ef_id", 0x6F99, "null"},
      // No reading: another type, nothing yet, no rule.
      {"RsrpRsrqSinr", "rsrp0", true, "null"},
      {"RsrpRsrqSinr", "rsrp0", ""_text, "null"},
      {"RsrpRsrqSinr", "timestamp", 1, "null"},
      {"KCellularLteSelReselCellInfo", "priority_operating_freq", 4294967295U, "null"},
      {"SomethingElse", "rsrp0", -96, "null"},
  };
  for (const auto& [messageClass, key, value, reading] : cases)
    EXPECT_EQ(readingOfOne(messageClass, key, value), reading) << messageClass << '.' << key;
}

TEST(Readings, LookAtTheRecordsOtherKeys) {
  const auto read = [](std::string_view messageClass, const Dictionary& record, std::string_view key) {
    return jsonOf(readingOf(messageClass, record, key));
  };
  const Dictionary lte{{"dl_freq"_text, 5815},
                       {"freq_band_ind"_text, 12},
                       {"num_mnc_digits"_text, 3},
                       {"sel_plmn_mcc"_text, 310},
                       {"sel_plmn_mnc"_text, 41}};
  EXPECT_EQ(read("KCellularLteScellInfo", lte, "freq_band_ind"),
            R"({"text":"B12 FDD, EARFCN is B17","mark":"mismatch","band":"12","duplex":"FDD"})");
  EXPECT_EQ(read("KCellularLteScellInfo", lte, "sel_plmn_mnc"), R"({"text":"310-041","plmn":"310-041"})");
  const Dictionary noChannel{{"nbr_earfcn"_text, 65000}, {"freq_band_ind"_text, 12}};
  EXPECT_EQ(read("EgwErrcNbrEutraMeas", noChannel, "freq_band_ind"),
            R"({"text":"B12 FDD","band":"12","duplex":"FDD"})");
  const Dictionary named{{"arfcn"_text, 562}, {"gsm_band"_text, "SYS_BAND_GSM_PCS_1900"_text}};
  EXPECT_EQ(read("KCellularGsmScellInfo", named, "arfcn"),
            R"({"text":"PCS 1900 1940.2 MHz, UL 1860.2 MHz","band":"PCS 1900","dl_mhz":1940.2,"ul_mhz":1860.2})");
  const Dictionary numbered{{"scell_arfcn"_text, 562}, {"scell_band"_text, 47}};
  EXPECT_EQ(read("KCellularGsmCsRfMeasurement", numbered, "scell_arfcn"),
            R"({"text":"DCS 1800 1815.2 MHz, UL 1720.2 MHz","band":"DCS 1800","dl_mhz":1815.2,"ul_mhz":1720.2})");
}

}  // namespace

}  // namespace vesk::insight
