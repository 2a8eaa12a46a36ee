#include "terminal/terminal.h"

#include <optional>
#include <utility>
#include <vector>

#include "terminal/device/column_width.h"
#include "terminal/device/difference.h"
#include "terminal/view/renderer.h"

namespace vesk {

std::unique_ptr<Terminal> Terminal::open(NavigationController& stack, const Clock& clock, Surroundings surroundings,
                                         const Appearance& appearance, std::string& reason) {
  std::optional<FileDescriptor> terminal = TerminalDevice::openControllingTerminal();
  if (!terminal) {
    reason = "there is no terminal to show screens on";
    return nullptr;
  }
  std::optional<Capabilities> capabilities =
      readCapabilities(terminal->get(), setUpCharacterLocale(), appearance, reason);
  if (!capabilities) return nullptr;
  if (!capabilities->warning.empty() && surroundings.warn) surroundings.warn(capabilities->warning);
  return std::make_unique<Terminal>(stack, clock, std::move(surroundings), std::move(*terminal),
                                    std::move(*capabilities));
}

Terminal::Terminal(NavigationController& stack, const Clock& clock, Surroundings surroundings, FileDescriptor terminal,
                   Capabilities capabilities)
    : stack_(stack),
      clock_(clock),
      surroundings_(std::move(surroundings)),
      capabilities_(std::move(capabilities)),
      device_(std::move(terminal), {capabilities_.enterScreen, capabilities_.leaveScreen}),
      presenter_(stack, surroundings_, capabilities_.signs) {
  stack_.setDisplayObserver([this] { setNeedsDisplay(); });
  if (surroundings_.diagnostics != nullptr) {
    surroundings_.diagnostics->setObserver([this] { setNeedsDisplay(); });
  }
  startAfresh();
  draw(clock_.now());
}

Terminal::~Terminal() {
  stack_.setDisplayObserver(nullptr);
  if (surroundings_.diagnostics != nullptr) surroundings_.diagnostics->setObserver(nullptr);
  presenter_.forgetMouse();
}

void Terminal::serve() {
  const Clock::Instant now = clock_.now();
  isServing_ = true;
  const TerminalDevice::Arrived arrived = device_.receive();
  std::vector<InputEvent> events;
  input_.feed(arrived.bytes, now, events);
  for (const InputEvent& event : events)
    presenter_.handle(event);
  if (arrived.isStopWanted) {
    suspend();
  } else if (arrived.isContinued) {
    device_.enter();
    startAfresh();
  } else if (arrived.isResized) {
    startAfresh();
  }
  isServing_ = false;
  if (arrived.isHungUp) {
    if (surroundings_.quit) surroundings_.quit();
    return;
  }
  const bool isUrgent = !events.empty() || arrived.isStopWanted || arrived.isContinued || arrived.isResized;
  const bool isFrameDue = needsDisplay_ && now >= nextFrame();
  const bool hasTimeChangedIt = presenter_.nextChange() && *presenter_.nextChange() <= now;
  if (isUrgent || isFrameDue || hasTimeChangedIt) {
    draw(clock_.now());
  } else {
    scheduleWakeUp(now);
  }
}

void Terminal::setNeedsDisplay() {
  if (std::exchange(needsDisplay_, true) || isServing_) return;
  scheduleWakeUp(clock_.now());
}

void Terminal::perform(Action action) {
  const BoundKey& key = *bindingOf(action).keys.begin();
  presenter_.handle(KeyEvent{.key = key.key, .character = key.character});
  setNeedsDisplay();
}

void Terminal::setOnTheWay(bool isOnTheWay) {
  presenter_.setOnTheWay(isOnTheWay);
  setNeedsDisplay();
}

void Terminal::tell(std::string notice, bool rings) {
  constexpr std::chrono::seconds kShown{6};
  constexpr std::chrono::seconds kQuiet{1};
  const Clock::Instant now = clock_.now();
  presenter_.tell(std::move(notice), now + kShown);
  if (rings && now >= lastRung_ + kQuiet) {
    device_.write("\a");
    lastRung_ = now;
  }
  setNeedsDisplay();
}

void Terminal::suspend() {
  presenter_.forgetMouse();
  if (surroundings_.setInBackground) surroundings_.setInBackground(true);
  device_.suspend();
  if (surroundings_.setInBackground) surroundings_.setInBackground(false);
  startAfresh();
}

/// Nothing of what was drawn can be relied on any more.
void Terminal::startAfresh() {
  presenter_.resize(device_.size());
  shown_ = {};
}

/// A terminal that is still behind with the picture before is shown the newest one later.
void Terminal::draw(Clock::Instant now) {
  if (device_.isBehind()) {
    needsDisplay_ = true;
    return scheduleWakeUp(now);
  }
  Grid wanted = render(presenter_.picture(now));
  std::string bytes;
  appendDifference(bytes, shown_, wanted, capabilities_);
  device_.write(bytes);
  shown_ = std::move(wanted);
  needsDisplay_ = false;
  lastDrawn_ = now;
  scheduleWakeUp(now);
}

void Terminal::scheduleWakeUp(Clock::Instant now) {
  std::optional<Clock::Instant> next = input_.deadline();
  const auto consider = [&](std::optional<Clock::Instant> when) {
    if (when && (!next || *when < *next)) next = when;
  };
  // The device tells by itself when a terminal that is behind has room again.
  if (!device_.isBehind()) {
    consider(presenter_.nextChange());
    if (needsDisplay_) consider(nextFrame());
  }
  device_.wakeAfter(next ? std::optional(*next - now) : std::nullopt);
}

}  // namespace vesk
