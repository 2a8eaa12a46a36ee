#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "system/file_descriptor.h"

namespace vesk {

/// Where a command writes one whole: a file or standard output. A regular file is replaced once the whole is there, and
/// stays as it was until then; one behind symbolic links is replaced where it lies. All else is written directly. The
/// user is told, once, when it fails.
class WholeFile {
 public:
  /// Absent for standard output.
  explicit WholeFile(const std::optional<std::string>& path);
  WholeFile(const WholeFile&) = delete;
  WholeFile& operator=(const WholeFile&) = delete;
  /// What was not committed is removed.
  ~WholeFile();

  /// Whether it is the regular file that is read at `input`, where "-" is standard input.
  [[nodiscard]] bool isInput(const std::string& input) const;
  /// Begins writing. What is written belongs to the user alone.
  void begin();
  void write(std::string_view piece);
  /// Puts what was written in its place.
  void commit();
  [[nodiscard]] bool hasFailed() const { return hasFailed_; }

 private:
  void findPlace(const std::string& path);
  void fail();

  std::string name_;
  /// Of the file that is replaced; empty when it is written directly.
  std::string target_;
  /// Of what is written, until it is committed.
  std::string temporary_;
  FileDescriptor file_;
  bool hasFailed_ = false;
};

}  // namespace vesk
