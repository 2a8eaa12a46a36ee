#include <gtest/gtest.h>

#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

constexpr std::uint16_t kRrc = 0xB0C0;

/// A packet of version 9 with the bits of a message; the channels are 12 (DL-CCCH), DL-DCCH, UL-CCCH, UL-DCCH.
Bytes rrcPacket(int channel, std::string_view bits) {
  const Bytes message = bodyOf("n0=" + std::string(bits));
  Bytes body = bodyOf("b0=9 h4=77 b12=" + std::to_string(channel) + " h17=" + std::to_string(message.size()));
  body.insert(body.end(), message.begin(), message.end());
  return body;
}

std::string tellRrc(Translator& translator, int channel, std::string_view bits, std::uint64_t ms = kPacketMs) {
  return told(translator, kRrc, rrcPacket(channel, bits), ms);
}

constexpr int kDownlinkCommon = 12;
constexpr int kDownlinkDedicated = 13;
constexpr int kUplinkCommon = 14;
constexpr int kUplinkDedicated = 15;

/// Up to the cause of a request for a connection, and of one for another after a failure.
std::string request(std::string_view cause) {
  return "0.1.0." + std::string(41, '1') + '.' + std::string(cause);
}
std::string secondRequest(std::string_view cause) {
  return "0.0.0." + std::string(41, '1') + '.' + std::string(cause);
}

/// The versions that share where their headers have what is read, and those that share their channels' numbers.
struct Header {
  std::vector<int> versions;
  int pci, channel, length, message;
};
const Header kHeaders[] = {
    {{2, 3, 4}, 4, 10, 11, 13},
    {{6, 7}, 4, 10, 15, 17},
    {{8, 9, 12, 13, 14, 15, 16, 19, 20, 22, 24}, 4, 12, 17, 19},
    {{25, 26, 27, 29}, 6, 14, 19, 21},
    {{30, 31}, 6, 14, 19, 24},
};
struct Numbering {
  std::vector<int> versions;
  int first;
};
const Numbering kNumberings[] = {
    {{2, 3, 4, 6, 7, 8, 13, 22}, 5},
    {{9, 12}, 12},
    {{14, 15, 16, 20, 24, 25}, 6},
    {{19, 26, 27, 29, 30, 31}, 8},
};

int firstChannel(int version) {
  for (const Numbering& row : kNumberings) {
    for (const int one : row.versions) {
      if (one == version) return row.first;
    }
  }
  return -1;
}

}  // namespace

TEST(LteRrc, EveryVersionOfTheHeaderIsRead) {
  const auto field = [](char kind, int at, int value) {
    return std::string{' ', kind} + std::to_string(at) + '=' + std::to_string(value);
  };
  for (const Header& header : kHeaders) {
    for (const int version : header.versions) {
      const auto packet = [&](int channelIndex, int size, std::string_view bits) {
        return "b0=" + std::to_string(version) + field('h', header.pci, 77) +
               field('b', header.channel, firstChannel(version) + channelIndex) + field('h', header.length, size) +
               " n" + std::to_string(header.message) + '=' + std::string(bits);
      };
      const std::string state = "LteRrcState{state: KLTE_RRC_STATE_";
      expectTranslation({kRrc, packet(0, 1, "0.10.00000"), state + "IDLE, cause: KLTE_RRC_CAUSE_EST_FAIL_REJ}"});
      expectTranslation({kRrc, packet(1, 1, "0.0011.000"), state + "ATMPT_OUTBND_MOBILITY}"});
      expectTranslation({kRrc, packet(2, 1, "0.1.1.00000"), state + "ATMPT_CONNECTION}"});
      expectTranslation({kRrc, packet(3, 4, "0.0001.000000.0.00000.0000000.000000.00"),
                         "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 77, rsrp0: -140, rsrq0: -20}]}"});
      Translator translator;
      EXPECT_EQ(told(translator, kRrc, packet(4, 1, "0.10.00000")), "") << "no such channel";
      EXPECT_EQ(told(translator, kRrc, packet(-1, 1, "0.10.00000")), "") << "no such channel";
      EXPECT_EQ(told(translator, kRrc, packet(4, 2, "0.10.00000")), "damaged");
    }
  }
  Translator translator;
  EXPECT_EQ(told(translator, kRrc, "b0=30 b14=8 h19=1 b23=1 b24=64"), "passed over") << "a part of a message";
  EXPECT_EQ(told(translator, kRrc, "b0=5 b300=0"), "passed over");
}

