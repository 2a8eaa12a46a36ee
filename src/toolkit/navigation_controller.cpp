#include "toolkit/navigation_controller.h"

#include <algorithm>
#include <utility>

namespace vesk {

std::shared_ptr<ViewController> NavigationController::topViewController() const {
  return stack_.empty() ? nullptr : stack_.back();
}

void NavigationController::push(const std::shared_ptr<ViewController>& screen) {
  screen->navigationController_ = this;
  stack_.push_back(screen);
  if (isViewLoaded()) screen->loadViewIfNeeded();
  screenNeedsDisplay(*screen);
}

std::shared_ptr<ViewController> NavigationController::pop() {
  if (stack_.size() < 2) return nullptr;
  std::shared_ptr<ViewController> screen = std::move(stack_.back());
  stack_.pop_back();
  screen->navigationController_ = nullptr;
  screen->didLeaveNavigationStack();
  stack_.back()->loadViewIfNeeded();
  screenNeedsDisplay(*stack_.back());
  return screen;
}

void NavigationController::popToDepth(std::size_t depth) {
  while (stack_.size() > std::max<std::size_t>(depth, 1))
    pop();
}

void NavigationController::screenNeedsDisplay(const ViewController& screen) {
  if (displayObserver_ && !stack_.empty() && stack_.back().get() == &screen) displayObserver_();
}

void NavigationController::loadViewIfNeeded() {
  if (isViewLoaded()) return;
  ViewController::loadViewIfNeeded();
  if (!stack_.empty()) stack_.back()->loadViewIfNeeded();
}

void NavigationController::didReceiveMemoryWarning() {
  ViewController::didReceiveMemoryWarning();
  for (const std::shared_ptr<ViewController>& screen : stack_)
    screen->didReceiveMemoryWarning();
}

}  // namespace vesk
