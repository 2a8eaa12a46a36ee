#include <gtest/gtest.h>

#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

std::string tellEmm(Translator& translator, std::string_view hex) {
  return told(translator, 0xB0EC, "x0=01090500" + std::string(hex));
}

/// What a message tells; cut off anywhere it is damage.
void expectEmm(std::string_view hex, std::string_view isTold) {
  expectTranslation({0xB0EC, "x0=01090500" + std::string(hex), isTold});
}

std::string emm(std::string_view fields) {
  return "EmmContext{" + std::string(fields) + '}';
}

/// The list of areas in an accept, of a type and a number, and the message in it, which asks for bearer 5.
const std::string kAreas = "06.0062F2100001";
const std::string kBearerRequest = "0010.5201C1.0109.0403696D73.05010A000001";
const std::string kAreaFields = "tai_list: [{encoded_plmn: 0x62f210, tac: 1}]";

}  // namespace

TEST(EpsNas, TheStateOfTheRegistrationIsRead) {
  struct Row {
    std::string_view status;
    std::vector<std::array<int, 2>> states;
  };
  const Row rows[] = {
      {"NORMAL_SERVICE", {{3, 0}, {5, 3}}},           {"NO_SERVICE", {{3, 3}, {3, 4}, {1, 1}, {1, 3}}},
      {"LIMITED_SERVICE", {{3, 5}, {1, 6}}},          {"AT_NOT_REGISTERED", {{1, 5}, {1, 2}, {1, 4}}},
      {"REGISTRATION_IN_PROGRESS", {{2, 9}, {4, 0}}}, {"SERVICE_DETACHED", {{6, 0}}},
  };
  const auto packet = [](int state, int substate, std::string_view rest) {
    return "b0=2 b1=" + std::to_string(state) + " h2=" + std::to_string(substate) + ' ' + std::string(rest);
  };
  Translator translator;
  for (const Row& row : rows) {
    const std::string status = emm("reg_status: KREG_STATUS_" + std::string(row.status));
    for (const auto& [state, substate] : row.states)
      EXPECT_EQ(told(translator, 0xB0EE, packet(state, substate, "b18=0")), status) << state << ' ' << substate;
    // A state without a meaning leaves what is known, and so does an identity that is not valid or of another kind.
    EXPECT_EQ(told(translator, 0xB0EE, packet(3, 256, "b8=6 w15=1")), status);
    EXPECT_EQ(told(translator, 0xB0EE, packet(7, 0, "b7=1 b8=5 w15=1")), status);
  }
  expectTranslation({0xB0EE, packet(3, 0, "b7=255 b8=6 h12=65535 b14=255 w15=4294967295"),
                     "EmmContext{reg_status: KREG_STATUS_NORMAL_SERVICE, "
                     "guti: {mmegi: 65535, mmec: 255, m_tmsi: 4294967295}}"});
}

TEST(EpsNas, RequestsSayWhichProcedureRuns) {
  expectEmm("074171", emm("reg_proc: EMM_PROC_ATTACH"));
  expectEmm("07417A", emm("reg_proc: EMM_PROC_ATTACH_COMB"));
  expectEmm("074176", emm("reg_proc: EMM_PROC_EMERGENCY_ATTACH"));
  expectEmm("074170", emm(""));
  expectEmm("074878", emm("reg_proc: EMM_PROC_TAU"));
  expectEmm("074871", emm("reg_proc: EMM_PROC_TAU_COMB"));
  expectEmm("074872", emm("reg_proc: EMM_PROC_TAU_COMB"));
  expectEmm("074873", emm("reg_proc: EMM_PROC_PERIODIC_TAU"));
  expectEmm("074874", emm(""));
  expectEmm("C7", emm("reg_proc: EMM_PROC_SERV_REQ"));
  expectEmm("074C", emm("reg_proc: EMM_PROC_SERV_REQ"));
  Translator translator;
  EXPECT_EQ(tellEmm(translator, "C7"), emm("reg_proc: EMM_PROC_SERV_REQ"));
  EXPECT_EQ(tellEmm(translator, "074172"), emm("reg_proc: EMM_PROC_ATTACH_COMB"));
  EXPECT_EQ(tellEmm(translator, "074874"), emm("")) << "an unknown procedure takes the place of a known one";
  EXPECT_EQ(tellEmm(translator, "17074171"), "") << "protected";
  EXPECT_EQ(tellEmm(translator, "0755"), "") << "of no interest";
  EXPECT_EQ(tellEmm(translator, "03"), "") << "of another protocol";
}

