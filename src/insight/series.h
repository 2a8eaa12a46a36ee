#pragma once

#include <string>

#include "insight/insight.h"

/// The course of the KPIs: a row for each event that reports any, with all that is known then.
namespace vesk::insight {

/// "timestamp,technology,channel,code,lte.rsrp,…".
[[nodiscard]] std::string seriesHeader();
/// The row of now: "1516485159662,LTE,850,443,-125,…"; what is unknown is empty.
void appendSeriesRow(std::string& out, const Insight& insight);
/// The same for people: "21:52:39.662  LTE PCI 443 B2 850  lte.rsrp -125  lte.rsrq -20".
void appendSeriesLine(std::string& out, const Insight& insight);

}  // namespace vesk::insight
