#include "diag/port/session.h"

#include <algorithm>
#include <chrono>
#include <iterator>
#include <utility>

#include "diag/translation/log_kind.h"

namespace vesk::diag {

namespace {

using namespace std::chrono_literals;

constexpr auto kAnswerTime = 2s;
constexpr auto kSilence = 10s;

constexpr Request kStart[] = {Request::version,          Request::firmware, Request::eventsOff,
                              Request::debugMessagesOff, Request::logsOff,  Request::logSizes};

/// How often a command is sent that is not answered.
int triesOf(Request request) {
  const bool isNeeded = request == Request::version || request == Request::logsOff || request == Request::logSizes;
  return isNeeded ? 2 : 1;
}

/// Whose logs are read, by the upper 4 bits of their codes.
struct Equipment {
  std::uint32_t id;
  const char* name;
};

constexpr Equipment kEquipment[] = {{0x4, "UMTS"}, {0x5, "GSM"}, {0x7, "UMTS and GSM NAS"}, {0xB, "LTE"}};

const char* nameOf(std::uint32_t equipment) {
  const auto* const found = std::find_if(std::begin(kEquipment), std::end(kEquipment),
                                         [equipment](const Equipment& each) { return each.id == equipment; });
  return found == std::end(kEquipment) ? "" : found->name;
}

std::vector<std::uint16_t> wantedCodes() {
  std::vector<std::uint16_t> codes;
  for (const LogKind& kind : logKinds())
    codes.push_back(kind.code);
  return codes;
}

constexpr const char* kNoAnswer =
    "no answer: not a diagnostic port; a modem has several ports, try the others (/dev/ttyUSB0, 1, 2, …)";
constexpr const char* kNoSizes = "the modem answers, but not which logs it has; unplug it and plug it in again";
constexpr const char* kMakerLocked = "the modem's maker has locked its logs; another firmware or modem is needed";
constexpr const char* kNoLogs = "the modem answers, but has none of the logs that are read";
constexpr const char* kSilent =
    "no log for 10 s: is a SIM in, and airplane mode off? Else the logs are encrypted, or go to another program: stop "
    "it";
constexpr const char* kEncrypted = "the modem encrypts its logs, and they cannot be read; another firmware is needed";

std::string inWords(std::uint32_t status) {
  return " (status " + std::to_string(status) + ")";
}

}  // namespace

Session::Session(Instant now) {
  for (const Request request : kStart)
    next_.push_back(Command::make(request));
  goOn(now);
}

std::optional<Command> Session::takeCommand() {
  return std::exchange(isToBeSent_, false) ? current_ : std::nullopt;
}

std::vector<std::string> Session::takeRemarks() {
  return std::exchange(remarks_, {});
}

void Session::takeAnswer(std::span<const std::uint8_t> content, Instant now) {
  if (!current_ || isToBeSent_ || !current_->isAnsweredBy(content)) return;
  isIdentified_ = true;
  take(readAnswer(*current_, content), now);
}

void Session::noteLog(Instant now) {
  silentAt_ = now + kSilence;
  isSilent_ = false;
}

std::optional<Session::Instant> Session::deadline() const {
  if (current_) return due_;
  if (phase_ == Phase::watching && !isSilent_) return silentAt_;
  return std::nullopt;
}

void Session::advance(Instant now) {
  if (const auto due = deadline(); !due || now < *due) return;
  if (!current_) {
    isSilent_ = true;
    remarks_.emplace_back(hasEncryptedLogs_ ? kEncrypted : kSilent);
  } else if (triesLeft_ > 0) {
    send(*current_, triesLeft_, now);
  } else {
    takeUnanswered(now);
  }
}

void Session::end(Instant now) {
  if (phase_ != Phase::starting && phase_ != Phase::watching) return;
  phase_ = Phase::ended;
  current_.reset();
  if (isIdentified_) endLogs(now);
}

void Session::send(Command command, int tries, Instant now) {
  current_ = std::move(command);
  isToBeSent_ = true;
  triesLeft_ = tries - 1;
  due_ = now + kAnswerTime;
}

void Session::goOn(Instant now) {
  current_.reset();
  if (phase_ == Phase::ending) {
    phase_ = failure_.empty() ? Phase::ended : Phase::failed;
  } else if (next_.empty()) {
    startWatching(now);
  } else {
    Command command = std::move(next_.front());
    next_.pop_front();
    const int tries = triesOf(command.request());
    send(std::move(command), tries, now);
  }
}

void Session::take(const Answer& answer, Instant now) {
  if (phase_ == Phase::ending) return goOn(now);
  const Request request = current_->request();
  if (answer.kind != Answer::Kind::done) refuse(answer, now);
  if (phase_ == Phase::ending) return;
  if (request == Request::firmware) firmware_ = answer.text;
  if (request == Request::logSizes) addMasks(answer.sizes);
  if (request == Request::logMask && answer.kind == Answer::Kind::done) ++masksInForce_;
  goOn(now);
}

void Session::refuse(const Answer& answer, Instant now) {
  const Request request = current_->request();
  if (answer.kind == Answer::Kind::locked && request != Request::firmware) isLocked_ = true;
  if (request == Request::logSizes) {
    fail(isLocked_ ? kMakerLocked : "the modem does not tell which logs it has" + inWords(answer.status), now);
  } else if (request == Request::logMask) {
    remarks_.push_back("the modem refuses its logs of " + std::string(nameOf(current_->equipment())) +
                       inWords(answer.status) + ": none will come; another firmware may give them");
  }
}

void Session::takeUnanswered(Instant now) {
  const Request request = current_->request();
  if (phase_ == Phase::starting && request == Request::version) return fail(kNoAnswer, now);
  if (phase_ == Phase::starting && request == Request::logSizes) return fail(kNoSizes, now);
  if (request == Request::logMask)
    remarks_.push_back("no answer when asked for logs of " + std::string(nameOf(current_->equipment())) +
                       ": if none come, unplug the modem and plug it in again");
  goOn(now);
}

void Session::addMasks(const std::vector<std::uint32_t>& sizes) {
  const std::vector<std::uint16_t> codes = wantedCodes();
  for (const Equipment& equipment : kEquipment) {
    const std::uint32_t size = equipment.id < sizes.size() ? sizes[equipment.id] : 0;
    if (size > 0) {
      next_.push_back(Command::makeLogMask(equipment.id, size, codes));
    } else {
      remarks_.push_back("the modem has no logs of " + std::string(equipment.name));
    }
  }
}

void Session::startWatching(Instant now) {
  if (masksInForce_ == 0) return fail(isLocked_ ? kMakerLocked : kNoLogs, now);
  phase_ = Phase::watching;
  noteLog(now);
}

void Session::fail(std::string reason, Instant now) {
  failure_ = std::move(reason);
  phase_ = Phase::failed;
  current_.reset();
  if (isIdentified_) endLogs(now);
}

void Session::endLogs(Instant now) {
  phase_ = Phase::ending;
  next_.clear();
  send(Command::make(Request::logsOff), 1, now);
}

}  // namespace vesk::diag
