#pragma once

#include <memory>
#include <string>
#include <vector>

#include "system/system_log.h"

namespace vesk {

/// While it lives, the system log's lines are kept here instead of going to the sink in force before.
class RecordedLog {
 public:
  RecordedLog() : previous_(SystemLog::setSink(std::make_unique<Sink>(lines_))) {}
  ~RecordedLog() { SystemLog::setSink(std::move(previous_)); }
  RecordedLog(const RecordedLog&) = delete;
  RecordedLog& operator=(const RecordedLog&) = delete;

  [[nodiscard]] const std::vector<std::string>& lines() const { return lines_; }

 private:
  class Sink : public LogSink {
   public:
    explicit Sink(std::vector<std::string>& lines) : lines_(lines) {}
    void write(std::string_view line) override { lines_.emplace_back(line); }

   private:
    std::vector<std::string>& lines_;
  };

  std::vector<std::string> lines_;
  std::unique_ptr<LogSink> previous_;
};

}  // namespace vesk
