#include <gtest/gtest.h>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"
#include "support/decoded.h"
#include "support/recorded_log.h"

namespace vesk {
namespace {

using namespace metrics;

TEST(Decoding, ReadsShowsAndWritesEachKindOfField) {
  using Resel = KCellularLteSelReselCellInfo;
  const DecodingCase cases[] = {
      decoding<Resel>("08 95 9A EF 3A 12 02 03 07 58 05 AA 01 03 08 BA 0E",
                      "{timestamp: 123456789, multi_band_info: [3, 7], QRxLevMin: -3, nbr_eutra: [{earfcn: 1850}]}"),
      decoding<Resel>("", "{multi_band_info: []}"),

      // Scalars: the last one counts, the wire type does not, and what does not fit is cut off.
      decoding<TxPowerInfo>("18 85 80 80 80 10", "{subframe_index: 5}", "18 05"),
      decoding<Resel>("18 01 18 02", "{multi_band_info: [], ims_emergency_support: 2}", "18 02"),
      decoding<Resel>("1D 05", "{multi_band_info: [], ims_emergency_support: 5}", "18 05"),
      decoding<TxPowerInfo>("08 FF FF FF FF 0F 10 FE FF FF FF 0F",
                            "{pucch_tx_power: -2147483648, pusch_tx_power: 2147483647}"),
      decoding<KCellularLteServingCellMeasurement>("10 80 80 80 80 10", "{is_connected_mode: true}", "10 01"),
      decoding<KCellularLteRrcState>("10 03 28 FE 01",
                                     "{state: KLTE_RRC_STATE_CONNECTED, cause: KLTE_RRC_CAUSE_NO_SERVICE}"),
      decoding<KCellularLteRrcState>("10 00 28 1F", "{state: KLTE_RRC_STATE_NULL, cause: (unknown: 31)}"),
      decoding<KCellularLteRrcState>("10 FF FF FF FF 0F", "{state: (unknown: -1)}", "10 FF FF FF FF FF FF FF FF FF 01"),

      // Text and bytes: present even when empty, and kept as they came.
      decoding<BearerContext>("1A 01 61 1A 02 C3 28 2A 02 00 FF", "{apn: \xEF\xBF\xBD(, pdp_addr: 0x00ff}",
                              "1A 02 C3 28 2A 02 00 FF"),

      // Repeated scalars: packed or not, in the order of arrival.
      decoding<KCellularWcdmaSelReselCellInfo>("28 07 28 08 2A 02 09 0A 2D 0B", "{multi_band_info: [7, 8, 9, 10, 11]}",
                                               "2A 05 07 08 09 0A 0B"),
      decoding<KCellularGsmCsRfMeasurement>("2A 02 05 0A", "{cs_tx_pwr: [-3, 5]}"),
      decoding<KCellularGsmCsRfMeasurement>("2A 00", "{cs_tx_pwr: []}", ""),

      // Messages: a single one is replaced, those of a list are kept.
      decoding<KCellularLteRsrpRsrqSinr>("72 02 08 01 72 02 20 01", "{avg_values: {rsrp0: -1}}", "72 02 20 01"),
      decoding<KCellularLteRsrpRsrqSinr>("7A 02 08 01 72 00 7A 02 08 02",
                                         "{avg_values: {}, inst_values: [{phy_cell_id: 1}, {phy_cell_id: 2}]}",
                                         "72 00 7A 02 08 01 7A 02 08 02"),
  };
  for (const DecodingCase& row : cases)
    expectDecoding(row);
}

TEST(Decoding, PassesOverWhatTheMessageDoesNotDeclare) {
  using Cdrx = KCellularLteCdrxConfig;
  const std::string known = "{cell_status: 1, long_drx_cycle_ms: 2}";
  const std::string written = "10 01 38 02";
  const std::string unknown[] = {
      "",
      "30 80 01",
      "41 01 02 03 04 05 06 07 08",
      "33 33 34 34",
      // Key 0, also when it has ten bytes without an end.
      "00 05",
      repeated(10, "80") + "05",
  };
  for (const std::string& field : unknown)
    expectDecoding(decoding<Cdrx>("10 01" + field + "38 02", known, written));

  // A number beyond 16 bits wraps onto a declared one; the end of a group ends the message.
  expectDecoding(decoding<Cdrx>("90 80 20 01 38 02", known, written));
  expectDecoding(decoding<Cdrx>("10 01 38 02 34 18 03", known, written));
  expectDecoding(decoding<KCellularLteTxPower>(
      "12 05 08 02 0C FF FF 08 01", "{timestamp: 1, tx_power_info: [{pucch_tx_power: 1}]}", "08 01 12 02 08 02"));
}

TEST(Decoding, YieldsNothingForBytesThatAreNoMessage) {
  const std::string cases[] = {
      "80",
      "08",
      "12 05 03 07",
      "12 02 03 80",
      "12 FF FF FF FF FF FF FF FF FF 01",
      "AA 01 05 08 01",
      "AA 01 02 08 80",
      "AA 01 03 1D 05 36",
      "AA 01 FF FF FF FF FF FF FF FF 7F",
      "F5 01 01 02 03",
      "F6 01",
      "F3 01 FC 01",
      "F2 B0 1A",
      "F2 B0 1A 04 18",
  };
  for (const std::string& payload : cases) {
    EXPECT_EQ(decoded<KCellularLteSelReselCellInfo>(payload), nullptr) << payload;
  }
  EXPECT_EQ(decoded<BearerContext>("1A 02 61"), nullptr);
  EXPECT_EQ(decoded<BearerContext>("2A FF FF FF FF FF FF FF FF FF 01"), nullptr);
  EXPECT_EQ(decoded<KCellularMmContext>("22 02 10 80"), nullptr);
}

TEST(Decoding, KeepsWhatWasReadBeforeTheFault) {
  struct Case {
    std::string payload;
    std::string shown;
  };
  const Case cases[] = {
      {"30 07 7A 02 08 01 7A 04 20 01 28 80 40 08",
       "{last_x_seconds: 7, inst_values: [{phy_cell_id: 1}, {rsrp0: -1, rsrp1: 0}]}"},
      {"30 07 72 02 08 01 72 05 20", "{last_x_seconds: 7, avg_values: {}}"},
  };
  for (const Case& row : cases) {
    const Bytes payload = bytesOf(row.payload);
    ProtoReader reader(payload);
    KCellularLteRsrpRsrqSinr message;
    EXPECT_FALSE(message.readFrom(reader)) << row.payload;
    EXPECT_EQ(shown(message), row.shown);
  }
}

TEST(Decoding, ReadsTheContentOfASectionThatIsKeyedByAMetric) {
  struct Case {
    std::string payload;
    std::string shown;
    std::vector<std::string> log;
  };
  const std::string valid = "valid metricId tag";
  const Case cases[] = {
      // Keyed by its own metric or another one, around all of it or only a part, twice, or as a mere number.
      {"F2 B0 1A 04 08 05 10 06", "{earfcn: 5, Q_rxlev_min: 3}", {valid, "Unknown tag: d30e:4"}},
      {"08 05 9A 01 02 10 06", "{earfcn: 5, Q_rxlev_min: 3}", {valid, "Unknown tag: 13:2"}},
      {"F2 B0 1A 05 9A 01 02 08 05", "{earfcn: 5}", {valid, "Unknown tag: d30e:5", valid, "Unknown tag: 13:2"}},
      {"F5 B0 1A 85 80 80 80 70 08 05", "{earfcn: 5}", {valid, "Unknown tag: d30e:5"}},
      {"A8 E2 09 FF FF FF FF 0F", "{}", {valid, "Unknown tag: 4e25:4294967295"}},
      // The length is not looked at.
      {"F2 B0 1A 7F 08 05", "{earfcn: 5}", {valid, "Unknown tag: d30e:127"}},
      // No metrics.
      {"A2 01 00 F8 FF 1F 00", "{}", {}},
  };
  for (const Case& row : cases) {
    RecordedLog log;
    const auto message = decoded<NbrEutra>(row.payload);
    ASSERT_NE(message, nullptr) << row.payload;
    EXPECT_EQ(shown(*message), row.shown);
    EXPECT_EQ(log.lines(), row.log);
  }
  // Where 19 is a declared field, it is that field.
  RecordedLog log;
  expectDecoding(decoding<KCellularLteSelReselCellInfo>("98 01 04", "{multi_band_info: [], Thresh_serving_lowQ: 4}"));
  EXPECT_TRUE(log.lines().empty());
}

TEST(Decoding, WithstandsAMillionElements) {
  constexpr std::size_t kMany = 1'000'000;
  const auto messages = decoded<KCellularLteTxPower>(repeated(kMany, "1200"));
  ASSERT_NE(messages, nullptr);
  EXPECT_EQ(messages->txPowerInfosCount(), kMany);
  const auto numbers = decoded<KCellularGsmCsRfMeasurement>(repeated(kMany, "2801"));
  ASSERT_NE(numbers, nullptr);
  EXPECT_EQ(numbers->csTxPwrAtIndex(kMany - 1), -1);
  EXPECT_EQ(decoded<KCellularGsmCsRfMeasurement>(repeated(kMany, "4B")), nullptr);
}

}  // namespace
}  // namespace vesk
