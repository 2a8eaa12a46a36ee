// Sets everything on the program with its screens at once: keys, mouse reports and rubbish at random, another size
// every few keys, hostile events at full speed, and a terminal that is not read for a while. It must take all of it,
// send the terminal nothing but what it may, end when it is told to, and leave the terminal as it was.
//
//     screens_under_fire SECONDS [SEED]

#include <array>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <optional>
#include <random>
#include <string>
#include <string_view>
#include <thread>

#include "app/vesk_program.h"
#include "handset/handset.h"
#include "handset/recording.h"
#include "hostile_recording.h"
#include "support/pseudo_terminal.h"
#include "terminal_language.h"

namespace vesk {
namespace {

using Clock = std::chrono::steady_clock;
using namespace std::chrono_literals;

constexpr std::array<std::string_view, 44> kKeys{
    "k", "j", "l", "h", "/", "f", "d", "[", "]", "?", " ", "\r", "\r", "\r", "\r", "\x1B[A", "\x1B[B", "\x1B[B",
    "\x1B[B", "\x1B[C", "\x1B[C", "\x1B[D", "\x1B[5~", "\x1B[6~", "\x1B[H", "\x1B[F", "\x1BOA", "\x1BOB", "\x1BOM",
    "\x1B[1;5B", "\x1B", "\x7F", "\b", "\t", "\x1B[Z", "\x1B[3~", "\x1Bj",
    // Begun and never ended, too long, or unknown.
    "\x1B[", "\x1BO", "\x1B]0;", "\x1BP1$r", "\x1B[[",
    "\x1B[1;2;3;4;5;6;7;8;9;10;11;12;13;14;15;16;17;18;19;20;21;22;23~", "\x1B[99999999999999999999999B"};
constexpr std::array<std::string_view, 8> kTexts{"rsrp",         "-9",   "\xC3\xA9", "\xF0\x9F\x93\xB6",
                                                 "\xE2\x80\xAE", "\xC3", "\xFF\xFE", "e\xCC\x81"};

class Fire {
 public:
  Fire(std::uint64_t seed, const std::string& recording)
      : random_(seed), terminal_({80, 24}), before_(terminal_.modes()) {
    process_.emplace(VESK_PROGRAM,
                     std::vector<std::string>{"--log", "none", "--speed", "max", "--loop", "--replay", recording},
                     terminal_.openForProgram());
    // Until then the terminal itself echoes what is typed.
    const Clock::time_point deadline = Clock::now() + 30s;
    while (!hasBegun_ && isFaultless() && Clock::now() < deadline)
      read(100);
  }

  Fire(const Fire&) = delete;
  Fire& operator=(const Fire&) = delete;
  ~Fire() { killProgram(); }

  /// One volley. False, and it is told why, when the program sent what it may not.
  bool shoot() {
    if (!hasBegun_) return fail("it does not begin");
    for (int count = pick(4); count >= 0; --count)
      terminal_.type(input());
    if (pick(3) == 0) resize();
    if (unread_ > 0) {
      --unread_;
      std::this_thread::sleep_for(1ms);
    } else if (pick(200) == 0) {
      unread_ = 100;
    } else {
      read(pick(3));
    }
    return isFaultless();
  }

  /// Ends the program by a key, by the key for interrupting, or by a signal.
  bool end(int how) {
    const Clock::time_point deadline = Clock::now() + 20s;
    read(0);
    if (isOver()) return fail("it ended by itself");
    // The first bytes end whatever sequence was begun, the next one the typing of a filter.
    constexpr std::string_view kLead = "\x18\x18\x18\x18\r";
    if (how == 2) kill(process_->id(), SIGTERM);
    while (!isOver()) {
      if (how < 2) terminal_.type(std::string(kLead) + (how == 0 ? "q" : "\x03"));
      read(50);
      if (!isFaultless()) return false;
      if (Clock::now() > deadline) {
        return fail("it does not end");
      }
    }
    const int status = process_->waitForExit();
    read(0);
    if (status != 0) return fail("it ended with status " + std::to_string(status));
    const termios after = terminal_.modes();
    if (after.c_lflag != before_.c_lflag || after.c_iflag != before_.c_iflag || after.c_oflag != before_.c_oflag) {
      return fail("the terminal's modes are not as they were");
    }
    return true;
  }

  [[nodiscard]] int resizes() const { return resizes_; }
  [[nodiscard]] std::size_t bytesRead() const { return bytesRead_; }
  /// The most memory that it has taken so far, in KiB.
  [[nodiscard]] long memory() const {
    std::ifstream status("/proc/" + std::to_string(process_->id()) + "/status");
    for (std::string line; std::getline(status, line);) {
      if (line.starts_with("VmHWM:")) return std::atol(line.c_str() + 6);
    }
    return 0;
  }

