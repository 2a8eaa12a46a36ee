// What no rule derives: irregular keys, numbers that are left out, values without a name.

#include <gtest/gtest.h>
#include <map>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/proto_schema.h"
#include "messages/wcdma/wcdma.h"
#include "support/decoded.h"

namespace vesk {
namespace {

using namespace metrics;

/// "1-5 7 10-14"
std::string rangesOf(const std::vector<std::int32_t>& numbers) {
  std::string text;
  for (std::size_t first = 0; first < numbers.size();) {
    std::size_t last = first;
    while (last + 1 < numbers.size() && numbers[last + 1] == numbers[last] + 1)
      ++last;
    if (!text.empty()) text += ' ';
    text += std::to_string(numbers[first]);
    if (last > first) text += '-' + std::to_string(numbers[last]);
    first = last + 1;
  }
  return text;
}

TEST(Schema, LeavesNumbersOut) {
  const std::map<std::string, std::string> gaps{
      {"KCellularGsmScellInfo", "1 4-11 13"},
      {"KCellularLteCdrxConfig", "1-5 7 10-14"},
      {"KCellularLteRsrpRsrqSinr", "1 3 6-8 10-11 14-15"},
      {"KCellularLteScellInfo", "1-12 14-15"},
      {"KCellularWcdmaCellInfo", "1 4-10 13-14"},
      {"KCellularWcdmaSelReselCellInfo", "1-13 21-24"},
      {"RoutingAreaId", "1 3-4"},
      {"RsrpRsrqSinr", "1 4-5 7-8 10-11"},
  };
  std::size_t fields = 0;
  for (const Descriptor* message : declaredMessages()) {
    const std::string& name = message->name();
    std::vector<std::int32_t> numbers;
    for (const auto& [number, field] : fieldsByNumber(*message))
      numbers.push_back(number);
    fields += numbers.size();
    const auto row = gaps.find(name);
    if (row != gaps.end()) {
      EXPECT_EQ(rangesOf(numbers), row->second) << name;
    } else {
      EXPECT_EQ(numbers.back(), static_cast<std::int32_t>(numbers.size())) << name << ' ' << rangesOf(numbers);
    }
  }
  EXPECT_EQ(declaredMessages().size(), 54U);
  EXPECT_EQ(fields, 348U);
}

/// The values below 300 that have a name.
template <class Enumeration>
std::string namedValues() {
  std::vector<std::int32_t> named;
  for (std::int32_t value = -2; value < 300; ++value) {
    const Text name = nameOf(static_cast<Enumeration>(value));
    if (!name.view().starts_with("(unknown: ")) {
      named.push_back(value);
    } else {
      EXPECT_EQ(name, "(unknown: " + std::to_string(value) + ")");
    }
  }
  return rangesOf(named);
}

TEST(Schema, NamesTheseValues) {
  EXPECT_EQ(namedValues<EmmCause>(), "0 2-3 5-26 35 39-40 95-101 111");
  EXPECT_EQ(namedValues<EmmProc>(), "0-7");
  EXPECT_EQ(namedValues<EpsUeOpMode>(), "0-3");
  EXPECT_EQ(namedValues<EpsUpdateStatus>(), "0-2");
  EXPECT_EQ(namedValues<GprsUpdateStatus>(), "0-2");
  EXPECT_EQ(namedValues<GsmDedicatedState>(), "1-2");
  EXPECT_EQ(namedValues<HsIndication>(), "0-3");
  EXPECT_EQ(namedValues<KCellularWcdmaSelReselCellInfo::DuplexMode>(), "0-1");
  EXPECT_EQ(namedValues<LteRrcCause>(), "0-30 254-255");
  EXPECT_EQ(namedValues<LteRrcState>(), "0-6");
  EXPECT_EQ(namedValues<MmUpdateStatus>(), "1-4");
  EXPECT_EQ(namedValues<NasMmProcFailureCause>(), "0-15");
  EXPECT_EQ(namedValues<NasMmRegProc>(), "0-10");
  EXPECT_EQ(namedValues<NasMmRejectCause>(), "0 2-17 20-23 25 32-34 38 40 63 95-101 111");
  EXPECT_EQ(namedValues<NbrEutra::FrameType>(), "0-2");
  EXPECT_EQ(namedValues<PdpType>(), "0-7");
  EXPECT_EQ(namedValues<RegStatus>(), "0-12");
  EXPECT_EQ(namedValues<RrcEstablishmentCause>(), "0-22");
  EXPECT_EQ(namedValues<RrcReleaseCause>(), "0-17");
  EXPECT_EQ(namedValues<SccState>(), "0-2");
  EXPECT_EQ(namedValues<SysBand>(), "0-1 3-19 40-48 80-88 90-91 120-133 136-140 143-145 152-168");
  EXPECT_EQ(namedValues<WcdmaRrcConnState>(), "0-10");
}

TEST(Schema, ShowsTheseNames) {
  const DecodingCase cases[] = {
      decoding<KCellularLteSelReselCellInfo>(
          "58 01 60 03 68 01 70 02 78 03 80 01 04 88 01 05 90 01 06 98 01 07",
          "{multi_band_info: [], QRxLevMin: -1, QQualMin: -2, Q_hyst: 1, S_non_intra_search_P: 2, "
          "S_non_intra_search_Q: 3, S_intra_search_P: 4, S_intra_search_Q: 5, Thresh_serving_lowP: 6, "
          "Thresh_serving_lowQ: 7}"),
      decoding<NbrEutra>("10 8B 01 28 02 38 01 40 02 48 03 50 04 60 02",
                         "{Q_rxlev_min: -70, Pmax: 1, Thres_X_highP: 1, Thres_X_lowP: 2, Thres_X_highQ: 3, "
                         "Thres_X_lowQ: 4, frame_type: INVALID}"),
      decoding<KCellularGsmIdleScellMeasurement>("18 01 28 DB 01", "{simplified_l1_state: 1, idle_rxlev_dBm: -110}"),
      decoding<KCellularGsmIdleConfig>("58 2C 90 01 01 F0 01 02 90 02 03",
                                       "{gsm_band: 44, c2_valid: 1, si_7_8_broadcast: 2, si_2_ter_needed: 3}"),
      decoding<KCellularGsmGprsConfig>("58 01", "{cell_bar_access_2: 1}"),
      decoding<KCellularGsmScellInfo>("40 2C 58 02", "{gsm_band: SYS_BAND_GSM_EGSM_900, state: NON_DEDICATED_STATE}"),
      decoding<KCellularGsmScellInfo>("40 A8 01 58 00", "{gsm_band: SYS_BAND_UMTS_BAND6, state: (unknown: 0)}"),
      // hspa is declared before the fields whose numbers are lower, and follows them everywhere.
      decoding<KCellularWcdmaCellInfo>("10 01 18 01 40 5B 70 03 68 02 58 01 60 01",
                                       "{wcdma_band: SYS_BAND_WCDMA_XIX_850, num_mnc_digits: 2, "
                                       "hspa: SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL}",
                                       "40 5B 68 02 70 03"),
      decoding<KCellularWcdmaRrcConnectionState>("10 07 18 09 20 04",
                                                 "{state: KWCDMA_RRC_CONN_STATE_CELL_DCH, establishment_cause: "
                                                 "KRRC_EST_EMERGENCY_CALL, release_cause: KRRC_REL_NORMAL_EVENT}"),
      decoding<KCellularWcdmaSelReselCellInfo>("20 01 48 01", "{duplex_mode: TDD, multi_band_info: [], s_rxlev: -1}"),
      decoding<UmtsNcellMeas>("20 96 01 28 07", "{cpich_rscp: 150, cpich_ecn0: 7}"),
      decoding<KCellularMmContext>(
          "18 00 40 04", "{update_status: (unknown: 0), reject_cause: KNAS_MM_REJ_CAUSE_IMSI_UNKNOWN_IN_VLR}"),
      decoding<KCellularGmmContext>("18 00 40 3F 48 0A",
                                    "{update_status: GPRS_STATUS_UPDATED, reject_cause: "
                                    "KNAS_MM_REJ_CAUSE_RETRY_UPON_ENTRY_TO_NEW_CELL, reg_proc: "
                                    "KNAS_MM_REG_PROC_PROC_NONE}"),
      decoding<KCellularEmmContext>("18 00 2A 04 0A 02 13 F0 2A 02 10 05 32 02 18 07 38 04 48 36",
                                    "{update_status: EPS_STATUS_UPDATED, tai_list: [{encoded_plmn: 0x13f0}, {tac: 5}], "
                                    "guti: {m_tmsi: 7}, reject_cause: (unknown: 4), t3412_dur_s: 54}"),
      decoding<BearerContext>("20 02 40 07", "{pdp_type: PDP_TYPE_IPv4v6, secondary_dns_type: PDP_TYPE_NONE}"),
      decoding<RoutingAreaId>("0A 01 FF 10 05 18 06 20 07", "{encoded_plmn: 0xff, lac: 6, rac: 7}",
                              "0A 01 FF 18 06 20 07"),
      decoding<KCellularSimCardFiles>("12 07 08 07 12 03 08 29 43", "{ef_list: [{ef_id: 7, content: 0x082943}]}"),
  };
  for (const DecodingCase& row : cases)
    expectDecoding(row);
}

}  // namespace
}  // namespace vesk
