#include <gtest/gtest.h>

#include "diag/written_packets.h"

namespace vesk::diag {

namespace {

std::string tellNas(Translator& translator, std::string_view hex) {
  return told(translator, 0xB0E2, "x0=01090500" + std::string(hex));
}

std::string bearers(std::string_view fields) {
  return "ActivatedBearerContexts{" + std::string(fields) + '}';
}

/// A request for bearer 5, up to its elements: access point "a.bc", an address of IPv4.
const std::string kRequest = "5201C1.0109.05016102.6263.0501C0A80102";
const std::string kBearer = "nsapi: 5, apn: a.bc, pdp_type: PDP_TYPE_IPv4_PDN, pdp_addr: 0xc0a80102";

}  // namespace

TEST(Bearers, ARequestBecomesABearerWhenItIsAccepted) {
  Translator translator;
  EXPECT_EQ(tellNas(translator, "5202C2"), "") << "nothing was asked for";
  EXPECT_EQ(tellNas(translator, kRequest), "");
  EXPECT_EQ(tellNas(translator, "6202C2"), "") << "another bearer";
  EXPECT_EQ(tellNas(translator, "5202C2"), bearers("bearer_contexts: [{" + kBearer + "}]"));
  EXPECT_EQ(tellNas(translator, "5202C2"), "") << "it is active already";
  // A dedicated bearer belongs to another, which is known by its identity when it was not seen.
  EXPECT_EQ(tellNas(translator, "7202C508"), "");
  EXPECT_EQ(tellNas(translator, "6202C5F5"), "");
  EXPECT_EQ(tellNas(translator, "6202C6"), bearers("bearer_contexts: [{" + kBearer + "}, {nsapi: 6}]"));
  EXPECT_EQ(tellNas(translator, "7202C6"),
            bearers("bearer_contexts: [{" + kBearer + "}, {nsapi: 6}, {nsapi: 7}, {nsapi: 8}]"));
  EXPECT_EQ(tellNas(translator, "5202CE"), bearers("bearer_contexts: [{nsapi: 6}, {nsapi: 7}, {nsapi: 8}]"));
  EXPECT_EQ(tellNas(translator, "5202CE"), "") << "it is active no more";
  // What is refused is forgotten, and so is what is asked for a bearer that is given up.
  for (const std::string_view end : {"5202C3", "5202C7", "5202CE"}) {
    EXPECT_EQ(tellNas(translator, kRequest), "");
    EXPECT_EQ(tellNas(translator, end), "") << end;
    EXPECT_EQ(tellNas(translator, "5202C2"), "") << end;
  }
  EXPECT_EQ(tellNas(translator, "5202CD"), "") << "of no interest";
  EXPECT_EQ(tellNas(translator, "5202"), "damaged");
  EXPECT_EQ(tellNas(translator, "5202C5"), "damaged");
}

TEST(Bearers, ANewAttachmentMakesAllOfThemKnown) {
  Translator translator;
  const std::string container = "000E" + kRequest.substr(0, 11) + "0403696D73.03020000";
  EXPECT_EQ(tellNas(translator, "6202C505"), "");
  EXPECT_EQ(tellNas(translator, "6202C6"), bearers("bearer_contexts: [{nsapi: 5}, {nsapi: 6}]"));
  EXPECT_NE(tellNas(translator, "074201.21.00" + container), "damaged");
  EXPECT_EQ(tellNas(translator, "0743.0004.5202C2"), "damaged");
  EXPECT_EQ(tellNas(translator, "0743.0002.5202C2"), "damaged") << "too short for such a message";
  EXPECT_EQ(tellNas(translator, "0743.0003.5202C2"),
            bearers("bearer_context_count: 1, bearer_contexts: "
                    "[{nsapi: 5, apn: ims, pdp_type: PDP_TYPE_IPv6_PDN, pdp_addr: 0x0000}]"));
  EXPECT_EQ(tellNas(translator, "0743.0003.5202C2"), "");
  EXPECT_EQ(tellNas(translator, "5202CE"), bearers("bearer_context_count: 0"));
}

TEST(Bearers, ARequestThatIsCutOffIsDamaged) {
  Translator translator;
  const Bytes request = bodyOf("x0=01090500" + kRequest);
  for (std::size_t size = 0; size < request.size(); ++size) {
    EXPECT_EQ(told(translator, 0xB0E2, std::span(request).first(size)), "damaged") << size;
    EXPECT_EQ(tellNas(translator, "5202C2"), "");
  }
  EXPECT_EQ(tellNas(translator, "5201C1.00.02.0261.00"), "damaged") << "the label is longer than the name";
}

TEST(Bearers, NameServersStandInTheProtocolOptions) {
  struct Row {
    std::string options;
    std::string isTold;
  };
  const std::string ipv6 = "20010DB8000000000000000000000001";
  const std::string first = ", primary_dns_type: PDP_TYPE_IPv4, primary_dns_addr: 0x01020304";
  const Row rows[] = {
      {"80", ""},
      {"80.000D0401020304", first},
      {"80.000D0401020304.000310" + ipv6,
       first + ", secondary_dns_type: PDP_TYPE_IPv6, secondary_dns_addr: 0x20010db8000000000000000000000001"},
      // Of any more, of the same once more, and of none the place is not taken.
      {"80.000D0400000000.000D0401020304.000D0401020304.000D0405060708.000D0409090909",
       first + ", secondary_dns_type: PDP_TYPE_IPv4, secondary_dns_addr: 0x05060708"},
      {"80.000D0301020304.000D0401020304", ""},
      {"80.000C0401020304.000D0401020304", first},
      {"80.8021.10.03000010.8106.01020304.8306.05060708",
       first + ", secondary_dns_type: PDP_TYPE_IPv4, secondary_dns_addr: 0x05060708"},
      {"80.8021.0D.03000010.030309.8106.01020304", first},
      {"80.8021.0C.03000010.0301.8106.01020304", ""},
      {"80.8021.04.03000010.000D0401020304", first},
  };
  for (const Row& row : rows) {
    Translator translator;
    EXPECT_EQ(tellNas(translator, kRequest + "5D0100.27" + withLength(row.options)), "");
    EXPECT_EQ(tellNas(translator, "5202C2"), bearers("bearer_contexts: [{" + kBearer + row.isTold + "}]"))
        << row.options;
  }
}

}  // namespace vesk::diag
