#include "app/series_command.h"

#include <string>

#include "app/watched_drive.h"
#include "insight/series.h"

namespace vesk {

Outcome runSeries(const RecordingInput& input, bool asCsv) {
  DataOutput output;
  insight::Insight insight;
  std::string line;
  if (asCsv) output.writeLine(insight::seriesHeader());
  insight.setStepHandler([&](const insight::Report& report, const std::vector<insight::TimelineEvent>& /*events*/) {
    if (report.kpis.empty()) return;
    line.clear();
    if (asCsv) {
      insight::appendSeriesRow(line, insight);
    } else {
      insight::appendSeriesLine(line, insight);
    }
    output.writeLine(line);
  });
  return watchDrive(input, insight, output);
}

}  // namespace vesk
