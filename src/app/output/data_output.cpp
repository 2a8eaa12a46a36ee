#include "app/output/data_output.h"

#include <string>
#include <unistd.h>

namespace vesk {

DataOutput::DataOutput() : sink_(STDOUT_FILENO, "standard output") {
  sink_.setFailureHandler([this](const std::string& reason) {
    if (!sink_.hasReaderLeft()) tellUser("vesk: " + reason);
  });
}

Outcome DataOutput::finish(Outcome outcome) {
  flush();
  return hasFailed() && !sink_.hasReaderLeft() ? Outcome::failed : outcome;
}

}  // namespace vesk
