#include <gtest/gtest.h>

#include "diag/translation/log_kind.h"
#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

// clang-format off
const TranslationCase kLteCells[] = {
    {0xB0C2, "b0=3 h1=503 w3=68935 w7=131071 b11=6 b12=100 w13=268435455 h17=65535 w19=71 h23=999 b25=3 h26=998",
     "LteScellInfo{phy_cell_id: 503, dl_freq: 68935, ul_freq: 131071, dl_bw: 3, ul_bw: 40, cell_id: 268435455, "
     "freq_band_ind: 71, tracking_area_code: 65535, num_mnc_digits: 3, sel_plmn_mcc: 999, sel_plmn_mnc: 998} "
     "LteComponentCarrierInfo{pcc_earfcn: 68935, pcc_bandwidth: 1}"},
    {0xB0C2, "b0=2 h1=1 h3=100 h5=18100 b7=74 b8=15 w9=257 h13=2 w15=1 h19=310 b21=2 h22=41",
     "LteScellInfo{phy_cell_id: 1, dl_freq: 100, ul_freq: 18100, ul_bw: 6, cell_id: 257, "
     "freq_band_ind: 1, tracking_area_code: 2, num_mnc_digits: 2, sel_plmn_mcc: 310, sel_plmn_mnc: 41} "
     "LteComponentCarrierInfo{pcc_earfcn: 100}"},
    {0xB17F, "b0=4 h6[0:9]=511 h6[9:7]=127 w8[0:12]=1288 w16[0:10]=312",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 511, rsrp0: -99, rsrq0: -10}]}"},
    {0xB17F, "b0=5 h8[0:9]=3 w12[0:12]=1287 w20[0:10]=0",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 3, rsrp0: -100}]}"},
    {0xB17F, "b0=5 h8[0:9]=3 w20[0:10]=5", ""},
};

