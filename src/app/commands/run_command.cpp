#include "app/commands/run_command.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <memory>
#include <string>
#include <unistd.h>
#include <utility>
#include <vector>

#include "app/program/app_delegate.h"
#include "app/program/configuration.h"
#include "app/program/shown_moment.h"
#include "app/program/stop_signals.h"
#include "app/program/vesk_interface.h"
#include "app/source/play_recording.h"
#include "app/source/redaction.h"
#include "app/source/replay_control.h"
#include "insight/insight.h"
#include "intake/metric_validator.h"
#include "screens/vesk_view_items.h"
#include "system/output_lines.h"
#include "system/run_loop.h"
#include "system/timer.h"
#include "terminal/terminal.h"
#include "toolkit/application.h"
#include "values/text_form.h"

namespace vesk {

namespace {

/// One run of the program, from the source of its events to what shows them.
class Run {
 public:
  Run(const RunOptions& options, bool isHeadless, Configuration configuration, std::vector<insight::Rule> rules)
      : options_(options),
        isHeadless_(isHeadless),
        isJudging_(!rules.empty()),
        configuration_(std::move(configuration)) {
    insight_.setRules(std::move(rules));
    if (options_.duration) end_ = clock_.now() + *options_.duration;
    boundTelling(stopSignal_, end_);
  }

  Outcome run() {
    source_ = makeEventSource(options_.source, clock_,
                              {[this](const std::string& message) { tell(message); },
                               [this](const std::string& remark) { show("vesk: " + remark); },
                               [this](const std::optional<std::string>& failure) { sourceEnded(failure); },
                               [this](bool isFromStart) { seekBegun(isFromStart); },
                               [this](double sinceLastEvent) { seekEnded(sinceLastEvent); }},
                              options_.isRedacted ? &redaction_ : nullptr);
    control_.setPlayer(source_.player);
    if (source_.failure) {
      tellUser("vesk: " + *source_.failure);
      return Outcome::failed;
    }
    corvik::installService(source_.service);
    if (isHeadless_) {
      printLines();
    } else {
      OutputLines::setSink(std::make_unique<DiagnosticSink>(diagnostics_));
    }
    Application application(veskInterface(), delegate_);
    const int status = application.run([&](NavigationController& root) { mainLoop(application, root); });
    if (status != 0) outcome_ = Outcome::failed;
    // The connection outlives all that the service was made of here.
    source_.service->shutDown();
    redaction_.tellLeftOut();
    OutputLines::setSink(nullptr);
    return isHeadless_ && insight_.alerts() > 0 ? Outcome::ruleFired : outcome_;
  }

 private:
  /// The diagnostic lines on standard output. When they can no longer be written nothing is left to be done.
  void printLines() {
    auto sink = std::make_unique<DescriptorSink>(STDOUT_FILENO, "standard output");
    sink->setFailureHandler([this, &written = *sink](const std::string& reason) {
      if (!written.hasReaderLeft()) tell("vesk: " + reason);
      loop_.stop();
    });
    sink->setInterrupt(&stopSignal_);
    sink->setDeadline(end_);
    OutputLines::setSink(std::move(sink));
  }

  void mainLoop(Application& application, NavigationController& root) {
    std::optional<Timer> end;
    if (options_.duration) {
      end.emplace(loop_, *options_.duration, RunLoopMode::common, [this] { loop_.stop(); });
    }
    if (isJudging_) judgeRules();
    root_ = &root;
    if (!isHeadless_) openTerminal(application, root);
    std::optional<Timer> aging;
    if (!isHeadless_) aging.emplace(loop_, std::chrono::seconds(1), RunLoopMode::defaultMode, [this] { showAging(); });
    if (isJudging_ || !isHeadless_) insight_.observeEventsOf(*MetricValidator::shared());
    const std::optional<std::string> reason = whyNoMetricArrives(root);
    if (reason) tell(*reason);
    if (!reason || !isHeadless_) loop_.run();
    closeTerminal();
    MetricValidator::shared()->setEventObserver(nullptr);
  }

  /// Those that fire are told among the diagnostic lines, and on the screens.
  void judgeRules() {
    insight_.setStepHandler([this](const insight::Report& /*report*/, const insight::Step& step) {
      for (const insight::TimelineEvent& event : step)
        if (event.kind == insight::EventKind::alert) tellAlert(textOf(event));
    });
  }

  void tellAlert(const std::string& alert) {
    if (isOnTheWay_) return;
    OutputLines::print({"Alert:", alert});
    if (terminal_ != nullptr) terminal_->tell("Alert: " + alert, true);
  }

  /// What is known grows old while no event comes, too.
  void growOlder() {
    if (!isOnTheWay_) insight_.setLater(moment_.sinceLastEvent());
  }

  void showAging() {
    if (!isOnTheWay_ && moment_.sinceLastEvent() > 0) terminal_->setNeedsDisplay();
  }

  void openTerminal(Application& application, NavigationController& root) {
    std::string reason;
    terminal_ = Terminal::open(root, clock_, surroundings(application), configuration_.appearance, reason);
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
      moment_.noteArrival(metricId, MetricValidator::shared()->stores);
      terminal_->setNeedsDisplay();
    });
    showStart(root);
    loop_.addInput(terminal_->descriptor(), [this] { terminal_->serve(); });
  }

