#include <gtest/gtest.h>

#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

constexpr std::uint16_t kRr = 0x512F;

/// A packet of a channel (0 DCCH, 1 BCCH, 4 SACCH), to the phone.
Bytes rrPacket(int channel, const Bytes& message) {
  Bytes body = bodyOf("b0[0:7]=" + std::to_string(channel) + " b0[7:1]=1 b1=99 b2=" + std::to_string(message.size()));
  body.insert(body.end(), message.begin(), message.end());
  return body;
}

std::string tellRr(Translator& translator, int channel, std::string_view fields) {
  return told(translator, kRr, rrPacket(channel, bodyOf(fields)));
}

/// Every cut of the message is damage, whether the packet ends there or says that the message does, and leaves no
/// trace.
void expectMessage(int channel, std::string_view fields, std::string_view isTold) {
  const Bytes message = bodyOf(fields);
  Translator translator;
  for (std::size_t size = 0; size < message.size(); ++size) {
    const Bytes cut(message.begin(), message.begin() + static_cast<std::ptrdiff_t>(size));
    EXPECT_EQ(told(translator, kRr, rrPacket(channel, cut)), "damaged") << fields << ", " << size;
  }
  const Bytes whole = rrPacket(channel, message);
  EXPECT_EQ(told(translator, kRr, std::span(whole).first(whole.size() - 1)), "damaged");
  EXPECT_EQ(told(translator, kRr, whole), isTold) << fields;
}

constexpr int kDcch = 0;
constexpr int kBcch = 1;
constexpr int kSacch = 4;

/// Cell 0x1234 of 310-410, area 0x5678.
const std::string kCell = "b1=6 b2=27 x3=1234130014 x8=5678 ";

}  // namespace

TEST(GsmRr, SystemInformation3IsACellAndItsIdleConfiguration) {
  expectMessage(
      kBcch,
      "b1=6 b2=27 x3=FFFF62F210FFFE b10[6:1]=1 b11[0:3]=7 b12=255 b13[0:4]=15 b13[4:2]=2 b14[0:5]=31 "
      "b15[0:6]=63 b16[6:2]=3 b16[1:1]=1 b16[0:1]=1 x17=FBFF n19=1.1.111110.100.00001.1.11.0.0 b22=0",
      "GsmScellInfo{mcc: 262, mnc: 1, lac: 65534, cell_id: 65535, num_mnc_digits: 2} "
      "GsmIdleConfig{mcc: 262, mnc: 1, lac: 65534, ci: 65535, dtx_from_bs: 2, radio_link_timeout: 64, "
      "ms_txpwr: 31, rx_acc_min: 63, cbq: 1, cba: 1, c2_valid: 1, cr_offset: 62, tmp_offset: 4, penalty_t: 1, "
      "t3212: 255, acc: 64511, bs_pa_mfrms: 9, max_retrans_cs: 3, emerg_call_allowed: 1, attach_allowed: 1, "
      "reest_allowed: 0, ecsc: 1, si_2_ter_needed: 0}");
  // All padding, but for the last two that are read.
  expectMessage(kBcch, kCell + "x17=0400 n19=0.0.0.1.0 x20=2B2B2B",
                "GsmScellInfo{mcc: 310, mnc: 410, lac: 22136, cell_id: 4660, num_mnc_digits: 3} "
                "GsmIdleConfig{mcc: 310, mnc: 410, lac: 22136, ci: 4660, dtx_from_bs: 0, radio_link_timeout: 4, "
                "ms_txpwr: 0, rx_acc_min: 0, cba: 0, c2_valid: 0, t3212: 0, acc: 1024, bs_pa_mfrms: 2, "
                "max_retrans_cs: 0, emerg_call_allowed: 0, attach_allowed: 0, reest_allowed: 1, ecsc: 1, "
                "si_2_ter_needed: 1}");
}

