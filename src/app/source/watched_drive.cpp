#include "app/source/watched_drive.h"

#include "app/source/play_recording.h"
#include "system/run_loop.h"

namespace vesk {

Outcome watchDrive(const RecordingInput& input, insight::Insight& insight, DataOutput& output,
                   const std::function<void()>& atEnd) {
  const bool isPipe = input.path == "-";
  const auto watch = [&] {
    MetricValidator& intake = *MetricValidator::shared();
    intake.setEventObserver([&](const TakenEvent& event) {
      insight.observe(event, intake.stores);
      if (isPipe) output.flush();
      if (output.hasFailed()) RunLoop::main().stop();
    });
  };
  const auto finish = [&](NavigationController& /*root*/) {
    MetricValidator::shared()->setEventObserver(nullptr);
    if (atEnd) atEnd();
  };
  const Outcome outcome = output.finish(playRecording(input, finish, watch));
  return insight.alerts() > 0 && !output.hasFailed() ? Outcome::ruleFired : outcome;
}

}  // namespace vesk
