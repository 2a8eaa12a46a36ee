#pragma once

#include <cstdlib>
#include <string>

#include "recording/recorded_event.h"
#include "support/child_process.h"
#include "support/metric_events.h"

namespace vesk {

/// Its signs are those of a UTF-8 locale in every test.
inline const bool kRunsInUtf8 = setenv("LC_ALL", "C.UTF-8", 1) == 0;

/// Runs the program itself, as its user does.
inline Finished vesk(std::vector<std::string> arguments, std::string_view input = "") {
  return run(VESK_PROGRAM, std::move(arguments), input);
}

/// A file with that content, for as long as it lives.
class TemporaryFile {
 public:
  explicit TemporaryFile(std::string_view content) : path_(testing::TempDir() + "vesk-XXXXXX") {
    writeAll(FileDescriptor(mkstemp(path_.data())), content);
  }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;
  ~TemporaryFile() { unlink(path_.c_str()); }

  [[nodiscard]] const std::string& path() const { return path_; }

 private:
  std::string path_;
};

/// The line of a recording.
inline std::string recorded(double at, std::int64_t metricId, const ProtoCodable& message) {
  const Data payload = encoded(message);
  std::string line;
  appendRecordedEvent(line, {at, metricId, payload.bytes()});
  return line;
}

}  // namespace vesk
