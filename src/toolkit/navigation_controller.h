#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

#include "toolkit/view_controller.h"

namespace vesk {

/// A stack of screens of which the top one shows. The first screen stays for as long as the stack lives.
class NavigationController : public ViewController {
 public:
  NavigationController() = default;
  explicit NavigationController(const std::shared_ptr<ViewController>& root) { push(root); }

  /// From the first screen to the one that shows.
  [[nodiscard]] const std::vector<std::shared_ptr<ViewController>>& stack() const { return stack_; }
  /// The screen that shows; null when the stack is empty.
  [[nodiscard]] std::shared_ptr<ViewController> topViewController() const;

  /// Shows `screen`, which must be on no stack yet. It is loaded now, or with the stack's own view when that
  /// is still to come.
  void push(const std::shared_ptr<ViewController>& screen);
  /// Takes the top screen away; null when it is the first.
  std::shared_ptr<ViewController> pop();
  /// Takes screens away until `depth` are left, at least the first one.
  void popToDepth(std::size_t depth);

  /// `observer` is called whenever what shows has changed: another screen, or other content of the top one.
  void setDisplayObserver(std::function<void()> observer) { displayObserver_ = std::move(observer); }
  /// A screen of this stack has something new to show.
  void screenNeedsDisplay(const ViewController& screen);

  /// Loads the stack's own view first, then that of its top screen.
  void loadViewIfNeeded() override;
  /// Passes the warning on to every screen of the stack.
  void didReceiveMemoryWarning() override;

 private:
  std::vector<std::shared_ptr<ViewController>> stack_;
  std::function<void()> displayObserver_;
};

}  // namespace vesk
