#include "app/commands/report_command.h"

#include "app/commands/row_readings.h"
#include "app/output/whole_file.h"
#include "app/program/vesk_interface.h"
#include "app/source/watched_drive.h"
#include "web/report_page.h"

namespace vesk {

namespace {

std::string titleOf(const RecordingInput& input) {
  if (input.path == "-") return "standard input";
  // A capture is often called after the subscriber.
  if (input.isRedacted) return "redacted recording";
  return input.path->substr(input.path->rfind('/') + 1);
}

}  // namespace

Outcome runReport(const ReportOptions& options) {
  WholeFile page(options.output);
  if (page.hasFailed()) return Outcome::failed;
  if (page.isInput(*options.input.path)) {
    tellUser("vesk: the page would take the place of the recording it is made of; write it to another file with -o");
    return Outcome::wrongUsage;
  }
  DataOutput unused;
  insight::Insight insight;
  web::DriveRecord record(web::kWholeDrive);
  insight.setStepHandler(
      [&](const insight::Report& report, const insight::Step& step) { record.take(insight, report, step); });
  const Outcome outcome = watchDrive(options.input, insight, unused, [&] {
    page.begin();
    web::writeReport({titleOf(options.input), record, insight, veskInterface(), readingOfRow},
                     [&](std::string_view piece) { page.write(piece); });
  });
  // What no event could be read of leaves the page that was there.
  if (outcome != Outcome::failed || insight.counts().all > 0) page.commit();
  return page.hasFailed() ? Outcome::failed : outcome;
}

}  // namespace vesk
