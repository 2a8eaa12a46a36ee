#include "app/program/headlines.h"

#include <gtest/gtest.h>

#include "insight/drive.h"

namespace vesk {
namespace {

using namespace insight;

TEST(Headlines, AreTheFiguresThatTheDriveIsJudgedBy) {
  Drive drive;
  const auto headline = [&](std::string_view area, std::string_view category) {
    return headlineOf(sourceOf(area, category), drive.stores());
  };
  EXPECT_EQ(headline("LTE", "Serving Cell Meas"), "");
  drive.play({
      event<KCellularLteRsrpRsrqSinr>(0, K_LTE_RSRP_RSRQ_SINR,
                                      [](auto& message) {
                                        const auto sample = std::make_shared<RsrpRsrqSinr>();
                                        sample->setRsrp0(-113);
                                        sample->setRsrp1(-109);
                                        message.addInstValues(sample);
                                      }),
      lteNeighbors(0, {{5815, 338, -104}, {2000, 62, -98}}),
      lteCell(0, 5815, 316),
      umtsLevel(0, -80, 29),
  });
  EXPECT_EQ(headline("LTE", "Serving Cell Meas"), "-109 dBm, poor");
  EXPECT_EQ(headline("LTE", "LTE Neighbor Cell Meas"), "-98 dBm, fair");
  EXPECT_EQ(headline("LTE", "Serving Cell Info"), "PCI 316");
  EXPECT_EQ(headline("UMTS", "Serving Cell Meas"), "-90 dBm, fair") << "RSSI and Ec/N0 tell the RSCP";
}

}  // namespace
}  // namespace vesk
