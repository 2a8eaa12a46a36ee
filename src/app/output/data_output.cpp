#include "app/output/data_output.h"

#include <string>
#include <unistd.h>

namespace vesk {

DataOutput::DataOutput() : sink_(STDOUT_FILENO, "standard output") {
  sink_.setFailureHandler([](const std::string& reason) { tellUser("vesk: " + reason); });
}

Outcome DataOutput::finish(Outcome outcome) {
  flush();
  return hasFailed() ? Outcome::failed : outcome;
}

}  // namespace vesk