TEST(LteRrc, MessagesAreStatesWithTheirCauses) {
  struct Row {
    int channel;
    std::string bits;
    std::string state;
    std::string cause;
  };
  const std::string connecting = "ATMPT_CONNECTION";
  const Row rows[] = {
      {kUplinkCommon, request("000"), connecting, "EST_EMERGENCY"},
      {kUplinkCommon, request("101"), connecting, "EST_DELAY_TOL_ACC"},
      {kUplinkCommon, request("110"), connecting, ""},
      {kUplinkCommon, request("111"), connecting, ""},
      {kUplinkCommon, secondRequest("00"), connecting, "REEST_RECFG_FAIL"},
      {kUplinkCommon, secondRequest("10"), connecting, "REEST_OTHER_FAIL"},
      {kUplinkCommon, secondRequest("11"), connecting, ""},
      {kUplinkCommon, "0.0.1", connecting, ""},
      {kDownlinkCommon, "0.01", "IDLE", "REL_CONN_FAIL_REEST_REJ"},
      {kDownlinkDedicated, "0.0101.11.000.111.00", "IDLE", "REL_LOAD_BAL_TAU_REQD"},
      {kDownlinkDedicated, "0.0101.11.000.111.01", "IDLE", "REL_OTHER"},
      {kDownlinkDedicated, "0.0101.11.000.111.10", "IDLE", "REL_CSFB_HIGH_PRIO"},
      {kDownlinkDedicated, "0.0101.11.000.111.11", "IDLE", ""},
      {kDownlinkDedicated, "0.0101.11.001.000.00", "IDLE", ""},
      {kUplinkDedicated, "0.0011", "CONNECTED", ""},
      {kUplinkDedicated, "0.0100", "CONNECTED", ""},
  };
  for (const Row& row : rows) {
    const std::string cause = row.cause.empty() ? "" : ", cause: KLTE_RRC_CAUSE_" + row.cause;
    const std::string isTold = "LteRrcState{state: KLTE_RRC_STATE_" + row.state + cause + '}';
    Translator translator;
    EXPECT_EQ(tellRrc(translator, row.channel, row.bits), isTold) << row.bits;
    EXPECT_EQ(tellRrc(translator, row.channel, '1' + row.bits.substr(1)), "") << row.bits;
  }
  Translator translator;
  EXPECT_EQ(tellRrc(translator, kUplinkDedicated, "0.0001.0001"), "") << "a report of another kind";
  EXPECT_EQ(tellRrc(translator, kUplinkCommon, "0.1.0.00000"), "damaged") << "the cause is cut off";
  EXPECT_EQ(tellRrc(translator, kDownlinkDedicated, "0.0101.000"), "damaged");
  EXPECT_EQ(tellRrc(translator, kUplinkDedicated, ""), "damaged");
}