  void showStart(NavigationController& root) {
    const StartView& start = configuration_.start;
    const auto open = [&](std::string_view label, const std::vector<Text>& labels) {
      auto* menu = dynamic_cast<TableViewController*>(root.topViewController().get());
      const auto found = std::find(labels.begin(), labels.end(), Text::copy(label));
      if (menu != nullptr && found != labels.end())
        menu->selectRow({0, static_cast<std::size_t>(found - labels.begin())});
    };
    const VeskViewItems& menu = VeskViewItems::shared();
    if (!start.area.empty()) open(start.area, menu.launchViewItemNames);
    if (!start.category.empty()) open(start.category, menu.categoriesOf(start.area));
    if (start.action) terminal_->perform(*start.action);
  }

  void closeTerminal() {
    MetricValidator::shared()->setArrivalObserver(nullptr);
    terminal_.reset();
    // What only the diagnostic lines have told is seen by nobody any more.
    if (isHeadless_ || faults_ == 0) return;
    tellUser(firstFault_);
    if (faults_ > 1) tellUser("vesk: " + counted(faults_ - 1, "more fault", "more faults") + "; --headless tells each");
  }

  Surroundings surroundings(Application& application) {
    Surroundings surroundings{
        .growOlder = [this] { growOlder(); },
        .sourceState = [this] { return sourceState(); },
        .isSeekable = control_.isSeekable(),
        .setHeld = [this](bool isHeld) { setHeld(isHeld); },
        .changeSpeed = [this](int step) { changeSpeed(step); },
        .jump = [this](std::chrono::seconds distance) { control_.jump(distance); },
        .drive = &insight_,
        .goToEvent = [this](const insight::TimelineEvent& event) { control_.goTo(event.moment); },
        .diagnostics = &diagnostics_,
        .setTracking =
            [this](bool isTracking) { loop_.setMode(isTracking ? RunLoopMode::tracking : RunLoopMode::defaultMode); },
        .quit = [this] { loop_.stop(); },
        .warn = [](const std::string& line) { tellUser("vesk: " + line); },
        .setInBackground =
            [&application](bool isInBackground) {
              if (isInBackground) {
                application.enterBackground();
              } else {
                application.enterForeground();
              }
            },
    };
    moment_.addTo(surroundings);
    return surroundings;
  }

  SourceState sourceState() {
    const ShownState shown = source_.state();
    std::optional<Clock::Instant> nextChange;
    if (shown.isMoving) nextChange = clock_.now() + std::chrono::seconds(1);
    return {shown.text, nextChange, moment_.date()};
  }

  void setHeld(bool isHeld) {
    isHeld_ = isHeld;
    moment_.keepTime();
    control_.setHeld(isHeld);
    if (!isOnTheWay_) showMoment();
  }

  void changeSpeed(int step) {
    moment_.keepTime();
    control_.changeSpeed(step);
  }

  /// What was shown stays until the moment that is sought has come.
  void seekBegun(bool isFromStart) {
    isOnTheWay_ = true;
    if (terminal_ != nullptr) {
      terminal_->setOnTheWay(true);
      // What stands there is of the moment that is left.
      terminal_->tell({}, false);
    }
    if (!moment_.isHeld()) moment_.hold();
    OutputLines::setSink(nullptr);
    if (!isFromStart) return;
    MetricValidator::shared()->startAnew();
    insight_.startAnew();
    moment_.startAnew();
  }

  /// `sinceLastEvent`: how long before the moment the last event came, in seconds.
  void seekEnded(double sinceLastEvent) {
    isOnTheWay_ = false;
    moment_.setSinceLastEvent(std::chrono::milliseconds(std::llround(sinceLastEvent * 1000)));
    OutputLines::setSink(std::make_unique<DiagnosticSink>(diagnostics_));
    showMoment();
    if (auto* table = dynamic_cast<TableViewController*>(root_->topViewController().get()))
      table->tableView().reloadData();
    if (terminal_ != nullptr) terminal_->setOnTheWay(false);
  }

  void showMoment() {
    growOlder();
    if (isHeld_) {
      moment_.hold();
    } else {
      moment_.release();
    }
  }

  /// To the user where there are no screens, and to the diagnostic lines where there are.
  void tell(const std::string& line) {
    outcome_ = Outcome::failed;
    if (faults_++ == 0) firstFault_ = line;
    show(line);
  }

  void show(const std::string& line) {
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
  Configuration configuration_;
  /// When nobody is waited for any more; absent for never.
  std::optional<Clock::Instant> end_;
  Outcome outcome_ = Outcome::done;
  std::size_t faults_ = 0;
  std::string firstFault_;
  RunLoop loop_{clock_};
  const WakeUp& stopSignal_ = stopMainLoopOnSignals();
  DiagnosticLines diagnostics_;
  Redaction redaction_;
  EventSource source_;
  insight::Insight insight_;
  ShownMoment moment_{clock_, insight_, [this] { return source_.state().pace; }};
  ReplayControl control_{[this](const std::string& line) {
    if (terminal_ != nullptr) terminal_->tell(line, false);
  }};
  /// By the user.
  bool isHeld_ = false;
  /// To the moment that is sought.
  bool isOnTheWay_ = false;
  NavigationController* root_ = nullptr;
  AppDelegate delegate_;
  std::unique_ptr<Terminal> terminal_;
};

}  // namespace

Outcome runProgram(const RunOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  const bool isHeadless = options.isHeadless || isatty(STDOUT_FILENO) == 0;
  auto configuration = isHeadless ? Configuration{} : readConfiguration(configurationPath());
  if (!configuration) return Outcome::wrongUsage;
  rules->insert(rules->begin(), configuration->rules.begin(), configuration->rules.end());
  return Run(options, isHeadless, *std::move(configuration), *std::move(rules)).run();
}

}  // namespace vesk
