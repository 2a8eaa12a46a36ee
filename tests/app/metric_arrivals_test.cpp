#include "app/program/metric_arrivals.h"

#include <gtest/gtest.h>

#include "handset/driven_events.h"
#include "intake/metric_validator.h"
#include "messages/gsm/gsm.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_identifiers.h"
#include "support/metric_events.h"
#include "system/output_lines.h"

namespace vesk {
namespace {

using namespace std::chrono_literals;

TEST(MetricArrivals, CountForAListOnlyWhatHasIt) {
  MetricArrivals arrivals;
  const auto shown = [&](std::string_view category) {
    const Arrivals of = arrivals.of("LTE", category).value();
    return std::to_string(of.count) + (of.last ? " at " + std::to_string(of.last->count()) : "") +
           (of.isWithoutList ? " without" : "");
  };
  EXPECT_EQ(shown("UMTS Neighbor Cell Meas"), "0");
  arrivals.note(K_LTE_INTERRAT_MEAS, Record{{"meas_nbr_utra"_text, Value(Array{})}}, 1s);
  arrivals.note(K_LTE_INTERRAT_MEAS, Record{}, 5s);
  EXPECT_EQ(shown("UMTS Neighbor Cell Meas"), "1 at 1000");
  EXPECT_EQ(shown("GSM Neighbor Cell Meas"), "2 at 5000 without");
  arrivals.note(K_LTE_RRC_STATE, Record{}, 7s);
  EXPECT_EQ(shown("RRC State"), "1 at 7000");
}

TEST(MetricArrivals, KnowEveryListOfADrive) {
  OutputLines::setSink(nullptr);
  const auto intake = MetricValidator::listeningTo(nullptr);
  MetricArrivals arrivals;
  const auto take = [&](std::int64_t metricId, Data payload) {
    if (intake->validateMetric(metricEvent(metricId, std::move(payload))))
      arrivals.note(metricId, *latestRecordOf(intake->stores, metricId), 1s);
  };
  for (const handset::HandsetEvent& each : handset::drivenEvents(1, 900))
    if (each.kind != handset::HandsetEvent::Kind::trigger) take(each.id, each.payload);
  // What this drive does not come to.
  metrics::KCellularSimCardFiles files;
  files.addEfList(std::make_shared<metrics::ElementaryFile>());
  take(K_SIM_FILE_INFO, encoded(files));
  metrics::KCellularGsmGrrEventMeasCr neighbors;
  neighbors.addLteNcellMeas(std::make_shared<metrics::LteNcellMeas>());
  take(K_GSM_NCELL_MEAS, encoded(neighbors));
  for (const CategorySource& source : categorySources()) {
    if (source.list == nullptr) continue;
    EXPECT_TRUE(isListFilled(source, intake->stores)) << source.area << ' ' << source.category;
    EXPECT_FALSE(arrivals.of(source.area, source.category)->isWithoutList) << source.area << ' ' << source.category;
  }
}

}  // namespace
}  // namespace vesk
