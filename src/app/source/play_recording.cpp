#include "app/source/play_recording.h"

#include <chrono>
#include <memory>

#include "app/output/progress.h"
#include "app/program/app_delegate.h"
#include "app/program/root_navigation_controller.h"
#include "app/program/vesk_interface.h"
#include "app/source/events_input.h"
#include "app/source/recording_input.h"
#include "app/source/redaction.h"
#include "corvik/recorded_service.h"
#include "system/clock.h"
#include "system/output_lines.h"
#include "system/run_loop.h"
#include "system/timer.h"
#include "toolkit/application.h"

namespace vesk {

namespace {

constexpr std::chrono::milliseconds kProgressInterval{200};

}  // namespace

std::optional<std::string> whyNoMetricArrives(const NavigationController& root) {
  if (dynamic_cast<const RootNavigationController&>(root).isConfigurationAccepted()) return std::nullopt;
  return "vesk: the metric configuration is missing or was refused, and no metric arrives; --log stderr tells more";
}

Outcome playRecording(const RecordingInput& input, const std::function<void(NavigationController& root)>& use,
                      const std::function<void()>& beforePlaying) {
  OutputLines::setSink(nullptr);
  const SteadyClock clock;
  RunLoop loop(clock);
  Outcome outcome = Outcome::done;
  Progress progress(Progress::Output::atTheEnd);
  const auto fail = [&](const std::string& reason) {
    progress.hide();
    tellUser(reason);
    outcome = Outcome::failed;
  };
  Redaction redaction;
  const EventsInput* events = nullptr;
  std::shared_ptr<corvik::RecordedService> service;
  if (input.path) {
    using Runs = corvik::RecordedService::Runs;
    const bool isWatchedPipe = beforePlaying && *input.path == "-";
    auto opened = std::make_unique<EventsInput>(*input.path, input.sim);
    // What a pipe holds is waited for where it is played.
    if (const auto failure = isWatchedPipe ? std::nullopt : opened->open()) {
      fail("vesk: " + *failure);
      return outcome;
    }
    events = opened.get();
    service =
        std::make_shared<corvik::RecordedService>(std::move(opened), clock, corvik::Playback{.speed = std::nullopt},
                                                  isWatchedPipe ? Runs::onThreadOfItsOwn : Runs::onMainThread);
    service->setBadLineHandler(fail);
    service->setEndHandler([&](const std::optional<std::string>& failure) {
      if (failure) fail("vesk: " + *failure);
      loop.stop();
    });
  }
  const std::shared_ptr<corvik::Service> installed =
      input.isRedacted && service != nullptr ? makeRedactedService(service, redaction) : service;
  corvik::installService(installed);

  AppDelegate delegate;
  Application application(veskInterface(), delegate);
  const int status = application.run([&](NavigationController& root) {
    if (input.path) {
      if (const auto reason = whyNoMetricArrives(root)) {
        fail(*reason);
        return;
      }
      if (beforePlaying) beforePlaying();
      std::optional<Timer> ticker;
      if (progress.isPossible()) {
        ticker.emplace(loop, kProgressInterval, RunLoopMode::defaultMode, [&] {
          const corvik::PlaybackState state = service->state();
          progress.show(state.events, state.position, state.duration);
        });
      }
      loop.run();
      progress.hide();
      if (const auto state = service->state(); state.events == 0 && state.badLines > 0)
        tellUser("vesk: " + remarkOnNoRecording(*input.path));
      for (const std::string& remark : events->remarks())
        tellUser(remark);
    }
    use(root);
  });
  if (status != 0) outcome = Outcome::failed;
  // The connection outlives all that the service was made of here.
  if (installed != nullptr) installed->shutDown();
  redaction.tellLeftOut();
  return outcome;
}

}  // namespace vesk