TEST(GsmRr, SystemInformation3KnowsTheCellThatTheModemCampsOn) {
  Translator translator;
  const auto tellCell = [&translator] {
    const std::string text = tellRr(translator, kBcch, kCell + "b22=0");
    return text.substr(0, text.find('}') + 1);
  };
  const std::string unknown = "GsmScellInfo{mcc: 310, mnc: 410, lac: 22136, cell_id: 4660, num_mnc_digits: 3}";
  for (const std::string_view other : {"h0=7 b2=2 h4=4661 x6=130014 x9=5678", "h0=7 b2=2 h4=4660 x6=130014 x9=5679",
                                       "h0=7 b2=2 h4=4660 x6=130024 x9=5678", "h0=7 b2=2 h4=4660 x6=230014 x9=5678"}) {
    EXPECT_NE(told(translator, 0x5134, other), "damaged");
    EXPECT_EQ(tellCell(), unknown) << other;
  }
  EXPECT_NE(told(translator, 0x5134, "h0=7 b2=2 b3=1 h4=4660 x6=130014 x9=5678"), "damaged");
  EXPECT_EQ(tellCell(),
            "GsmScellInfo{mcc: 310, mnc: 410, lac: 22136, cell_id: 4660, arfcn: 7, bsic: 10, num_mnc_digits: 3}");
}

TEST(GsmRr, SystemInformation13IsThePacketService) {
  const std::string start = "b1=6 b2=0 n3=1.111.1111.";
  const std::string service = "11111110.1.101.10.01." + std::string(15, '1') + '.';
  const std::string isTold = "GsmGprsConfig{gprs_sup: true, rac: 254, sp_pg_cy: true, nco: 2, nom: 2, acc_thr: 5";
  expectMessage(kBcch, start + "0.0." + service + "0.0", isTold + "}");
  // A mobile allocation, as a list of numbers and as a map, with two reference frequencies.
  expectMessage(kBcch, start + "1.11.111111.1.1111.1.1111.0.1.1.111111.1.111111.0.0." + service + "0.0", isTold + "}");
  expectMessage(kBcch, start + "1.11.111111.0.0.000010.111.0." + service + "1.111111111.0", isTold + "}");
  // In an extension, behind its own optional part, if it goes so far.
  expectMessage(kBcch, start + "0.0." + service + "0.1.000101.0.1111.1", isTold + ", ext_upl_tbf_supported: true}");
  expectMessage(kBcch, start + "0.0." + service + "0.1.001010.1.11111.1111.0",
                isTold + ", ext_upl_tbf_supported: false}");
  expectMessage(kBcch, start + "0.0." + service + "0.1.000100.0.1111.1", isTold + "}");

  Translator translator;
  EXPECT_EQ(tellRr(translator, kBcch, "b1=6 b2=0 n3=0"), "") << "no packet service";
  EXPECT_EQ(tellRr(translator, kBcch, start + "0.1"), "") << "a broadcast channel of its own";
}

TEST(GsmRr, AReportIsTheCallAndItsNeighbours) {
  const std::string start = "b0=6 b1=21 n2=11.111111.1.0.111110.1.111.101.";
  for (const int channel : {kDcch, kSacch}) {
    expectMessage(channel, start + "010.111111.11111.000001.000010.00000.111111",
                  "GsmCsRfMeasurement{cs_tx_pwr: [], cs_rxlev_sub: 62, cs_rxqual_sub: 5} "
                  "GsmGrrEventMeasCr{gsm_ncell_meas: [{bsic: 1, rxlev: 63}, {bsic: 63, rxlev: 2}]}");
  }
  Translator translator;
  const std::string_view own = "GsmCsRfMeasurement{cs_tx_pwr: [], cs_rxlev_sub: 62, cs_rxqual_sub: 5}";
  EXPECT_EQ(tellRr(translator, kSacch, start + "111" + std::string(102, '1')), own) << "neighbours were not reported";
  EXPECT_EQ(tellRr(translator, kSacch, start + "000"), own);
  EXPECT_EQ(tellRr(translator, kSacch, "b0=6 b1=21 n2=11.111111.1.1.111110"), "") << "not valid";
  EXPECT_EQ(tellRr(translator, kBcch, start + "000"), "") << "not on this channel";
}

TEST(GsmRr, OtherMessagesTellNothing) {
  Translator translator;
  EXPECT_EQ(tellRr(translator, 3, "b0=6 b1=27"), "");
  EXPECT_EQ(tellRr(translator, kBcch, "b1=6 b2=28"), "");
  EXPECT_EQ(tellRr(translator, kBcch, "b1=5"), "") << "another protocol";
}

}  // namespace vesk::diag
