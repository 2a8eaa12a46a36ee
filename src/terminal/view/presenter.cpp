#include "terminal/view/presenter.h"

#include <algorithm>
#include <utility>

#include "terminal/panels/kpi_look.h"
#include "terminal/view/filter_typing.h"
#include "terminal/view/renderer.h"

namespace vesk {

namespace {

constexpr int kWheelLines = 3;
constexpr std::chrono::seconds kJump{10};

}  // namespace

Presenter::Presenter(NavigationController& stack, Surroundings surroundings, Signs signs)
    : stack_(stack), surroundings_(std::move(surroundings)), pane_(surroundings_.diagnostics) {
  if (surroundings_.drive != nullptr) panels_.emplace(*surroundings_.drive, surroundings_.goToEvent, signs);
}

void Presenter::resize(Size size) {
  size_ = size;
  forgetMouse();
}

void Presenter::forgetMouse() {
  held_.reset();
  setTracking(false);
}

void Presenter::setTracking(bool isTracking) {
  if (isTracking == std::exchange(isTracking_, isTracking)) return;
  if (surroundings_.setTracking) surroundings_.setTracking(isTracking);
}

void Presenter::followStack() {
  const auto& stack = stack_.stack();
  const auto isSame = [](const Screen& screen, const std::shared_ptr<ViewController>& controller) {
    return screen.controller == controller;
  };
  const auto differs = std::mismatch(screens_.begin(), screens_.end(), stack.begin(), stack.end(), isSame).first;
  if (differs != screens_.end() || screens_.size() < stack.size()) {
    isTypingFilter_ = false;
    screens_.erase(differs, screens_.end());
    for (std::size_t depth = screens_.size(); depth < stack.size(); ++depth)
      addScreen(stack[depth]);
    for (const Screen& screen : screens_) {
      if (screen.browser != nullptr && !screen.browser->filter().empty()) screen.browser->setFilter({});
    }
  }
  if (TableBrowser* shown = browser()) {
    const Regions regions = this->regions();
    shown->setViewport({regions.listColumns, std::max(regions.list.count(), 1)});
    shown->follow();
    noteArrivals(screens_.back(), *shown);
    if (isHolding() && !shown->isFrozen()) shown->setFrozen(true);
  }
}

void Presenter::addScreen(const std::shared_ptr<ViewController>& controller) {
  Screen& screen = screens_.emplace_back(Screen{controller, nullptr});
  auto* table = dynamic_cast<TableViewController*>(controller.get());
  if (table == nullptr) return;
  TableContent::ReadingOf readingOf;
  if (screens_.size() == kDepthOfMetrics && surroundings_.reading) {
    readingOf = [this, titles = titles()](IndexPath at, std::string_view name) {
      return surroundings_.reading(titles[1], titles[2], at, name);
    };
  }
  screen.browser = std::make_unique<TableBrowser>(*table, std::move(readingOf));
}

/// The rows are as old as what had come when they were taken over, however much has come since.
void Presenter::noteArrivals(Screen& screen, const TableBrowser& shown) {
  if (screens_.size() != kDepthOfMetrics || !surroundings_.arrivals || screen.reload == shown.reloadCount()) return;
  screen.reload = shown.reloadCount();
  const std::vector<std::string> titles = this->titles();
  screen.arrivals = surroundings_.arrivals(titles[1], titles[2]);
}

void Presenter::hold(bool isHeld) {
  for (const Screen& screen : screens_)
    if (screen.browser != nullptr) screen.browser->setFrozen(isHeld);
  if (panels_) panels_->setHeld(isHeld);
}

void Presenter::toggleHold() {
  isHeld_ = !isHeld_;
  if (surroundings_.setHeld) surroundings_.setHeld(isHeld_);
  hold(isHolding());
}

void Presenter::setOnTheWay(bool isOnTheWay) {
  if (!std::exchange(isOnTheWay_, isOnTheWay) && !isOnTheWay) return;
  if (!isOnTheWay) hold(false);
  followStack();
  hold(isHolding());
}

void Presenter::tell(std::string notice, Clock::Instant until) {
  notice_ = std::move(notice);
  noticeEnd_ = until;
}

void Presenter::handle(const InputEvent& event) {
  followStack();
  if (const auto* key = std::get_if<KeyEvent>(&event)) {
    forgetMouse();
    handleKey(*key);
  } else if (const auto* mouse = std::get_if<MouseEvent>(&event)) {
    handleMouse(*mouse);
  } else if (isTypingFilter_ && filter() != nullptr) {
    setFilter(pasteInto(*filter(), std::get<PasteEvent>(event).text));
  }
}

void Presenter::handleKey(const KeyEvent& event) {
  if (isTypingFilter_ && typeIntoFilter(event)) return;
  const std::optional<Action> action = actionOf(event);
  if (!action) return;
  if (*action == Action::Area) {
    helpStart_.reset();
    openArea(event.character - U'1');
  } else if (helpStart_) {
    performInHelp(*action);
  } else {
    perform(*action);
  }
}

const std::string* Presenter::filter() {
  if (panel() != nullptr) return panel()->filter();
  return browser() != nullptr ? &browser()->filter() : nullptr;
}

void Presenter::setFilter(std::string filter) {
  if (panel() != nullptr) {
    panel()->setFilter(std::move(filter));
  } else if (browser() != nullptr) {
    browser()->setFilter(std::move(filter));
  }
}

/// False for the keys that mean the same while a filter is typed.
bool Presenter::typeIntoFilter(const KeyEvent& event) {
  if (filter() == nullptr) return false;
  std::optional<TypedFilter> typed = typeInto(*filter(), event);
  if (!typed) return false;
  isTypingFilter_ = typed->goesOn;
  if (typed->filter != *filter()) setFilter(std::move(typed->filter));
  return true;
}

/// Of the selected row of a screen of values.
std::optional<insight::Kpi> Presenter::selectedKpi() {
  const std::vector<std::string> titles = this->titles();
  const auto name = titles.size() == kDepthOfMetrics && browser() != nullptr ? browser()->selectedName() : std::nullopt;
  return name ? kpiOfRow(titles[1], titles[2], name->view()) : std::nullopt;
}

void Presenter::openArea(std::size_t index) {
  if (panels_) panels_->close();
  stack_.popToDepth(1);
  followStack();
  if (browser() != nullptr) browser()->screen().selectRow({0, index});
}

void Presenter::perform(Action action) {
  if (panels_ && panels_->perform(action, action == Action::Trend ? selectedKpi() : std::nullopt)) {
    isTypingFilter_ = false;
    return;
  }
  switch (action) {
    case Action::Help:
      helpStart_ = 0;
      return;
    case Action::Filter:
      isTypingFilter_ = filter() != nullptr;
      return;
    case Action::Diagnostics:
      pane_.changeHeight();
      return;
    case Action::OlderLines:
      return pane_.scroll(-std::max(paneRoom().lines - 1, 1), paneRoom());
    case Action::NewerLines:
      return pane_.scroll(+std::max(paneRoom().lines - 1, 1), paneRoom());
    case Action::Quit:
      if (surroundings_.quit) surroundings_.quit();
      return;
    case Action::Freeze:
      return toggleHold();
    case Action::Backward:
      return jump(-kJump);
    case Action::Forward:
      return jump(+kJump);
    case Action::Faster:
      return changeSpeed(+1);
    case Action::Slower:
      return changeSpeed(-1);
    case Action::Readings:
      showsReadings_ = !showsReadings_;
      return;
    case Action::Open:
    case Action::Back:
    case Action::Up:
    case Action::Down:
    case Action::PageUp:
    case Action::PageDown:
    case Action::First:
    case Action::Last:
    case Action::NextSection:
      return performOnTable(action);
    case Action::Overview:
    case Action::Trend:
    case Action::Timeline:
    case Action::Cells:
    case Action::Sort:
    case Action::Area:
      return;
  }
}

void Presenter::performOnTable(Action action) {
  if (action == Action::Back) return goBack();
  TableBrowser* shown = browser();
  if (shown == nullptr) return;
  if (action == Action::Open) open();
  if (action == Action::Up) shown->moveSelection(-1);
  if (action == Action::Down) shown->moveSelection(+1);
  if (action == Action::PageUp) shown->page(-1);
  if (action == Action::PageDown) shown->page(+1);
  if (action == Action::First) shown->selectFirst();
  if (action == Action::Last) shown->selectLast();
  if (action == Action::NextSection) shown->selectNextSection();
}

void Presenter::jump(std::chrono::seconds distance) {
  if (surroundings_.jump) surroundings_.jump(distance);
}

void Presenter::changeSpeed(int step) {
  if (surroundings_.changeSpeed) surroundings_.changeSpeed(step);
}

void Presenter::performInHelp(Action action) {
  const int page = std::max(regions().list.count() - 1, 1);
  switch (action) {
    case Action::Help:
    case Action::Back:
      helpStart_.reset();
      return;
    case Action::Quit:
      return perform(action);
    case Action::Up:
      return scrollHelp(-1);
    case Action::Down:
      return scrollHelp(+1);
    case Action::PageUp:
      return scrollHelp(-page);
    case Action::PageDown:
      return scrollHelp(+page);
    case Action::First:
      return scrollHelp(-helpLineCount(size_.columns));
    case Action::Last:
      return scrollHelp(+helpLineCount(size_.columns));
    case Action::Open:
    case Action::Filter:
    case Action::Freeze:
    case Action::Backward:
    case Action::Forward:
    case Action::Faster:
    case Action::Slower:
    case Action::Readings:
    case Action::Overview:
    case Action::Trend:
    case Action::Timeline:
    case Action::Cells:
    case Action::Sort:
    case Action::Area:
    case Action::Diagnostics:
    case Action::OlderLines:
    case Action::NewerLines:
    case Action::NextSection:
      return;
  }
}

void Presenter::scrollHelp(int lines) {
  const int last = std::max(helpLineCount(size_.columns) - regions().list.count(), 0);
  helpStart_ = std::clamp(*helpStart_ + lines, 0, last);
}

/// Where the lines of the pane stand.
Size Presenter::paneRoom() const {
  return {size_.columns - kBarMargin, std::max(regions().pane.count() - 1, 1)};
}

void Presenter::open() {
  TableBrowser* shown = browser();
  if (shown == nullptr || !shown->selection()) return;
  shown->screen().selectRow(*shown->selection());
}

void Presenter::goBack() {
  TableBrowser* shown = browser();
  if (shown != nullptr && !shown->filter().empty()) {
    shown->setFilter({});
  } else {
    stack_.pop();
  }
}

void Presenter::handleMouse(const MouseEvent& event) {
  TableBrowser* shown = browser();
  switch (event.action) {
    case MouseAction::WheelUp:
    case MouseAction::WheelDown: {
      const int lines = event.action == MouseAction::WheelUp ? -kWheelLines : kWheelLines;
      if (regions().pane.has(event.line)) {
        pane_.scroll(lines, paneRoom());
      } else if (helpStart_) {
        scrollHelp(lines);
      } else if (panel() != nullptr) {
        panel()->scroll(lines);
      } else if (shown != nullptr) {
        shown->scroll(lines);
      }
      return;
    }
    case MouseAction::Press:
      setTracking(false);
      held_ = event;
      isScrollBarHeld_ = isOnScrollBar(event);
      if (isScrollBarHeld_) scrollTo(event.line);
      return;
    case MouseAction::Drag:
      if (!held_ || shown == nullptr || helpStart_ || panel() != nullptr) return;
      if (isScrollBarHeld_) {
        setTracking(true);
        return scrollTo(event.line);
      }
      if (!isTracking_ && (event.line == held_->line || !regions().list.has(held_->line))) return;
      setTracking(true);
      shown->scroll(held_->line - event.line);
      held_ = event;
      return;
    case MouseAction::Release: {
      const std::optional<MouseEvent> pressed = std::exchange(held_, std::nullopt);
      const bool wasDragged = isTracking_;
      setTracking(false);
      if (pressed && !wasDragged && pressed->line == event.line) click(*pressed);
      return;
    }
  }
}

bool Presenter::isOnScrollBar(const MouseEvent& event) {
  const Regions regions = this->regions();
  return browser() != nullptr && !helpStart_ && panel() == nullptr && event.column == regions.listColumns &&
         regions.list.has(event.line);
}

void Presenter::scrollTo(int line) {
  const Regions::Lines list = regions().list;
  browser()->scrollTo(line - list.start, list.count());
}

/// Of the path: the table screens, then the panels over them.
void Presenter::goToDepth(std::size_t depth) {
  const std::size_t tables = stack_.stack().size();
  if (panels_) panels_->close(depth > tables ? depth - tables : 0);
  if (depth < tables) stack_.popToDepth(depth);
}

void Presenter::click(const MouseEvent& event) {
  const Regions regions = this->regions();
  if (event.line == regions.bar) {
    for (const PathSegment& segment : pathBar(statusWidth_).segments) {
      const int column = event.column - kBarMargin;
      if (segment.column <= column && column < segment.end) goToDepth(segment.depth);
    }
  } else if (helpStart_) {
    helpStart_.reset();
  } else if (panel() != nullptr) {
    if (regions.panel(size_.columns).has(event.column, event.line)) {
      panel()->click(event.column, event.line - regions.title);
    }
  } else if (regions.list.has(event.line) && event.column < regions.listColumns) {
    TableBrowser* shown = browser();
    if (shown != nullptr && shown->selectLine(event.line - regions.list.start)) open();
  }
}

}  // namespace vesk
