#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "recording/timed_events.h"
#include "system/file_descriptor.h"

namespace vesk {

/// The bytes of a file or pipe, as they come; unpacked where they are compressed with gzip, in one member or several.
class ByteInput {
 public:
  /// Over the file at `path`; "-" is standard input. One that cannot be opened shows in failure().
  explicit ByteInput(const std::string& path);
  /// Over an open descriptor, called `name` in messages.
  ByteInput(FileDescriptor descriptor, std::string name);
  ByteInput(ByteInput&& other) noexcept;
  ByteInput& operator=(ByteInput&& other) noexcept;
  ~ByteInput();

  void setBeforeRead(TimedEvents::BeforeRead beforeRead) { beforeRead_ = std::move(beforeRead); }

  /// Puts at least one byte into `place` and returns how many; 0 at the end, behind which what was appended to a file
  /// since follows, and after a failure.
  [[nodiscard]] std::size_t read(std::span<std::uint8_t> place);
  /// Before anything was taken: reads on, and shows all that lies ahead now, valid until the next call. No longer than
  /// the last time at the end, and after a failure.
  [[nodiscard]] std::span<const std::uint8_t> lookFurther();

  /// Why it cannot be read (any more), as NAME: reason.
  [[nodiscard]] const std::optional<std::string>& failure() const { return failure_; }
  /// As shown to people: the path, or "standard input".
  [[nodiscard]] const std::string& name() const { return name_; }
  [[nodiscard]] int descriptor() const { return descriptor_.get(); }
  /// Back to the first byte; false when the input has no way back.
  [[nodiscard]] bool rewind();

 private:
  class Unpacking;

  /// Finds out what the input begins with, where it has begun.
  void begin();
  [[nodiscard]] std::size_t readOn(std::span<std::uint8_t> place);
  [[nodiscard]] std::size_t readUnpacked(std::span<std::uint8_t> place);
  /// As they are in the file; absent when it may not be read.
  [[nodiscard]] std::optional<std::size_t> readRaw(std::span<std::uint8_t> place);
  void fail(const std::string& reason);

  FileDescriptor descriptor_;
  std::string name_;
  std::optional<std::string> failure_;
  TimedEvents::BeforeRead beforeRead_;
  /// What was looked at and not taken yet.
  std::vector<std::uint8_t> ahead_;
  std::size_t taken_ = 0;
  bool hasBegun_ = false;
  /// There for an input that is compressed.
  std::unique_ptr<Unpacking> unpacking_;
};

}  // namespace vesk
