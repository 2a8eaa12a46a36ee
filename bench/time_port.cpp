// time_port [FRAMES]: how long it takes from a frame that a modem sends, behind a pseudo-terminal, to its value in the
// stores, with the whole program between them, and beside it to a thread that does nothing but read the port. One frame
// at a time, as far apart as a modem's are.

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <poll.h>
#include <semaphore>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "app/program/app_delegate.h"
#include "app/program/vesk_interface.h"
#include "app/source/event_source.h"
#include "bench/stop.h"
#include "diag/framing/frame.h"
#include "diag/framing/frame_reader.h"
#include "diag/framing/packet_reader.h"
#include "diag/modem.h"
#include "diag/port/port.h"
#include "intake/metric_validator.h"
#include "system/output_lines.h"
#include "system/run_loop.h"
#include "toolkit/application.h"

namespace vesk::bench {
namespace {

using namespace std::chrono_literals;
using Instant = std::chrono::steady_clock::time_point;

constexpr std::size_t kUsualFrames = 500;
constexpr auto kBetweenFrames = 20ms;
constexpr auto kPatience = 5s;

/// 2016, in ticks of 1.25 ms since 1980.
constexpr std::uint64_t kFirstTick = 900'000'000'000;
constexpr std::uint64_t kTicksPerSecond = 800;

std::uint64_t modemTimeOf(std::size_t number) {
  return (kFirstTick + kTicksPerSecond * number) << 16;
}

/// An UMTS state, logged a second later than the one before.
Bytes frameOf(std::size_t number) {
  Bytes content = bytesOf("10 00 0D 00 0D 00 25 41");
  for (int shift = 0; shift < 64; shift += 8)
    content.push_back(static_cast<std::uint8_t>(modemTimeOf(number) >> shift));
  content.push_back(static_cast<std::uint8_t>(number % 6));
  Bytes frame;
  diag::appendFrame(frame, content);
  return frame;
}

/// Plays the modem, and times what becomes of its frames.
class TimedModem {
 public:
  [[nodiscard]] std::string path() const { return modem_.path(); }

  void answerUntilItWatches() { modem_.answerUntilItWatches(); }
  /// Sends the frames; the time that each one took.
  std::vector<Instant::duration> send(std::size_t frames) {
    std::vector<Instant::duration> taken;
    for (std::size_t number = 0; number < frames; ++number) {
      std::this_thread::sleep_for(kBetweenFrames);
      const Bytes frame = frameOf(number);
      const auto sent = std::chrono::steady_clock::now();
      modem_.sendBytes(frame);
      if (!hasArrived_.try_acquire_for(kPatience)) stop("a frame has not become a value");
      if (arrived_.milliseconds != diag::millisecondsOf(modemTimeOf(number))) stop("another value came than was sent");
      taken.push_back(arrived_.at - sent);
    }
    return taken;
  }
  void answerTheEnd() {
    const std::string command = modem_.next();
    modem_.send(command + " 00 00 00 00");
  }

  /// The frame that says this time has come to where it was to come.
  void noteArrival(std::uint64_t milliseconds) {
    arrived_ = {std::chrono::steady_clock::now(), milliseconds};
    hasArrived_.release();
  }

 private:
  struct Arrival {
    Instant at;
    std::uint64_t milliseconds = 0;
  };

  diag::Modem modem_;
  Arrival arrived_;
  std::counting_semaphore<> hasArrived_{0};
};

/// To a thread that only reads: what the system itself takes.
std::vector<Instant::duration> timeReader(std::size_t frames) {
  TimedModem modem;
  diag::Port port(modem.path());
  if (!port.isOpen()) stop(port.failure());
  const std::jthread reader([&] {
    Bytes place(4096);
    diag::FrameReader read;
    for (std::size_t count = 0; count < frames;) {
      pollfd waited{port.descriptor(), POLLIN, 0};
      poll(&waited, 1, -1);
      const auto bytes = port.read(place);
      if (!bytes) stop("the port is gone");
      read.take(*bytes);
      for (; const auto frame = read.next(); ++count)
        modem.noteArrival(diag::readPacket(frame->content).log.value().milliseconds);
    }
  });
  return modem.send(frames);
}

/// To the stores.
std::vector<Instant::duration> timeProgram(std::size_t frames) {
  OutputLines::setSink(nullptr);
  const SteadyClock clock;
  RunLoop loop(clock);
  TimedModem modem;
  const auto fail = [](const std::string& reason) { stop(reason); };
  SourceOptions options;
  options.port = modem.path();
  const EventSource source = makeEventSource(
      options, clock,
      {fail, [](const std::string& /*remark*/) {},
       [&](const std::optional<std::string>& failure) { fail(failure.value_or("")); }, nullptr, nullptr},
      nullptr);
  if (source.failure) stop(*source.failure);
  corvik::installService(source.service);

  std::vector<Instant::duration> taken;
  std::jthread sender;
  AppDelegate delegate;
  const int status = Application(veskInterface(), delegate).run([&](NavigationController& /*root*/) {
    MetricValidator::shared()->setEventObserver([&modem](const TakenEvent& event) {
      modem.noteArrival(static_cast<std::uint64_t>(event.timestamp.value_or(0)));
    });
    sender = std::jthread([&] {
      modem.answerUntilItWatches();
      taken = modem.send(frames);
      loop.stop();
      modem.answerTheEnd();
    });
    loop.run();
    MetricValidator::shared()->setEventObserver(nullptr);
  });
  if (status != 0) stop("the program did not start");
  source.service->shutDown();
  return taken;
}

double microseconds(Instant::duration time) {
  return std::chrono::duration<double, std::micro>(time).count();
}

void print(const char* what, std::vector<Instant::duration> taken) {
  std::sort(taken.begin(), taken.end());
  std::printf("%-27s  %zu frames, µs: least %.0f, median %.0f, 99 of 100 below %.0f, most %.0f\n", what, taken.size(),
              microseconds(taken.front()), microseconds(taken[taken.size() / 2]),
              microseconds(taken[taken.size() * 99 / 100]), microseconds(taken.back()));
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  using namespace vesk::bench;
  std::size_t frames = kUsualFrames;
  if (argc > 1) {
    const std::string_view text = argv[1];
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), frames);
    if (error != std::errc() || end != text.data() + text.size() || frames == 0) stop("usage: time_port [FRAMES]");
  }
  print("to a thread that only reads", timeReader(frames));
  print("to the value in the stores", timeProgram(frames));
}
