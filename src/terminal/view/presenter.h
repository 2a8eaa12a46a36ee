#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "terminal/input/input_event.h"
#include "terminal/input/key_bindings.h"
#include "terminal/panels/panel_stack.h"
#include "terminal/view/diagnostics_pane.h"
#include "terminal/view/freshness.h"
#include "terminal/view/picture.h"
#include "terminal/view/surroundings.h"
#include "terminal/view/table_browser.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// What stands between the keys and the screens: it turns events into selection, scrolling, filter, hold
/// and panes, calls the toolkit for the rest, and says what shows. It knows no terminal. Main queue only.
class Presenter {
 public:
  /// `stack` must outlive the presenter.
  Presenter(NavigationController& stack, Surroundings surroundings, Signs signs = Signs::braille);

  void resize(Size size);
  void handle(const InputEvent& event);
  /// The mouse is no longer heard of, as when the program is stopped.
  void forgetMouse();

  /// While the replay goes to another moment, what shows stays as it is; then it is that of the moment.
  void setOnTheWay(bool isOnTheWay);
  /// Shows a line until `until`.
  void tell(std::string notice, Clock::Instant until);

  /// What shows at `now`, as of the toolkit's present state.
  [[nodiscard]] Picture picture(Clock::Instant now);
  /// Whether what shows has a drawing for every event, which is not worth drawing as often as a table.
  [[nodiscard]] bool showsPanel() const { return panel() != nullptr; }
  /// When the last picture will be another one by the passing of time alone.
  [[nodiscard]] std::optional<Clock::Instant> nextChange() const { return nextChange_; }

 private:
  /// The screens of the stack down to the values of a category.
  static constexpr std::size_t kDepthOfMetrics = 3;

  struct Screen {
    std::shared_ptr<ViewController> controller;
    /// Null for a screen that is no table.
    std::unique_ptr<TableBrowser> browser;
    /// What had come of a category when its rows were last taken over, in that reload.
    std::optional<Arrivals> arrivals{};
    std::uint64_t reload = 0;
  };

  void handleKey(const KeyEvent& event);
  void handleMouse(const MouseEvent& event);
  void perform(Action action);
  void performInHelp(Action action);
  void performOnTable(Action action);
  bool typeIntoFilter(const KeyEvent& event);
  void openArea(std::size_t index);
  void click(const MouseEvent& event);
  void goToDepth(std::size_t depth);
  void open();
  void goBack();
  void jump(std::chrono::seconds distance);
  void changeSpeed(int step);
  void toggleHold();
  void hold(bool isHeld);
  [[nodiscard]] bool isHolding() const { return isHeld_ || isOnTheWay_; }
  void scrollHelp(int lines);
  [[nodiscard]] Size paneRoom() const;
  [[nodiscard]] bool isOnScrollBar(const MouseEvent& event);
  void scrollTo(int line);
  void setTracking(bool isTracking);

  /// Brings the browsers in line with the navigation stack and the top one with its table.
  void followStack();
  void addScreen(const std::shared_ptr<ViewController>& controller);
  void noteArrivals(Screen& screen, const TableBrowser& shown);
  [[nodiscard]] TableBrowser* browser() { return screens_.empty() ? nullptr : screens_.back().browser.get(); }
  [[nodiscard]] Regions regions() const { return Regions::of(size_, paneHeight()); }
  /// The help lies over the pane.
  [[nodiscard]] PaneHeight paneHeight() const { return helpStart_ ? PaneHeight::None : pane_.height(); }
  [[nodiscard]] Panel* panel() const { return panels_ ? panels_->top() : nullptr; }
  /// Of what shows; null where nothing can be filtered.
  [[nodiscard]] const std::string* filter();
  void setFilter(std::string filter);
  [[nodiscard]] std::optional<insight::Kpi> selectedKpi();
  [[nodiscard]] std::vector<std::string> titles() const;
  /// The keys that do something where the user is.
  [[nodiscard]] std::vector<Action> hints(const Picture& picture);
  [[nodiscard]] std::vector<Action> hintsOnTable(const Picture& picture);
  void fillTable(Picture& picture, Clock::Instant now);
  void addHeadlines(Picture& picture, std::string_view area, Clock::Instant now);
  [[nodiscard]] std::string dateBehind(std::string_view status, std::string_view date) const;
  [[nodiscard]] std::chrono::milliseconds driveTime() const;
  [[nodiscard]] std::string timeBound(Freshness freshness, Clock::Instant now);
  [[nodiscard]] std::string technologyInstead(std::string_view area, std::string_view category) const;
  [[nodiscard]] PathBar pathBar(int statusWidth) const;
  void expectChange(std::optional<Clock::Instant> when);

  NavigationController& stack_;
  Surroundings surroundings_;
  /// Absent without insight.
  std::optional<PanelStack> panels_;
  Size size_;
  /// One for each screen of the stack, as of the last followStack.
  std::vector<Screen> screens_;
  bool isTypingFilter_ = false;
  /// By the user.
  bool isHeld_ = false;
  bool isOnTheWay_ = false;
  bool showsReadings_ = true;
  DiagnosticsPane pane_;
  std::optional<int> helpStart_;

  /// Where the mouse's button went down or was last dragged to.
  std::optional<MouseEvent> held_;
  bool isScrollBarHeld_ = false;
  bool isTracking_ = false;

  std::string notice_;
  std::optional<Clock::Instant> noticeEnd_;
  int statusWidth_ = 0;
  std::optional<Clock::Instant> nextChange_;
};

}  // namespace vesk