const TranslationCase kLteServingMeasurements[] = {
    {0xB193, "b0=1 b1=1 b4=25 b5=18 h6=76 @8 w0=2175 @12 h0[0:9]=511 h0[12:1]=1 "
             "w16[10:12]=1000 w20[12:12]=1100 w24[12:12]=1100 w28[12:10]=300 w32[0:10]=312 w64[0:9]=511 w64[9:9]=1",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: "
     "[{phy_cell_id: 511, rsrp0: -117, rsrp1: -111, rsrq0: -11, rsrq1: -10, sinr0: 62, sinr1: -40}]}"},
    // Of a chain without RSRP nothing counts.
    {0xB193, "b0=1 b1=1 b4=25 b5=19 h6=80 @8 w0=39650 @16 h0[0:9]=1 h0[9:3]=7 h0[12:1]=1 "
             "w20[12:12]=1100 w24[12:12]=1100 w32[20:10]=301 w40[0:11]=2047 w64[0:9]=400 w64[9:9]=205",
     "LteCarrierAggregationStatus{scc_list: [{index: 7, pci: 1, dl_earfcn: 39650, dl_rf_band: 41, "
     "rsrp: -11125, rsrq: -1119, snr: 1, rssi: 1794}]}"},
    {0xB193, "b0=1 b1=1 b4=25 b5=19 h6=80 @8 w0=39650 @16 h0[0:9]=2 h0[12:1]=1 w28[12:10]=300 w64[0:9]=400",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 2}]}"},
    {0xB193, "b0=1 b1=1 b4=25 b5=35 h6=96 @8 w0=10360 @16 h0[0:9]=7 "
             "w16[10:12]=1100 w28[12:12]=460 w44[0:10]=1023 w80=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_earfcn: 10360, nbr_phys_cell_id: 7, nbr_rsrp: 29, nbr_rsrq: 107}]}"},
    // The second neighbour's levels contradict each other. What is served stands before the neighbours.
    {0xB193, "b0=1 b1=1 b4=25 b5=36 h6=524 @8 w0=300 h4=4 "
             "@16 h0[0:9]=4 w16[10:12]=640 w28[12:12]=0 @144 h0[0:9]=5 w16[10:12]=700 w28[12:12]=61 "
             "@272 h0[0:9]=6 h0[12:1]=1 w16[10:12]=640 w20[12:12]=700 w28[12:12]=60 w36[20:10]=1 w36[0:10]=480 "
             "w80[0:9]=200 w80[9:9]=202 @400 h0[0:9]=8 h0[9:3]=2 h0[12:1]=1 w20[12:12]=700 w28[12:12]=60 w44[0:10]=480 "
             "w56[0:11]=1 w80[9:9]=511 w124=0",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: "
     "[{phy_cell_id: 6, rsrp0: -140, rsrp1: -136, rsrq0: 0, rsrq1: -30, sinr0: 0, sinr1: 0}]} "
     "LteCarrierAggregationStatus{scc_list: [{index: 2, pci: 8, dl_earfcn: 300, dl_rf_band: 1, "
     "rsrp: -13625, rsrq: 0, snr: 31, rssi: -10994}]} "
     "LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_earfcn: 300, nbr_phys_cell_id: 4, freq_band_ind: 1, nbr_rsrp: 0}]}"},
    {0xB193, "b0=1 b1=1 b4=25 b5=40 h6=100 @8 w0=300 @16 h0[0:9]=9 h0[12:1]=1 w16[10:12]=4095 w20[12:12]=4000 "
             "w32[12:12]=3455 w40[0:10]=2 w40[20:10]=10 w84[0:9]=3 w84[9:9]=2",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: "
     "[{phy_cell_id: 9, rsrp0: 76, rsrp1: 70, rsrq0: -30, rsrq1: -29, sinr0: -39, sinr1: -40}]}"},
    {0xB193, "b0=1 b1=1 b4=25 b5=48 h6=156 @8 w0=300 h4=1 @20 h0[0:9]=9 h0[9:3]=1 h0[12:1]=1 w16[10:12]=1000 "
             "w20[12:12]=900 w32[12:12]=360 w48[0:10]=200 w60[0:11]=600 w92[0:9]=94 w92[9:9]=95 w136=0",
     "LteCarrierAggregationStatus{scc_list: [{index: 1, pci: 9, dl_earfcn: 300, dl_rf_band: 1, "
     "rsrp: -11750, rsrq: -1750, snr: -10, rssi: -7250}]}"},
    {0xB193, "b0=1 b1=1 b4=25 b5=60 h6=308 @8 w0=300 h4=2 @24 h0[0:9]=9 h0[15:1]=1 w16[10:12]=1000 w32[12:12]=360 "
             "w40[0:10]=200 w92[0:9]=94 @172 h0[0:9]=10 h0[12:1]=1 w20[12:12]=1000 w32[12:12]=360 w48[0:10]=200 w136=0",
     "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 9, rsrp0: -117, rsrq0: -17}]} "
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 300, nbr_phys_cell_id: 10, freq_band_ind: 1, nbr_rsrp: 23, nbr_rsrq: 4}]}"},
};

const TranslationCase kLteNeighbours[] = {
    {0xB179, "b0=4 w8=65536 b24=2 @28 h0=503 h2=1288 h6=312 @40 h0=101 h6=9 h10=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 65536, nbr_phys_cell_id: 503, freq_band_ind: 65, nbr_rsrp: 41, nbr_rsrq: 18}]}"},
    {0xB179, "b0=4 w8=65536 b24=0", ""},
    {0xB179, "b0=3 h8=65535 b22=1 @24 h0=4 h2=1 h6=4 h10=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_earfcn: 65535, nbr_phys_cell_id: 4, nbr_rsrp: -40, nbr_rsrq: -20}]}"},
    {0xB195, "b0=1 b1=2 b4=30 b5=3 h6=4 @8 b0=31 b1=4 h2=64 @12 w0=66436 h4[0:6]=1 h4[6:10]=1023 "
             "@20 w0[0:10]=1023 w12[0:12]=4095 w20[10:10]=1023 w48=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 66436, nbr_phys_cell_id: 1023, freq_band_ind: 66, nbr_rsrp: 216, nbr_rsrq: 107}]}"},
    {0xB195, "b0=1 b1=1 b4=31 b5=3 h6=60 @8 h0=599 h2[0:6]=1 @12 w0[0:10]=1 w12[0:12]=640 w20[10:10]=168 w48=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 599, nbr_phys_cell_id: 1, freq_band_ind: 1, nbr_rsrp: 0, nbr_rsrq: 0}]}"},
    {0xB192, "b0=1 b1=2 b4=27 b5=4 h6=64 @8 w0=68585 h4[0:6]=1 @16 w0[0:10]=2 w12[0:12]=648 w20[10:10]=172 "
             "@68 b0=27 b1=2 h2=60 @72 h0=600 h2[0:6]=1 @76 w0[0:10]=3 w12[0:12]=647 w20[10:10]=171 w48=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 68585, nbr_phys_cell_id: 2, freq_band_ind: 70, nbr_rsrp: 1, nbr_rsrq: 1}, "
     "{nbr_earfcn: 600, nbr_phys_cell_id: 3, freq_band_ind: 2, nbr_rsrp: 0, nbr_rsrq: 0}]}"},
    {0xB180, "b0=5 w4=55240 w8[6:26]=1 w8[0:6]=63 @12 w0[0:9]=511 w0[20:12]=1000 w8[12:10]=0 w28=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 55240, nbr_phys_cell_id: 511, freq_band_ind: 48, nbr_rsrp: 23}]}"},
    {0xB180, "b0=4 h4=36949 h6[6:10]=1 @8 w0[0:9]=7 w0[20:12]=1000 w8[12:10]=200 w28=0",
     "LteNbrEutraCellMeas{meas_nbr_eutra: "
     "[{nbr_earfcn: 36949, nbr_phys_cell_id: 7, freq_band_ind: 35, nbr_rsrp: 23, nbr_rsrq: 4}]}"},
};