TEST(LteRrc, AStateLastsUntilTheNext) {
  const std::string idle = "0.0101.00.000.000.01";
  const auto ended = [](std::string_view previous, std::string_view rest) {
    return "LteRrcState{state: KLTE_RRC_STATE_IDLE, prev_state: KLTE_RRC_STATE_" + std::string(previous) +
           std::string(rest) + ", cause: KLTE_RRC_CAUSE_REL_OTHER}";
  };
  Translator translator;
  EXPECT_NE(tellRrc(translator, kUplinkCommon, request("011"), kPacketMs), "");
  EXPECT_EQ(tellRrc(translator, kUplinkCommon, request("100"), kPacketMs + 5), "") << "the state lasts";
  EXPECT_EQ(tellRrc(translator, kUplinkDedicated, "0.0100", kPacketMs + 7),
            "LteRrcState{state: KLTE_RRC_STATE_CONNECTED, prev_state: KLTE_RRC_STATE_ATMPT_CONNECTION, "
            "prev_state_dur_ms: 7, cause: KLTE_RRC_CAUSE_EST_MO_DATA}");
  EXPECT_EQ(tellRrc(translator, kUplinkDedicated, "0.0100", kPacketMs + 8),
            "LteRrcState{state: KLTE_RRC_STATE_CONNECTED, prev_state: KLTE_RRC_STATE_CONNECTED, "
            "prev_state_dur_ms: 1, cause: KLTE_RRC_CAUSE_EST_MO_DATA}")
      << "a connection may have been made anew, for the last reason";
  EXPECT_EQ(tellRrc(translator, kDownlinkDedicated, idle, kPacketMs + 8), ended("CONNECTED", ", prev_state_dur_ms: 0"));
  EXPECT_EQ(tellRrc(translator, kDownlinkDedicated, idle, kPacketMs + 9), "");
  EXPECT_NE(tellRrc(translator, kUplinkCommon, "0.1.1", kPacketMs + 9), "");
  EXPECT_EQ(tellRrc(translator, kDownlinkDedicated, idle, kPacketMs), ended("ATMPT_CONNECTION", ""))
      << "the clock went back";
  EXPECT_EQ(tellRrc(translator, kUplinkDedicated, "0.0011", kPacketMs + 0xFFFF'FFFF),
            "LteRrcState{state: KLTE_RRC_STATE_CONNECTED, prev_state: KLTE_RRC_STATE_IDLE, "
            "prev_state_dur_ms: 4294967295}")
      << "the last request gave no reason";
  EXPECT_EQ(tellRrc(translator, kDownlinkDedicated, idle, kPacketMs + 0x1'FFFF'FFFF), ended("CONNECTED", ""));

  constexpr std::uint64_t kYear2000 = 946684800000;
  Translator unset;
  EXPECT_NE(tellRrc(unset, kUplinkDedicated, "0.0011", kYear2000 - 2), "");
  EXPECT_EQ(tellRrc(unset, kDownlinkDedicated, idle, kYear2000 - 1), ended("CONNECTED", ", prev_state_dur_ms: 1"));
  EXPECT_EQ(tellRrc(unset, kUplinkCommon, "0.1.1", kYear2000),
            "LteRrcState{state: KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state: KLTE_RRC_STATE_IDLE}");
}

TEST(LteRrc, AReportTellsItsNeighboursAsFarAsTheyGo) {
  const std::string own = "LteRsrpRsrqSinr{num_samples: 1, inst_values: [{phy_cell_id: 77, rsrp0: -43, rsrq0: 12}]}";
  const auto report = [](std::string_view neighbours) {
    return "0.0001.000000.1.00000.1100001.111111." + std::string(neighbours);
  };
  struct Row {
    std::string_view neighbours;
    std::string_view isTold;
  };
  const Row rows[] = {
      {"", ""},
      {"1.00.000.0.000000001.0.0.0", ""},
      {"0.11.000.0.000000001.0.0.0", ""},
      {"0.00.001.0.111110111.0.1.1.1100001.100010.0.000000001.0.0.1.000000",
       " LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_phys_cell_id: 503, nbr_rsrp: 97, nbr_rsrq: 34}, "
       "{nbr_phys_cell_id: 1, nbr_rsrq: 0}]}"},
      // An extension, a global identity, the number of cells and the end each end the list.
      {"0.00.111.0.000000001.1.0.0.0.000000010.0.0.0.00000000",
       " LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_phys_cell_id: 1}]}"},
      {"0.00.111.0.000000001.0.0.0.1.000000010.0.0.0.00000000",
       " LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_phys_cell_id: 1}]}"},
      {"0.00.000.0.000000001.0.0.0.0.000000010.0.0.0.00000000",
       " LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_phys_cell_id: 1}]}"},
      {"0.00.111.0.000000001.0.0.0.0.000000010.0.1.0.1",
       " LteNbrEutraCellMeas{meas_nbr_eutra: [{nbr_phys_cell_id: 1}]}"},
      {"0.01.001.0.0.111111111.0.1.1.0000000.110001.0.1.1111111.0.1.0.1011011",
       " LteNbrInterRatCellMeas{meas_nbr_utra: [{psc: 511, rscp: -5, ecno: 49}, {rscp: 86}]}"},
      {"0.10.001.0.1111111111.1.111111.0.111111.0.0000000001.0.000010.1.000011",
       " LteNbrInterRatCellMeas{meas_nbr_geran: [{arfcn: 1023, bsic: 63, rxlev: 63}, "
       "{arfcn: 1, bsic: 2, rxlev: 3}]}"},
      {"0.10.001.1.1111111111.1.111111.0.111111", ""},
  };
  for (const Row& row : rows) {
    Translator translator;
    EXPECT_EQ(tellRrc(translator, kUplinkDedicated, report(row.neighbours)), own + std::string(row.isTold))
        << row.neighbours;
  }
}

}  // namespace vesk::diag
