#include "app/summary_command.h"

#include "app/watched_drive.h"
#include "insight/summary_form.h"

namespace vesk {

Outcome runSummary(const RecordingInput& input, bool asJson) {
  DataOutput output;
  insight::Insight insight;
  return watchDrive(input, insight, output,
                    [&] { output.writeLine(asJson ? insight::summaryJson(insight) : insight::summaryText(insight)); });
}

}  // namespace vesk
