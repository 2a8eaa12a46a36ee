#include "app/commands/run_command.h"

#include <memory>
#include <string>
#include <unistd.h>
#include <utility>
#include <vector>

#include "app/program/app_delegate.h"
#include "app/program/metric_arrivals.h"
#include "app/program/stop_signals.h"
#include "app/program/vesk_interface.h"
#include "app/source/redaction.h"
#include "app/source/road.h"
#include "insight/insight.h"
#include "intake/metric_validator.h"
#include "system/output_lines.h"
#include "system/run_loop.h"
#include "system/timer.h"
#include "terminal/terminal.h"
#include "toolkit/application.h"

namespace vesk {

namespace {

/// One run of the program, from the source of its events to what shows them.
class Run {
 public:
  Run(const RunOptions& options, std::vector<insight::Rule> rules)
      : options_(options), isHeadless_(options.isHeadless), isJudging_(!rules.empty()) {
    insight_.setRules(std::move(rules));
    if (options_.duration) end_ = clock_.now() + *options_.duration;
    boundTelling(stopSignal_, end_);
  }

  Outcome run() {
    source_ = makeEventSource(options_.source, clock_,
                              {[this](const std::string& message) { tell(message); },
                               [this](const std::optional<std::string>& failure) { sourceEnded(failure); }});
    if (source_.failure) {
      tellUser("vesk: " + *source_.failure);
      return Outcome::failed;
    }
    const std::shared_ptr<corvik::Service> service =
        options_.isRedacted ? makeRedactedService(source_.service, redaction_) : source_.service;
    corvik::installService(service);
    if (!isHeadless_ && isatty(STDOUT_FILENO) == 0) isHeadless_ = true;
    if (isHeadless_) {
      printLines();
    } else {
      OutputLines::setSink(std::make_unique<DiagnosticSink>(diagnostics_));
    }
    Application application(veskInterface(), delegate_);
    const int status = application.run([&](NavigationController& root) { mainLoop(application, root); });
    if (status != 0) outcome_ = Outcome::failed;
    // The connection outlives all that the service was made of here.
    service->shutDown();
    redaction_.tellLeftOut();
    OutputLines::setSink(nullptr);
    return isHeadless_ && insight_.alerts() > 0 ? Outcome::ruleFired : outcome_;
  }

 private:
  /// The diagnostic lines on standard output. When they can no longer be written nothing is left to be done.
  void printLines() {
    auto sink = std::make_unique<DescriptorSink>(STDOUT_FILENO, "standard output");
    sink->setFailureHandler([this](const std::string& reason) {
      tell("vesk: " + reason);
      loop_.stop();
    });
    sink->setInterrupt(&stopSignal_);
    sink->setDeadline(end_);
    OutputLines::setSink(std::move(sink));
  }

  void mainLoop(Application& application, NavigationController& root) {
    std::optional<Timer> end;
    if (options_.duration) {
      end.emplace(loop_, *options_.duration, RunLoopMode::defaultMode, [this] { loop_.stop(); });
    }
    if (isJudging_) judgeRules();
    if (!isHeadless_) openTerminal(application, root);
    const std::optional<std::string> reason = whyNoMetricArrives(root);
    if (reason) tell(*reason);
    if (!reason || !isHeadless_) loop_.run();
    closeTerminal();
    MetricValidator::shared()->setEventObserver(nullptr);
  }

  /// Those that fire are told among the diagnostic lines.
  void judgeRules() {
    insight_.setStepHandler([](const insight::Report& /*report*/, const std::vector<insight::TimelineEvent>& events) {
      for (const insight::TimelineEvent& event : events)
        if (event.kind == insight::EventKind::alert) OutputLines::print({"Alert:", textOf(event)});
    });
    insight_.observeEventsOf(*MetricValidator::shared());
  }

  void openTerminal(Application& application, NavigationController& root) {
    std::string reason;
    terminal_ = Terminal::open(root, clock_, surroundings(application), reason);
    if (terminal_ == nullptr) {
      tellUser("vesk: " + reason + "; running without screens");
      isHeadless_ = true;
      printLines();
      // The lines of the start were meant for the pane.
      for (const std::string& line : diagnostics_.lines())
        OutputLines::print({line});
      return;
    }
    MetricValidator::shared()->setArrivalObserver([this](std::int64_t metricId) {
      arrivals_.note(metricId);
      terminal_->setNeedsDisplay();
    });
    loop_.addInput(terminal_->descriptor(), [this] { terminal_->serve(); });
  }

  void closeTerminal() {
    MetricValidator::shared()->setArrivalObserver(nullptr);
    terminal_.reset();
    // What only the diagnostic lines have told is seen by nobody any more.
    if (!isHeadless_ && firstFault_) tellUser(*firstFault_);
  }

  Surroundings surroundings(Application& application) {
    return {
        .sourceState = [this] { return sourceState(); },
        .arrivals = [this](std::string_view area, std::string_view category) { return arrivals_.of(area, category); },
        .diagnostics = &diagnostics_,
        .setTracking =
            [this](bool isTracking) { loop_.setMode(isTracking ? RunLoopMode::tracking : RunLoopMode::defaultMode); },
        .quit = [this] { loop_.stop(); },
        .setInBackground =
            [&application](bool isInBackground) {
              if (isInBackground) {
                application.enterBackground();
              } else {
                application.enterForeground();
              }
            },
    };
  }

  SourceState sourceState() {
    const ShownState shown = source_.state();
    if (!shown.isMoving) return {shown.text};
    return {shown.text, clock_.now() + std::chrono::seconds(1)};
  }

  /// To the user where there are no screens, and to the diagnostic lines where there are.
  void tell(const std::string& line) {
    outcome_ = Outcome::failed;
    if (!firstFault_) firstFault_ = line;
    if (isHeadless_) {
      tellUser(line);
    } else {
      diagnostics_.append(line);
    }
  }

  void sourceEnded(const std::optional<std::string>& failure) {
    if (failure) tell("vesk: " + *failure);
    if (isHeadless_) loop_.stop();
    if (terminal_ != nullptr) terminal_->setNeedsDisplay();
  }

  const RunOptions& options_;
  const SteadyClock clock_;
  bool isHeadless_;
  /// Whether there are rules.
  bool isJudging_;
  /// When nobody is waited for any more; absent for never.
  std::optional<Clock::Instant> end_;
  Outcome outcome_ = Outcome::done;
  std::optional<std::string> firstFault_;
  RunLoop loop_{clock_};
  const WakeUp& stopSignal_ = stopMainLoopOnSignals();
  DiagnosticLines diagnostics_;
  MetricArrivals arrivals_{clock_};
  Redaction redaction_;
  EventSource source_;
  insight::Insight insight_;
  AppDelegate delegate_;
  std::unique_ptr<Terminal> terminal_;
};

}  // namespace

Outcome runProgram(const RunOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  return Run(options, *std::move(rules)).run();
}

}  // namespace vesk
