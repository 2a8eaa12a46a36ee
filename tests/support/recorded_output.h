#pragma once

#include <memory>
#include <string>
#include <vector>

#include "system/output_lines.h"

namespace vesk {

/// While it lives, the program's output lines are kept here instead of being printed.
class RecordedOutput {
 public:
  RecordedOutput() : previous_(OutputLines::setSink(std::make_unique<Sink>(lines_))) {}
  ~RecordedOutput() { OutputLines::setSink(std::move(previous_)); }
  RecordedOutput(const RecordedOutput&) = delete;
  RecordedOutput& operator=(const RecordedOutput&) = delete;

  [[nodiscard]] const std::vector<std::string>& lines() const { return lines_; }
  void clear() { lines_.clear(); }

 private:
  class Sink : public OutputSink {
   public:
    explicit Sink(std::vector<std::string>& lines) : lines_(lines) {}
    void write(std::string_view line) override { lines_.emplace_back(line); }
    void flush() override {}

   private:
    std::vector<std::string>& lines_;
  };

  std::vector<std::string> lines_;
  std::unique_ptr<OutputSink> previous_;
};

}  // namespace vesk
