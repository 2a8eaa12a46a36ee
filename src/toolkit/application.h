#pragma once

#include <functional>
#include <memory>

#include "toolkit/interface_layout.h"
#include "toolkit/navigation_controller.h"
#include "toolkit/responder.h"

namespace vesk {

/// What an application's screens live in.
class Window {
 public:
  explicit Window(std::shared_ptr<NavigationController> root) : root_(std::move(root)) {}

  [[nodiscard]] NavigationController& rootNavigationController() const { return *root_; }

 private:
  std::shared_ptr<NavigationController> root_;
};

/// Is told of the stations of an application's life. The base does nothing at any of them.
class ApplicationDelegate : public Responder {
 public:
  /// Whether the launch succeeded; false ends the application.
  virtual bool didFinishLaunching() { return true; }
  virtual void willResignActive() {}
  virtual void didEnterBackground() {}
  virtual void willEnterForeground() {}
  virtual void didBecomeActive() {}
  virtual void willTerminate() {}

  /// The main window; null until it was made.
  [[nodiscard]] const std::shared_ptr<Window>& window() const { return window_; }
  void setWindow(std::shared_ptr<Window> window) { window_ = std::move(window); }

 private:
  std::shared_ptr<Window> window_;
};

/// Takes an interface from its launch to its end.
class Application {
 public:
  /// Both must outlive the application.
  Application(const InterfaceLayout& layout, ApplicationDelegate& delegate) : layout_(layout), delegate_(delegate) {}

  /// Launches, then runs `mainLoop`, which is handed the root stack and returns when the program shall end.
  /// The exit status: 0, or 1 when the delegate refused the launch.
  [[nodiscard]] int run(const std::function<void(NavigationController&)>& mainLoop);

  /// Between these two the interface does not show, as when the program is suspended.
  void enterBackground();
  void enterForeground();

 private:
  const InterfaceLayout& layout_;
  ApplicationDelegate& delegate_;
};

}  // namespace vesk