const TranslationCase kLteTransmitPowers[] = {
    {0xB139, "b0=43 h1[9:5]=1 @8 h0=10239 b24[0:7]=-1 b24[7:1]=1 b63=0",
     "LteTxPower{tx_power_info: [{pusch_tx_power: -1, subframe_index: 10239}]}"},
    {0xB139, "b0=102 h1[9:5]=2 @8 h0=5 b2[0:2]=0 b2[2:6]=63 b24[0:7]=-64 @76 h0=6 b2[0:2]=1 b24[0:7]=9 b67=0",
     "LteTxPower{tx_power_info: [{pusch_tx_power: -64, subframe_index: 5}]}"},
    {0xB139, "b0=122 h1[9:5]=1 @8 h0=0 b2[0:2]=3 b24[0:7]=9 b67=0", ""},
    {0xB139, "b0=124 h1[9:5]=2 @8 h0=1 b24[0:7]=63 @92 h0=2 b24[0:7]=-14 b83=0",
     "LteTxPower{tx_power_info: [{pusch_tx_power: 63, subframe_index: 1}, {pusch_tx_power: -14, subframe_index: 2}]}"},
    {0xB139, "b0=144 h1[9:5]=1 @8 h0=1 b24[0:7]=1 b40[0:7]=23 b99=0",
     "LteTxPower{tx_power_info: [{pusch_tx_power: 23, subframe_index: 1}]}"},
    {0xB139, "b0=145 h1[9:5]=2 @8 h0=1 b2[0:2]=2 b40[0:7]=23 @108 h0=2 b40[0:7]=0 b99=0",
     "LteTxPower{tx_power_info: [{pusch_tx_power: 0, subframe_index: 2}]}"},
    {0xB13C, "b0=43 h1[9:5]=1 @8 h0=9 b4=3 b23[0:7]=-22 b35=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: -22, subframe_index: 9}]}"},
    {0xB13C, "b0=101 h1[9:5]=1 @8 h0=9 b4[2:6]=63 b23[0:7]=-2 b23[7:1]=1 b35=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: -2, subframe_index: 9}]}"},
    {0xB13C, "b0=121 h1[9:5]=2 @8 h0=9 b4[0:2]=1 b23[0:7]=-2 @44 h0=10 b23[0:7]=1 b35=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: 1, subframe_index: 10}]}"},
    {0xB13C, "b0=142 h1[9:5]=1 @8 h0=9 b23[0:7]=4 b51=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: 4, subframe_index: 9}]}"},
    {0xB16E, "b0=25 b3=2 @4 w0[3:10]=1023 w0[13:4]=9 w8[15:8]=-1 @16 w0[0:3]=4 w8[15:8]=5",
     "LteTxPower{tx_power_info: [{pusch_tx_power: -1, subframe_index: 10239}]}"},
    {0xB16E, "b0=5 b3=1 @4 w0[0:10]=1023 w0[10:4]=0 w8[15:8]=-128",
     "LteTxPower{tx_power_info: [{pusch_tx_power: -128, subframe_index: 10230}]}"},
    {0xB16E, "b0=4 b3=1 @4 w0[0:10]=1 w0[10:4]=9 w8[5:8]=127",
     "LteTxPower{tx_power_info: [{pusch_tx_power: 127, subframe_index: 19}]}"},
    {0xB16F, "b0=4 b3=1 @4 w0[0:10]=7 w0[10:4]=1 b10=-23 b11=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: -23, subframe_index: 71}]}"},
    {0xB16F, "b0=24 b3=1 @4 w0[0:10]=512 w0[10:4]=2 b10=23 b11=0",
     "LteTxPower{tx_power_info: [{pucch_tx_power: 23, subframe_index: 5122}]}"},
};

