#include <gtest/gtest.h>

#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

constexpr std::uint16_t kMmState = 0x7131;
constexpr std::uint16_t kGmmState = 0x7130;

std::string packetOf(std::string_view hex) {
  return "w1=" + std::to_string(messageOf(hex).size()) + " x5=" + std::string(hex);
}

std::string tellMessage(Translator& translator, std::string_view hex) {
  return told(translator, 0x713A, packetOf(hex));
}

/// A message without anything behind what it must have: shorter, by its length or the packet's, it is damaged or, below
/// two bytes, none at all.
void expectMessage(std::string_view hex, std::string_view isTold) {
  Translator translator;
  for (std::size_t size = 0; size < messageOf(hex).size(); ++size) {
    Bytes body = bodyOf("w1=" + std::to_string(size) + " b4=0");
    const Bytes message = messageOf(hex);
    body.insert(body.end(), message.begin(), message.end());
    EXPECT_EQ(told(translator, 0x713A, body), size < 2 ? "" : "damaged") << hex << ", " << size;
  }
  EXPECT_EQ(tellMessage(translator, hex), isTold) << hex;
  expectTranslation({0x713A, packetOf(hex), isTold});
}

}  // namespace

TEST(Mm, TheStatesOfTheRegistrationsAreRead) {
  struct Row {
    std::uint16_t code;
    std::string_view status;
    std::vector<std::array<int, 2>> states;
  };
  const Row rows[] = {
      {kMmState, "NORMAL_SERVICE", {{19, 8}, {19, 7}}},
      {kMmState, "LIMITED_SERVICE", {{19, 3}}},
      {kMmState, "NO_SERVICE", {{19, 2}, {19, 6}}},
      {kMmState, "AT_NOT_REGISTERED", {{19, 4}, {19, 5}}},
      {kMmState, "REGISTRATION_IN_PROGRESS", {{3, 9}, {14, 0}}},
      {kGmmState, "NORMAL_SERVICE", {{3, 0}, {3, 7}, {6, 0}}},
      {kGmmState, "LIMITED_SERVICE", {{3, 1}, {1, 1}}},
      {kGmmState, "NO_SERVICE", {{3, 5}, {3, 6}, {1, 5}, {1, 6}}},
      {kGmmState, "AT_NOT_REGISTERED", {{1, 0}, {1, 2}, {1, 3}}},
      {kGmmState, "REGISTRATION_IN_PROGRESS", {{2, 9}, {5, 9}}},
      {kGmmState, "SERVICE_DETACHED", {{4, 0}}},
  };
  const auto packet = [](int state, int substate, int update) {
    return "b0=" + std::to_string(state) + " b1=" + std::to_string(substate) + " b2=" + std::to_string(update);
  };
  Translator translator;
  for (const Row& row : rows) {
    const std::string isTold = (row.code == kMmState ? "MmContext{" : "GmmContext{") +
                               ("reg_status: KREG_STATUS_" + std::string(row.status)) + '}';
    for (const auto& [state, substate] : row.states)
      EXPECT_EQ(told(translator, row.code, packet(state, substate, 4)), isTold) << state << ' ' << substate;
    EXPECT_EQ(told(translator, row.code, packet(0, 8, 255)), isTold) << "what has no meaning changes nothing";
  }
  expectTranslation({kMmState, packet(19, 0, 0), "MmContext{update_status: STATUS_UPDATED}"});
  expectTranslation({kMmState, packet(0, 0, 2), "MmContext{update_status: STATUS_ROAMING_NOT_ALLOWED}"});
  expectTranslation({kMmState, packet(0, 0, 3), "MmContext{}"});
  expectTranslation({kGmmState, packet(3, 2, 0), "GmmContext{update_status: GPRS_STATUS_UPDATED}"});
  expectTranslation({kGmmState, packet(0, 0, 1), "GmmContext{update_status: GPRS_STATUS_NOT_UPDATED}"});
  expectTranslation({kGmmState, packet(0, 0, 3), "GmmContext{update_status: GPRS_STATUS_ROAMING_NOT_ALLOWED}"});
}

