#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace vesk {

/// "1,200,000 events, 43%"; without the share where it is unknown.
[[nodiscard]] std::string progressText(std::uint64_t events, std::optional<double> share);

/// A line on standard error that tells how far the work is, rewritten in place: from the second second on, and only
/// where a terminal shows it and nothing else is written there.
class Progress {
 public:
  enum class Output {
    /// Written while the work goes on.
    meanwhile,
    /// Written when the work is done.
    atTheEnd,
  };

  explicit Progress(Output output);
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;
  ~Progress() { hide(); }

  /// Whether the line could ever be seen.
  [[nodiscard]] bool isPossible() const { return isPossible_; }
  /// `position` and `duration` are seconds of the recording; `duration` is absent where it is unknown.
  void show(std::uint64_t events, double position, std::optional<double> duration);
  /// Takes the line away, until it is shown again: before anything else is written to the terminal.
  void hide();

 private:
  using Clock = std::chrono::steady_clock;

  bool isPossible_;
  bool isShown_ = false;
  Clock::time_point next_;
};

}  // namespace vesk
