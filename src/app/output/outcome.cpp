#include "app/output/outcome.h"

#include <string>
#include <unistd.h>

#include "system/output_lines.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

DescriptorSink& standardError() {
  static DescriptorSink theSink(STDERR_FILENO, "standard error");
  return theSink;
}

}  // namespace

void tellUser(std::string_view line) {
  std::string shown;
  appendVisible(shown, line);
  standardError().write(shown);
  standardError().flush();
}

void boundTelling(const WakeUp& interrupt, std::optional<std::chrono::steady_clock::time_point> deadline) {
  standardError().setInterrupt(&interrupt);
  standardError().setDeadline(deadline);
}

}  // namespace vesk
