#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

namespace vesk::web {

/// Where a stretch of the drive begins: its charts run over counted time, without the gaps between. Milliseconds.
struct StretchBegin {
  std::int64_t position;
  std::int64_t time;

  /// What makes times of the positions in it.
  [[nodiscard]] std::int64_t shift() const { return time - position; }
};

/// The stretches of a drive, in a bounded number: when there would be too many, those beside each other whose times
/// agree well enough become one. Times still never run backwards where the drive's did not.
class Stretches {
 public:
  /// `most` is at least 1.
  explicit Stretches(std::size_t most) : most_(most) {}

  void add(const StretchBegin& begin) {
    if (!joins(begins_, begin, error_)) begins_.push_back(begin);
    while (begins_.size() > most_)
      widen();
  }
  void clear() {
    begins_.clear();
    error_ = 0;
  }

  [[nodiscard]] const std::vector<StretchBegin>& begins() const { return begins_; }
  /// How far the time of a position may be off: milliseconds.
  [[nodiscard]] std::int64_t error() const { return error_; }

 private:
  /// Whether a stretch is told well enough by the one before.
  static bool joins(const std::vector<StretchBegin>& begins, const StretchBegin& next, std::int64_t tolerance) {
    return !begins.empty() && std::abs(next.shift() - begins.back().shift()) <= tolerance;
  }

  void widen() {
    // No gap is shorter than five seconds.
    constexpr std::int64_t kFirst = 5000;
    // What became one before may be off by the error so far.
    const std::int64_t tolerance = error_ == 0 ? kFirst : error_;
    error_ += tolerance;
    std::vector<StretchBegin> fewer;
    for (const StretchBegin& each : begins_)
      if (!joins(fewer, each, tolerance)) fewer.push_back(each);
    begins_ = std::move(fewer);
  }

  std::size_t most_;
  std::int64_t error_ = 0;
  std::vector<StretchBegin> begins_;
};

}  // namespace vesk::web
