#include "app/output/progress.h"

#include <algorithm>
#include <cstdio>
#include <unistd.h>

namespace vesk {

namespace {

constexpr std::chrono::seconds kPatience{1};
constexpr std::chrono::milliseconds kInterval{200};
constexpr const char* kEraseLine = "\r\x1B[K";

}  // namespace

std::string progressText(std::uint64_t events, std::optional<double> share) {
  std::string text = std::to_string(events);
  for (std::size_t end = text.size(); end > 3; end -= 3)
    text.insert(end - 3, 1, ',');
  text += " events";
  if (share) text += ", " + std::to_string(static_cast<int>(std::clamp(*share, 0.0, 1.0) * 100)) + "%";
  return text;
}

Progress::Progress(Output output)
    : isPossible_(isatty(STDERR_FILENO) != 0 && (output == Output::atTheEnd || isatty(STDOUT_FILENO) == 0)),
      next_(Clock::now() + kPatience) {}

void Progress::show(std::uint64_t events, double position, std::optional<double> duration) {
  if (!isPossible_) return;
  const Clock::time_point now = Clock::now();
  if (now < next_) return;
  next_ = now + kInterval;
  isShown_ = true;
  const bool hasShare = duration && *duration > 0;
  const std::string text = progressText(events, hasShare ? std::optional(position / *duration) : std::nullopt);
  std::fprintf(stderr, "%s%s", kEraseLine, text.c_str());
}

void Progress::hide() {
  if (!isShown_) return;
  isShown_ = false;
  std::fputs(kEraseLine, stderr);
}

}  // namespace vesk
