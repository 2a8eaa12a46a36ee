#pragma once

#include <string_view>

#include "app/output/outcome.h"
#include "system/output_lines.h"

namespace vesk {

/// Standard output for a command that prints data: lines are written as they are. The user is told when it fails.
class DataOutput {
 public:
  DataOutput();

  void writeLine(std::string_view line) { sink_.write(line); }
  void flush() { sink_.flush(); }
  [[nodiscard]] bool hasFailed() const { return sink_.hasFailed(); }

  /// Writes what is left. `outcome`, unless something could not be written.
  [[nodiscard]] Outcome finish(Outcome outcome);

 private:
  DescriptorSink sink_;
};

}  // namespace vesk
