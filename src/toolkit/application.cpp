#include "toolkit/application.h"

namespace vesk {

int Application::run(const std::function<void(NavigationController&)>& mainLoop) {
  if (!delegate_.didFinishLaunching()) return 1;
  const auto window = std::make_shared<Window>(layout_.makeRootStack());
  delegate_.setWindow(window);
  window->rootNavigationController().loadViewIfNeeded();
  delegate_.didBecomeActive();
  mainLoop(window->rootNavigationController());
  delegate_.willResignActive();
  delegate_.willTerminate();
  return 0;
}

void Application::enterBackground() {
  delegate_.willResignActive();
  delegate_.didEnterBackground();
}

void Application::enterForeground() {
  delegate_.willEnterForeground();
  delegate_.didBecomeActive();
}

}  // namespace vesk
