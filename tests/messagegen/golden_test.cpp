#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <sstream>

#include "emit.h"
#include "names.h"
#include "resolver.h"

namespace messagegen {
namespace {

std::optional<std::string> readGolden(const std::string& name) {
  std::ifstream file(std::string(VESK_GOLDEN) + '/' + name, std::ios::binary);
  if (!file) return std::nullopt;
  return std::string(std::istreambuf_iterator<char>(file), {});
}

/// Empty when there is none.
std::string firstDifference(const std::optional<std::string>& golden, const std::string& emitted) {
  if (golden == emitted) return "";
  std::istringstream was(golden.value_or(""));
  std::istringstream is(emitted);
  std::string oldLine;
  std::string newLine;
  for (int number = 1;; ++number) {
    const bool wasOver = !std::getline(was, oldLine);
    const bool isOver = !std::getline(is, newLine);
    if (wasOver || isOver || oldLine != newLine) {
      return "line " + std::to_string(number) + ": was \"" + oldLine + "\", is \"" + newLine + '"';
    }
  }
}

TEST(GeneratedCode, IsWhatItWas) {
  const ProtoFile file = loadProto("kinds.proto", readGolden);
  const std::string advice =
      "Look at the difference; where it is meant, take it over with\n"
      "  g=tests/messagegen/golden/messages; build/release/bin/messagegen $g $g kinds.proto";
  EXPECT_EQ(firstDifference(readGolden("kinds.h"), emitHeader(file)), "") << advice;
  EXPECT_EQ(firstDifference(readGolden("kinds.cpp"), emitSource(file)), "") << advice;
}

TEST(Names, FollowFromTheKeyByOneRule) {
  struct Case {
    std::string key;
    bool repeated;
    std::string property;
    std::string element;
  };
  const Case cases[] = {
      {"timestamp", false, "timestamp", "timestamp"},
      {"Thres_X_highP", false, "thresXHighP", "thresXHighP"},
      {"QRxLevMin", false, "qRxLevMin", "qRxLevMin"},
      {"Pmax", false, "pmax", "pmax"},
      {"idle_rxlev_dBm", false, "idleRxlevDBm", "idleRxlevDBm"},
      {"si_7_8_broadcast", false, "si78Broadcast", "si78Broadcast"},
      {"avg_values", false, "avgValues", "avgValues"},
      {"multi_band_info", true, "multiBandInfos", "multiBandInfo"},
      {"inst_values", true, "instValues", "instValues"},
      {"gsm_ncell_meas", true, "gsmNcellMeas", "gsmNcellMeas"},
      {"cs_tx_pwr", true, "csTxPwrs", "csTxPwr"},
  };
  for (const Case& row : cases) {
    Field field{};
    field.name = row.key;
    field.repeated = row.repeated;
    EXPECT_EQ(propertyOf(field), row.property);
    EXPECT_EQ(elementOf(field), row.element);
  }
}

}  // namespace
}  // namespace messagegen