const TranslationCase kGsm[] = {
    {0x5134, "h0[0:12]=1023 h0[12:4]=15 b2=255 b3=254 h4=65535 x6=62F210 x9=1234",
     "GsmScellInfo{mcc: 262, mnc: 1, lac: 4660, cell_id: 65535, arfcn: 1023, bsic: 55, num_mnc_digits: 2}"},
    {0x507A, "h0=-1193", "GsmIdleScellMeasurement{idle_rxlev_dBm: -75}"},
    {0x507A, "h0=0", ""},
    {0x507B, "b0=3 @1 h0[0:12]=1 h0[12:4]=9 h2=-2000 @5 h0=2 h2=0 @9 h0=3 h2=-1192",
     "GsmGrrEventMeasCr{gsm_ncell_meas: [{arfcn: 1, rxlev: 0}, {arfcn: 3, rxlev: 36}]}"},
    {0x507B, "b0=1 @1 h0=2 h2=0", ""},
    {0x5071, "b0=3 @1 h0[0:12]=5 h0[12:4]=9 h2=-720 b4=1 b5=255 b11=0 @13 h2=-1760 b4=2 b5=63 b11=0 "
             "@25 h0=7 h2=0 b4=1 b5=5 b11=0",
     "GsmGrrEventMeasCr{gsm_ncell_meas: [{bsic: 63, arfcn: 5, rxlev: 63}, {arfcn: 0}, {bsic: 5, arfcn: 7}]}"},
    {0x51FC, "h0[0:12]=600 h0[12:4]=1 b5=70 b25=2 @26 h0[0:12]=601 h0[12:4]=1 b5=64 b24=0 @51 b5=0 b24=0",
     "GsmIdleScellMeasurement{scell_arfcn: 600, idle_rxlev_dBm: -40} "
     "GsmGrrEventMeasCr{gsm_ncell_meas: [{arfcn: 601, rxlev: 63}, {arfcn: 0, rxlev: 0}]}"},
    {0x51FC, "h0=600 b5=0 b25=0", "GsmIdleScellMeasurement{scell_arfcn: 600, idle_rxlev_dBm: -110}"},
};

