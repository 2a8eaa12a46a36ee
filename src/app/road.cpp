#include "app/road.h"

#include <chrono>
#include <memory>

#include "app/app_delegate.h"
#include "app/events_input.h"
#include "app/progress.h"
#include "app/recording_hint.h"
#include "app/root_navigation_controller.h"
#include "app/vesk_interface.h"
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

Outcome playRecording(const std::optional<std::string>& path,
                      const std::function<void(NavigationController& root)>& use) {
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
  const EventsInput* input = nullptr;
  std::shared_ptr<corvik::RecordedService> service;
  if (path) {
    auto opened = std::make_unique<EventsInput>(*path, std::nullopt);
    if (const auto failure = opened->open()) {
      fail("vesk: " + *failure);
      return outcome;
    }
    input = opened.get();
    service = std::make_shared<corvik::RecordedService>(
        std::move(opened), clock, corvik::Playback{.speed = std::nullopt}, corvik::RecordedService::Runs::onMainThread);
    service->setBadLineHandler(fail);
    service->setEndHandler([&](const std::optional<std::string>& failure) {
      if (failure) fail("vesk: " + *failure);
      loop.stop();
    });
  }
  corvik::installService(service);

  AppDelegate delegate;
  Application application(veskInterface(), delegate);
  const int status = application.run([&](NavigationController& root) {
    if (path) {
      if (const auto reason = whyNoMetricArrives(root)) {
        fail(*reason);
        return;
      }
      std::optional<Timer> ticker;
      if (progress.isPossible()) {
        ticker.emplace(loop, kProgressInterval, RunLoopMode::defaultMode, [&] {
          const corvik::PlaybackState state = service->state();
          progress.show(state.events, state.position, state.duration);
        });
      }
      loop.run();
      progress.hide();
      if (const auto state = service->state(); state.events == 0 && state.badLines > 0) tellIsNoRecording(*path);
      for (const std::string& remark : input->remarks())
        tellUser(remark);
    }
    use(root);
  });
  if (status != 0) outcome = Outcome::failed;
  // The connection outlives all that the service was made of here.
  if (service != nullptr) service->shutDown();
  return outcome;
}

}  // namespace vesk
