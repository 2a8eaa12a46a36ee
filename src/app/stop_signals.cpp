#include "app/stop_signals.h"

#include <csignal>
#include <initializer_list>

#include "platform/run_loop.h"

namespace vesk {

namespace {

/// Looked up beforehand: a handler may not.
RunLoop* mainLoop = nullptr;

}  // namespace

void stopMainLoopOnSignals() {
  mainLoop = &RunLoop::main();
  struct sigaction action {};
  action.sa_handler = [](int /*signal*/) { mainLoop->stop(); };
  action.sa_flags = SA_RESTART;
  for (const int signal : {SIGINT, SIGTERM, SIGHUP})
    sigaction(signal, &action, nullptr);
}

}  // namespace vesk