const TranslationCase kUmts[] = {
    {0x4127, "w0=9750 w4=10700 w8=268435455 h16[4:12]=511 h16[0:4]=15 x18=02060200020F w24=65534",
     "WcdmaCellInfo{mcc: 262, mnc: 2, lac: 65534, cell_id: 268435455, dl_uarfcn: 10700, psc: 511, num_mnc_digits: 2}"},
    {0x4127, "w4=1 x18=030100040109 w24=2",
     "WcdmaCellInfo{mcc: 310, mnc: 419, lac: 2, cell_id: 0, dl_uarfcn: 1, psc: 0, num_mnc_digits: 3}"},
    {0x4127, "w4=1 x18=03010004010A w24=2", "WcdmaCellInfo{mcc: 310, lac: 2, cell_id: 0, dl_uarfcn: 1, psc: 0}"},
    {0x4127, "w4=1 x18=030100040A09 w24=2", "WcdmaCellInfo{lac: 2, cell_id: 0, dl_uarfcn: 1, psc: 0}"},
    {0x4125, "b0=0", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_IDLE}"},
    {0x4125, "b0=1", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_ESTABLISH}"},
    {0x4125, "b0=2", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_CELL_FACH}"},
    {0x4125, "b0=3", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_CELL_DCH}"},
    {0x4125, "b0=4", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_CELL_PCH}"},
    {0x4125, "b0=5", "WcdmaRrcConnectionState{state: KWCDMA_RRC_CONN_STATE_URA_PCH}"},
    {0x4125, "b0=6", ""},
    {0x4005, "b0[0:6]=1 b1[0:6]=1 b1[6:2]=3 @2 h0=10700 h2=511 b4=-100 b7=-50 b9=0 @12 h0[0:12]=512 h0[12:4]=15 b4=-50 b6=0",
     "WcdmaNbrCellMeas{meas_utra_result: [{uarfcn: 10700, psc: 511, rscp: -5}], "
     "meas_gsm_result: [{arfcn: 512, rxlev: 60}]}"},
    {0x4005, "b0[0:6]=2 b0[6:2]=1 b1=1 @2 h0=1 h2=2 b4=-49 b7=-49 @13 h0=3 h2=4 b4=1 b7=0 b10=0 @24 h0=5 b4=-128 b7=0",
     "WcdmaNbrCellMeas{meas_utra_result: [{uarfcn: 1, psc: 2, ecno: 0, rscp: 46}, "
     "{uarfcn: 3, psc: 4, ecno: 49, rscp: 96}], meas_gsm_result: [{arfcn: 5, rxlev: 0}]}"},
    {0x4005, "b0[0:6]=1 b0[6:2]=2 b1=2 @7 h0=1 h2=2 b4=-74 b7=-12 b15=0 @23 h0=5 b4=-47 b12=0 @36 h0=6 b4=-46 b12=0",
     "WcdmaNbrCellMeas{meas_utra_result: [{uarfcn: 1, psc: 2, ecno: 37, rscp: 21}], "
     "meas_gsm_result: [{arfcn: 5, rxlev: 63}, {arfcn: 6, rxlev: 63}]}"},
    {0x4005, "b0[0:6]=0 b0[6:2]=2 b1=0", ""},
};
// clang-format on

void expectAll(std::span<const TranslationCase> rows) {
  for (const TranslationCase& row : rows)
    expectTranslation(row);
}

}  // namespace

TEST(Layouts, EachIsReadAsItStandsInItsTable) {
  expectAll(kLteCells);
  expectAll(kLteServingMeasurements);
  expectAll(kLteNeighbours);
  expectAll(kLteTransmitPowers);
  expectAll(kGsm);
  expectAll(kUmts);
}

TEST(Layouts, WhatIsMadeOfSubpacketsIsReadAsFarAsTheyAreKnown) {
  Translator translator;
  const std::string cell = "h0[0:9]=2 h0[12:1]=1 w64=0";
  const std::string values = "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 2}]}";
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=2 b4=26 b5=18 h6=5 @9 b0=25 b1=18 h2=76 @17 " + cell), values);
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=2 b4=25 b5=56 h6=4 @8 b0=25 b1=18 h2=76 @16 " + cell), values);
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=1 b4=25 b5=56 h6=4"), "passed over");
  EXPECT_EQ(told(translator, 0xB195, "b0=1 b1=1 b4=30 b5=4 h6=4"), "passed over");
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=0"), "passed over");
  EXPECT_EQ(told(translator, 0xB193, "b0=2 b1=1 b4=25 b5=18 h6=76 @12 " + cell), "passed over");
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=2 b4=25 b5=18 h6=76 @12 " + cell + " @80 h2=3"), "damaged");
  EXPECT_EQ(told(translator, 0xB193, "b0=1 b1=2 b4=25 b5=18 h6=76 @12 " + cell + " @80 h2=5"), "damaged");
}

TEST(Layouts, AListOfPowersHasExactlyItsRecords) {
  Translator translator;
  EXPECT_EQ(told(translator, 0xB139, "b0=43 h1[9:5]=0 b7=0"), "");
  EXPECT_EQ(told(translator, 0xB139, "b0=43 h1[9:5]=0 b8=0"), "damaged");
}

TEST(Layouts, AnUnknownVersionIsPassedOver) {
  Translator translator;
  const Bytes body(300, 0xFE);
  for (const LogKind& kind : logKinds()) {
    if (kind.versionPlace == VersionPlace::firstByte) {
      EXPECT_EQ(told(translator, kind.code, body), "passed over") << kind.name;
    }
  }
  EXPECT_EQ(told(translator, 0x4005, "b0=192 b300=0"), "passed over");
  EXPECT_EQ(told(translator, 0x7138, body), "passed over");
}

}  // namespace vesk::diag
