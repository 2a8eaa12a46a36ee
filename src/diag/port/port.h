#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <sys/types.h>

#include "diag/port/command.h"
#include "system/file_descriptor.h"

namespace vesk::diag {

/// An open diagnostic port of a modem, held by this program alone. Nothing but a Command is ever written to it.
class Port {
 public:
  /// Opens the device at `path`: a terminal is set to hand on every byte as it is, another device is taken as it is.
  /// Not open, and failure() tells why, when that is not possible.
  explicit Port(std::string path);

  void close() { descriptor_ = FileDescriptor(); }
  [[nodiscard]] bool isOpen() const { return descriptor_.isOpen(); }
  /// In words for the user, what was wrong and what to do.
  [[nodiscard]] const std::string& failure() const { return failure_; }
  [[nodiscard]] const std::string& path() const { return path_; }
  /// Whether terminal settings could be made.
  [[nodiscard]] bool isTerminal() const { return isTerminal_; }
  /// Readable when read() has something; never blocks.
  [[nodiscard]] int descriptor() const { return descriptor_.get(); }

  /// Throws away what has been waiting to be read.
  void drain();
  /// What has come, at least one byte; none when nothing has. Absent when the port is gone.
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> read(std::span<std::uint8_t> place);
  /// False when the port is gone, or does not take it.
  [[nodiscard]] bool send(const Command& command);

 private:
  [[nodiscard]] bool open();
  [[nodiscard]] bool setUp();
  void fail(int error);

  std::string path_;
  FileDescriptor descriptor_;
  bool isTerminal_ = false;
  std::string failure_;
};

}  // namespace vesk::diag
