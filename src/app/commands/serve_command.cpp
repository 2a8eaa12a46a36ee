#include "app/commands/serve_command.h"

#include <memory>
#include <string>
#include <utility>

#include "app/commands/row_readings.h"
#include "app/output/word_list.h"
#include "app/program/app_delegate.h"
#include "app/program/drive_time.h"
#include "app/program/stop_signals.h"
#include "app/program/vesk_interface.h"
#include "app/source/play_recording.h"
#include "app/source/redaction.h"
#include "intake/metric_validator.h"
#include "system/output_lines.h"
#include "system/run_loop.h"
#include "system/timer.h"
#include "toolkit/application.h"
#include "web/http/listener.h"
#include "web/live_server.h"

namespace vesk {

namespace {

/// Where a browser on this machine finds a page that is served at `address`.
std::string placeOf(const std::string& address, std::uint16_t port) {
  std::string host = address;
  if (address.find(':') != std::string::npos) host = address == "::" ? "[::1]" : "[" + address + "]";
  if (address == "0.0.0.0") host = "127.0.0.1";
  return "http://" + host + ":" + std::to_string(port);
}

/// One run of the program behind its page.
class Serving {
 public:
  Serving(const ServeOptions& options, std::vector<insight::Rule> rules) : options_(options) {
    insight_.setRules(std::move(rules));
    boundTelling(stopSignal_, std::nullopt);
  }

  Outcome run() {
    OutputLines::setSink(nullptr);
    source_ = makeEventSource(options_.source, clock_,
                              {[this](const std::string& message) { fail(message); },
                               [](const std::string& remark) { tellUser("vesk: " + remark); },
                               [this](const std::optional<std::string>& failure) {
                                 if (failure) fail("vesk: " + *failure);
                               },
                               nullptr, nullptr},
                              options_.isRedacted ? &redaction_ : nullptr);
    if (source_.failure) {
      fail("vesk: " + *source_.failure);
      return outcome_;
    }
    corvik::installService(source_.service);
    Application application(veskInterface(), delegate_);
    if (application.run([this](NavigationController& root) { mainLoop(root); }) != 0) outcome_ = Outcome::failed;
    // The connection outlives all that the service was made of here.
    source_.service->shutDown();
    redaction_.tellLeftOut();
    return insight_.alerts() > 0 ? Outcome::ruleFired : outcome_;
  }

 private:
  void mainLoop(NavigationController& root) {
    if (const auto reason = whyNoMetricArrives(root)) return fail(*reason);
    std::string reason;
    const std::unique_ptr<web::LiveServer> page =
        web::LiveServer::open(options_.server,
                              {insight_, veskInterface(), readingOfRow, [this] { return source_.state().text; },
                               [](const std::string& remark) { tellUser("vesk: " + remark); }},
                              reason);
    if (page == nullptr) return fail("vesk: " + reason);
    tellPlace(page->port());
    insight_.setStepHandler([&](const insight::Report& report, const insight::Step& step) {
      time_.take(insight_.clock().now(), clock_.now());
      page->take(report, step);
    });
    insight_.observeEventsOf(*MetricValidator::shared());
    // What is known grows old while no event comes, too.
    const Timer aging(loop_, std::chrono::seconds(1), RunLoopMode::defaultMode, [this] {
      insight_.setLater(time_.passedSince(insight_.clock().now(), clock_.now(), source_.state().pace));
    });
    std::optional<Timer> end;
    if (options_.duration) end.emplace(loop_, *options_.duration, RunLoopMode::defaultMode, [this] { loop_.stop(); });
    loop_.run();
    MetricValidator::shared()->setEventObserver(nullptr);
  }

  void tellPlace(std::uint16_t port) {
    const std::string& address = options_.server.address;
    tellUser("vesk: serving " + placeOf(address, port) + "; Ctrl+C ends it");
    if (web::isLocal(address)) return;
    const std::string addresses = listOf(web::reachableAddresses(address));
    tellUser("vesk: everybody who reaches this machine" + (addresses.empty() ? "" : " at " + addresses) +
             " can read the measurements, without a password" +
             (options_.isRedacted ? "" : ", and the subscriber's identities; --redact leaves those out"));
  }

  void fail(const std::string& line) {
    outcome_ = Outcome::failed;
    tellUser(line);
  }

  const ServeOptions& options_;
  const SteadyClock clock_;
  Outcome outcome_ = Outcome::done;
  RunLoop loop_{clock_};
  const WakeUp& stopSignal_ = stopMainLoopOnSignals();
  Redaction redaction_;
  EventSource source_;
  insight::Insight insight_;
  DriveTime time_;
  AppDelegate delegate_;
};

}  // namespace

Outcome runServe(const ServeOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  return Serving(options, *std::move(rules)).run();
}

}  // namespace vesk
