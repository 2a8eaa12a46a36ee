#include "app/program/stop_signals.h"

#include <csignal>
#include <initializer_list>

#include "system/run_loop.h"

namespace vesk {

namespace {

/// Looked up beforehand: a handler may not.
RunLoop* mainLoop = nullptr;
const WakeUp* stopRequest = nullptr;

}  // namespace

const WakeUp& stopMainLoopOnSignals() {
  static const WakeUp theRequest;
  stopRequest = &theRequest;
  mainLoop = &RunLoop::main();
  struct sigaction action {};
  action.sa_handler = [](int /*signal*/) {
    stopRequest->signal();
    mainLoop->stop();
  };
  action.sa_flags = SA_RESTART;
  for (const int signal : {SIGINT, SIGTERM, SIGHUP})
    sigaction(signal, &action, nullptr);
  return theRequest;
}

}  // namespace vesk