TEST(Mm, LocationUpdatingIsRead) {
  const std::string area = "lai: {encoded_plmn: 0x62f210, lac: 65534}";
  const std::string networks = " MmCommonInfo{eplmn_list: [{encoded_plmn: 0xaabbcc}]}";
  expectMessage("0502.62F210FFFE", "MmContext{update_status: STATUS_UPDATED, " + area + ", is_combined_proc: false}");
  expectMessage("054402",
                "MmContext{update_status: STATUS_ROAMING_NOT_ALLOWED, reject_cause: KNAS_MM_REJ_CAUSE_IMSI_UNKNOWN}");
  expectMessage("05C410",
                "MmContext{update_status: STATUS_NOT_UPDATED, reject_cause: KNAS_MM_REJ_CAUSE_MSC_OUT_OF_REACH}");
  Translator translator;
  EXPECT_NE(tellMessage(translator, "05040F"), "damaged");
  const std::string known =
      "MmContext{update_status: STATUS_UPDATED, " + area + ", tmsi: 287454020, is_combined_proc: false}";
  // An identity comes with its length; one of another type or size is none. What is known before stays.
  EXPECT_EQ(tellMessage(translator, "0502.62F210FFFE.1705F411223344.A1.4A03AABBCC"), known + networks);
  EXPECT_EQ(tellMessage(translator, "0502.62F210FFFE.1705F111223344.4A03AABBCC"), known + networks);
  EXPECT_EQ(tellMessage(translator, "0502.62F210FFFE.1704F4112233.4A03AABBCC"), known + networks);
  EXPECT_EQ(tellMessage(translator, "0502.62F210FFFE.4A03AABBCC"), known + networks);
  EXPECT_EQ(tellMessage(translator, "0502.62F210FFFE.1706F4AABBCCDD"), known) << "the identity is cut off";
  EXPECT_EQ(tellMessage(translator, "0508"), "");
  EXPECT_EQ(tellMessage(translator, "0602.62F210FFFE"), "") << "of another protocol";
}

TEST(Mm, PacketServiceIsRead) {
  expectMessage("0801.02E5E0.01", "GmmContext{reg_proc: KNAS_MM_REG_PROC_ATTACH}");
  expectMessage("0801.00.72", "GmmContext{reg_proc: KNAS_MM_REG_PROC_COMBINED_ATTACH}");
  expectMessage("0801.00.03", "GmmContext{reg_proc: KNAS_MM_REG_PROC_COMBINED_ATTACH}");
  expectMessage("0808.70", "GmmContext{reg_proc: KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE}");
  expectMessage("0808.03", "GmmContext{reg_proc: KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE}");
  expectMessage("0808.01", "GmmContext{reg_proc: KNAS_MM_REG_PROC_COMBINED_RAU}");
  expectMessage("0808.02", "GmmContext{reg_proc: KNAS_MM_REG_PROC_COMBINED_RAU}");
  expectMessage("0804.23",
                "GmmContext{update_status: GPRS_STATUS_ROAMING_NOT_ALLOWED, reject_cause: (unknown: 35), "
                "reg_proc: KNAS_MM_REG_PROC_PROC_NONE}");
  expectMessage("080B.02",
                "GmmContext{update_status: GPRS_STATUS_NOT_UPDATED, "
                "reject_cause: KNAS_MM_REJ_CAUSE_IMSI_UNKNOWN, reg_proc: KNAS_MM_REG_PROC_PROC_NONE}");
  const std::string area =
      "GmmContext{update_status: GPRS_STATUS_UPDATED, rai: {encoded_plmn: 0x62f210, lac: 65534, rac: 7}";
  const std::string none = ", reg_proc: KNAS_MM_REG_PROC_PROC_NONE}";
  expectMessage("0802.01.1F.00.62F210FFFE07", area + ", t3312_dur_s: 62" + none);
  expectMessage("0809.00.41.62F210FFFE07", area + ", t3312_dur_s: 360" + none);

  Translator translator;
  EXPECT_NE(tellMessage(translator, "0804.23"), "damaged");
  EXPECT_NE(tellMessage(translator, "0809.00.41.62F210FFFE07"), "damaged");
  // Elements without a length stand before; a timer without a value removes the one that was.
  EXPECT_EQ(
      tellMessage(translator, "0802.01.E0.00.62F210FFFE07.19AABBCC.1705.2518.2B4A.8C.1805F411223344.4A06AABBCCDDEEFF"),
      area + ", p_tmsi: 287454020" + none +
          " MmCommonInfo{eplmn_list: [{encoded_plmn: 0xaabbcc}, {encoded_plmn: 0xddeeff}]}");
  EXPECT_EQ(tellMessage(translator, "0808.04"), area + ", p_tmsi: 287454020}") << "an unknown procedure";
  EXPECT_EQ(tellMessage(translator, "0801.00.04"), area + ", p_tmsi: 287454020}");
}

}  // namespace vesk::diag
