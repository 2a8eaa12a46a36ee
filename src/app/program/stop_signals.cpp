#include "app/program/stop_signals.h"

#include <csignal>
#include <initializer_list>

#include "system/run_loop.h"

namespace vesk {

namespace {

/// Looked up beforehand: a handler may not.
const WakeUp* stopRequest = nullptr;

}  // namespace

const WakeUp& stopMainLoopOnSignals() {
  static const WakeUp theRequest;
  stopRequest = &theRequest;
  RunLoop& loop = RunLoop::main();
  // Not by the handler itself: on another thread it could still be at it when the loop has ended.
  loop.addInput(theRequest.descriptor(), [&loop] { loop.stop(); });
  struct sigaction action {};
  action.sa_handler = [](int /*signal*/) { stopRequest->signal(); };
  action.sa_flags = SA_RESTART;
  for (const int signal : {SIGINT, SIGTERM, SIGHUP})
    sigaction(signal, &action, nullptr);
  return theRequest;
}

}  // namespace vesk