TEST(EpsNas, AnAttachAcceptIsReadWithItsElements) {
  // Up to the end of what it must have, every cut is damage.
  expectEmm("074201.49" + kAreas + kBearerRequest, emm("update_status: EPS_STATUS_UPDATED, " + kAreaFields +
                                                       ", reg_proc: EMM_PROC_NO_PROC, t3412_dur_s: 3240"));

  Translator translator;
  const std::string accept = "074202.5F" + kAreas + kBearerRequest;
  const std::string fields = "update_status: EPS_STATUS_UPDATED, " + kAreaFields;
  const std::string all =
      "9F.500BF662F2108001FFC0000001.1362F2101234.2305F411223344.5312.640201FF.4A0862F220130014FFFF.53AA";
  EXPECT_EQ(
      tellEmm(translator, accept + all),
      emm(fields + ", guti: {mmegi: 32769, mmec: 255, m_tmsi: 3221225473}, "
                   "reject_cause: EMM_CAUSE_CS_DOMAIN_NOT_AVAILABLE, reg_proc: EMM_PROC_NO_PROC, t3412_dur_s: 11160, "
                   "is_ims_voice_supported: true, is_emerg_bearer_supported: false") +
          " MmContext{update_status: STATUS_UPDATED, lai: {encoded_plmn: 0x62f210, lac: 4660}, tmsi: 287454020, "
          "is_combined_proc: true} "
          "MmCommonInfo{eplmn_list: [{encoded_plmn: 0x62f220}, {encoded_plmn: 0x130014}]}");
  // A timer of another unit and a cause that is not given are removed, all else stays. Alone, it is no matter of MM's.
  EXPECT_EQ(tellEmm(translator, "074201.60" + kAreas + kBearerRequest + "1362F2101234.4A0262F2"),
            emm(fields + ", guti: {mmegi: 32769, mmec: 255, m_tmsi: 3221225473}, reg_proc: EMM_PROC_NO_PROC, "
                         "is_ims_voice_supported: true, is_emerg_bearer_supported: false") +
                " MmCommonInfo{}");
  // What is cut off is left out with what follows; a short identity and an empty element say nothing.
  Translator other;
  EXPECT_EQ(tellEmm(other, accept + "500AF662F2108001FFC00000.6400.2304F4112233.1362F2101234.4A03AABB"),
            emm(fields + ", reg_proc: EMM_PROC_NO_PROC, t3412_dur_s: 11160") +
                " MmContext{update_status: STATUS_UPDATED, lai: {encoded_plmn: 0x62f210, lac: 4660}, "
                "is_combined_proc: true}");
}