 private:
  int pick(int count) { return std::uniform_int_distribution(0, count - 1)(random_); }
  template <std::size_t Count>
  std::string_view oneOf(const std::array<std::string_view, Count>& choices) {
    return choices[static_cast<std::size_t>(pick(Count))];
  }
  int coordinate() { return pick(10) == 0 ? pick(1 << 30) : pick(120); }

  std::string input() {
    switch (pick(10)) {
      case 0: {
        constexpr std::array kButtons{0, 0, 32, 32, 64, 65, 2, 128, 255};
        const int button = kButtons[static_cast<std::size_t>(pick(kButtons.size()))];
        return "\x1B[<" + std::to_string(button) + ';' + std::to_string(coordinate()) + ';' +
               std::to_string(coordinate()) + (pick(2) == 0 ? 'M' : 'm');
      }
      case 1:
        return "\x1B[M" + harmlessBytes(3);
      case 2:
        return "\x1B[200~" + std::string(oneOf(kTexts)) + "\x1B[201~";
      case 3:
        return std::string(oneOf(kTexts));
      case 4:
        return harmlessBytes(1 + pick(8));
      default:
        return std::string(oneOf(kKeys));
    }
  }

  /// Any but those by which the terminal would end or stop the program, and the letter that quits.
  std::string harmlessBytes(int count) {
    std::string bytes;
    while (static_cast<int>(bytes.size()) < count) {
      const char byte = static_cast<char>(pick(256));
      if (std::string_view("\x03\x1A\x1Cq").find(byte) == std::string_view::npos) bytes += byte;
    }
    return bytes;
  }

  void resize() {
    constexpr std::array kSizes{Size{1, 1}, Size{500, 200}, Size{0, 0}, Size{500, 1}, Size{1, 200}, Size{80, 24}};
    const auto choice = static_cast<std::size_t>(pick(2 * kSizes.size()));
    terminal_.resize(choice < kSizes.size() ? kSizes[choice] : Size{1 + pick(200), 1 + pick(60)});
    ++resizes_;
  }

  /// All there is, if anything comes within that time. What was typed and not taken comes back as an echo when the
  /// terminal is as it was, and is none of the program's.
  void read(int milliseconds) {
    for (std::string some = terminal_.readWithin(milliseconds); !some.empty(); some = terminal_.readWithin(0)) {
      for (const char& byte : some) {
        if (!isOver()) language_.take({&byte, 1});
        hasBegun_ = hasBegun_ || language_.isTakenOver();
      }
      bytesRead_ += some.size();
    }
  }
  [[nodiscard]] bool isOver() const { return hasBegun_ && language_.isGivenBack(); }

  void killProgram() {
    if (process_->id() > 0) kill(process_->id(), SIGKILL);
  }

  bool isFaultless() { return !language_.fault() || fail("it sent what it may not: " + *language_.fault()); }

  static bool fail(const std::string& reason) {
    std::cerr << reason << '\n';
    return false;
  }

  std::mt19937_64 random_;
  PseudoTerminal terminal_;
  termios before_;
  std::optional<ChildProcess> process_;
  TerminalLanguage language_;
  bool hasBegun_ = false;
  int unread_ = 0;
  int resizes_ = 0;
  std::size_t bytesRead_ = 0;
};

std::string recordingOfADriveAmongHostileEvents() {
  std::string lines = hostileRecording();
  handset::Handset handset(4, 0);
  handset::recordDrive(handset, 120, [&lines](std::string_view line) {
    lines += line;
    return true;
  });
  return lines + hostileRecording();
}

int burn(double seconds, std::uint64_t seed) {
  constexpr int kRounds = 3;
  constexpr int kFewestResizes = 1000;
  setenv("TERM", "xterm-256color", 1);
  std::cout << "seed " << seed << std::endl;
  const TemporaryFile recording(recordingOfADriveAmongHostileEvents());
  int resizes = 0;
  for (int round = 0; round < kRounds; ++round) {
    const Clock::time_point over =
        Clock::now() + std::chrono::duration_cast<Clock::duration>(std::chrono::duration<double>(seconds / kRounds));
    Fire fire(seed + static_cast<std::uint64_t>(round), recording.path());
    int volleys = 0;
    while (Clock::now() < over || fire.resizes() * kRounds < kFewestResizes) {
      if (!fire.shoot()) return 1;
      ++volleys;
    }
    const long memory = fire.memory();
    if (!fire.end(round)) return 1;
    resizes += fire.resizes();
    std::cout << volleys << " volleys, " << fire.resizes() << " sizes, " << fire.bytesRead() << " bytes drawn, "
              << memory << " KiB at most" << std::endl;
  }
  return resizes >= kFewestResizes ? 0 : 1;
}

}  // namespace
}  // namespace vesk

int main(int argc, char** argv) {
  if (argc < 2) {
    std::cerr << "usage: screens_under_fire SECONDS [SEED]\n";
    return 2;
  }
  return vesk::burn(std::atof(argv[1]), argc > 2 ? std::strtoull(argv[2], nullptr, 10) : std::random_device()());
}
