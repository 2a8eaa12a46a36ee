#pragma once

#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "diag/port/command.h"
#include "system/clock.h"

namespace vesk::diag {

/// The conversation with a modem: asks what it is, asks for the logs that are read here and for no others, watches them
/// come, and ends them. Sends and reads nothing itself: it is told what came and how late it is, and tells what to
/// send.
class Session {
 public:
  using Instant = Clock::Instant;

  enum class Phase {
    starting,
    /// The logs that were asked for come.
    watching,
    /// Waits for the modem to have stopped them.
    ending,
    ended,
    /// See failure().
    failed,
  };

  explicit Session(Instant now);

  [[nodiscard]] Phase phase() const { return phase_; }
  /// In words for the user, what was wrong and what to do.
  [[nodiscard]] const std::string& failure() const { return failure_; }
  /// What the modem calls its firmware; empty while that is not known.
  [[nodiscard]] const std::string& firmware() const { return firmware_; }
  /// Whether no log has come for ten seconds.
  [[nodiscard]] bool isSilent() const { return isSilent_; }

  /// What is to be sent now, if anything.
  [[nodiscard]] std::optional<Command> takeCommand();
  /// What the user should know, one line each, since the last call.
  [[nodiscard]] std::vector<std::string> takeRemarks();

  /// The content of a frame that is no log.
  void takeAnswer(std::span<const std::uint8_t> content, Instant now);
  void noteLog(Instant now);
  /// One that cannot be read.
  void noteEncryptedLog() { hasEncryptedLogs_ = true; }

  /// When advance() has something to do; absent for never.
  [[nodiscard]] std::optional<Instant> deadline() const;
  void advance(Instant now);
  /// Ends the logs, where they may have begun.
  void end(Instant now);

 private:
  void send(Command command, int tries, Instant now);
  void goOn(Instant now);
  void take(const Answer& answer, Instant now);
  void takeUnanswered(Instant now);
  void addMasks(const std::vector<std::uint32_t>& sizes);
  void startWatching(Instant now);
  void refuse(const Answer& answer, Instant now);
  /// Both end the logs, where the modem is one.
  void fail(std::string reason, Instant now);
  void endLogs(Instant now);

  Phase phase_ = Phase::starting;
  std::string failure_;
  std::string firmware_;
  std::vector<std::string> remarks_;

  /// What comes after current_ until the watching begins.
  std::deque<Command> next_;
  std::optional<Command> current_;
  bool isToBeSent_ = false;
  int triesLeft_ = 0;
  /// When current_ is given up or sent again.
  Instant due_;

  /// Whether anything was answered.
  bool isIdentified_ = false;
  bool isLocked_ = false;
  int masksInForce_ = 0;
  Instant silentAt_;
  bool isSilent_ = false;
  bool hasEncryptedLogs_ = false;
};

}  // namespace vesk::diag