TEST(EpsNas, AnUpdateAcceptChangesWhatItNames) {
  expectEmm("074900", emm("update_status: EPS_STATUS_UPDATED, reg_proc: EMM_PROC_NO_PROC"));
  Translator translator;
  EXPECT_EQ(tellEmm(translator, "0749F5.5A21.5406.0162F2100001"), "damaged") << "the list is cut off by its element";
  const std::string fields =
      "update_status: EPS_STATUS_UPDATED, " + kAreaFields + ", reg_proc: EMM_PROC_NO_PROC, t3412_dur_s: 60";
  EXPECT_EQ(tellEmm(translator, "0749F5.5A21.54" + kAreas + "13AABBCC0001"),
            emm(fields) +
                " MmContext{update_status: STATUS_UPDATED, lai: {encoded_plmn: 0xaabbcc, lac: 1}, "
                "is_combined_proc: true}");
  EXPECT_EQ(tellEmm(translator, "074900.13AABBCC0001"), emm(fields)) << "not combined; what is not named stays";
  EXPECT_EQ(tellEmm(translator, "0749F1.13AABBCC0002.5AFF.5400"),
            emm("update_status: EPS_STATUS_UPDATED, reg_proc: EMM_PROC_NO_PROC") +
                " MmContext{update_status: STATUS_UPDATED, lai: {encoded_plmn: 0xaabbcc, lac: 2}, "
                "is_combined_proc: true}");
}

TEST(EpsNas, RejectsDetachesAndNewIdentitiesAreRead) {
  expectEmm("07440B", emm("update_status: EPS_STATUS_ROAMING_NOT_ALLOWED, "
                          "reject_cause: EMM_CAUSE_PLMN_NOT_ALLOWED, reg_proc: EMM_PROC_NO_PROC"));
  expectEmm("074B11", emm("update_status: EPS_STATUS_NOT_UPDATED, reject_cause: EMM_CAUSE_NETWORK_FAILURE, "
                          "reg_proc: EMM_PROC_NO_PROC"));
  Translator translator;
  for (const int cause : {2, 3, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16, 24, 25, 26, 34, 35, 36}) {
    constexpr std::string_view kForbidding = " 3 6 7 8 11 12 13 14 15 25 35 ";
    const bool isForbidden = kForbidding.find(' ' + std::to_string(cause) + ' ') != std::string_view::npos;
    const std::string text = told(translator, 0xB0EC, "b0=1 b4=7 b5=78 b6=" + std::to_string(cause));
    EXPECT_EQ(text.find("ROAMING_NOT_ALLOWED,") != std::string::npos, isForbidden) << cause;
  }
  expectEmm("0745",
            emm("reg_status: KREG_STATUS_SERVICE_DETACHED") + " ActivatedBearerContexts{bearer_context_count: 0}");
  expectEmm("0750.0BF662F2108001FFC0000001", emm("guti: {mmegi: 32769, mmec: 255, m_tmsi: 3221225473}"));
  EXPECT_EQ(tellEmm(translator, "0750.00.5406"), tellEmm(translator, "0750.00")) << "what is cut off is left out";
  EXPECT_EQ(tellEmm(translator, "0750.00.540200FF"), "damaged");
}

TEST(EpsNas, ListsOfAreasHaveThreeForms) {
  const auto tellList = [](std::string_view hex) {
    Translator translator;
    const std::string text = tellEmm(translator, "0750.00.54" + withLength(hex));
    return text.substr(0, text.rfind(']') + 1);
  };
  const auto list = [](std::string_view areas) { return "EmmContext{tai_list: [" + std::string(areas) + ']'; };
  EXPECT_EQ(tellList("01.AABBCC.FFFF.0000.E3"),
            list("{encoded_plmn: 0xaabbcc, tac: 65535}, {encoded_plmn: 0xaabbcc, tac: 0}"));
  EXPECT_EQ(tellList("22.AABBCC.00FF.00.DDEEFF.0001"),
            list("{encoded_plmn: 0xaabbcc, tac: 255}, {encoded_plmn: 0xaabbcc, tac: 256}, "
                 "{encoded_plmn: 0xaabbcc, tac: 257}, {encoded_plmn: 0xddeeff, tac: 1}"));
  EXPECT_EQ(tellList("41.AABBCC.0001.DDEEFF.0002.60.00"),
            list("{encoded_plmn: 0xaabbcc, tac: 1}, {encoded_plmn: 0xddeeff, tac: 2}"));
}

}  // namespace vesk::diag
