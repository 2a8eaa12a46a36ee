#include "terminal/input/input_machine.h"

#include <utility>

#include "terminal/input/input_sequence.h"
#include "values/utf8.h"

namespace vesk {

namespace {

constexpr unsigned char kEscape = 0x1B;
constexpr unsigned char kBell = 0x07;
constexpr unsigned char kCancel = 0x18;
constexpr unsigned char kSubstitute = 0x1A;
constexpr unsigned char kDelete = 0x7F;

/// Far longer than any sequence with a meaning here.
constexpr std::size_t kLongestSequence = 64;
constexpr std::size_t kOldMouseBytes = 3;
constexpr std::string_view kPasteStart = "200~";
constexpr std::string_view kPasteEnd = "\x1b[201~";
/// What comes behind is passed over.
constexpr std::size_t kLongestPaste = 1024;

KeyEvent keyOfControl(unsigned char byte) {
  switch (byte) {
    case '\r':
    case '\n':
      return {.key = Key::Enter};
    case '\t':
      return {.key = Key::Tab};
    case '\b':
    case kDelete:
      return {.key = Key::Backspace};
    default:
      return {.character = byte == 0 ? U' ' : char32_t{byte} + (byte <= 26 ? U'a' - 1 : U'@'),
              .modifiers = {.control = true}};
  }
}

bool isControl(unsigned char byte) {
  return byte < 0x20 || byte == kDelete;
}

bool opensString(unsigned char byte) {
  return byte == ']' || byte == 'P' || byte == 'X' || byte == '^' || byte == '_';
}

}  // namespace

void InputMachine::feed(std::string_view bytes, Clock::Instant now, std::vector<InputEvent>& events) {
  advance(now, events);
  for (const char byte : bytes)
    take(byte, events);
  if (bytes.empty()) return;
  deadline_.reset();
  if (state_ == State::Escape) {
    deadline_ = now + kLoneEscape;
  } else if (state_ != State::Ground) {
    deadline_ = now + kUnfinishedSequence;
  }
}

void InputMachine::advance(Clock::Instant now, std::vector<InputEvent>& events) {
  if (!deadline_ || now < *deadline_) return;
  deadline_.reset();
  if (state_ == State::Escape) events.emplace_back(KeyEvent{.key = Key::Escape});
  isAltHeld_ = false;
  enter(State::Ground);
}

void InputMachine::enter(State state) {
  state_ = state;
  collected_.clear();
}

void InputMachine::take(char byte, std::vector<InputEvent>& events) {
  const auto code = static_cast<unsigned char>(byte);
  switch (state_) {
    case State::Ground:
      return takeInGround(code, events);
    case State::Character:
      return takeInCharacter(code, events);
    case State::Escape:
      return takeAfterEscape(code, events);
    case State::Csi:
      return takeInCsi(code, events);
    case State::Ss3:
      return takeInSs3(code, events);
    case State::LinuxConsole:
      return enter(State::Ground);
    case State::OldMouse:
      collected_ += byte;
      if (collected_.size() == kOldMouseBytes) enter(State::Ground);
      return;
    case State::String:
      if (code == kEscape) return enter(State::StringEscape);
      if (code == kBell || code == kCancel || code == kSubstitute) enter(State::Ground);
      return;
    case State::Paste:
      return takeInPaste(byte, events);
    case State::StringEscape:
      if (code == '\\') return enter(State::Ground);
      enter(State::Escape);
      return takeAfterEscape(code, events);
  }
}

void InputMachine::takeInGround(unsigned char byte, std::vector<InputEvent>& events) {
  const bool isAltHeld = std::exchange(isAltHeld_, false);
  if (byte == kEscape) return enter(State::Escape);
  if (byte >= 0x80) {
    isAltHeld_ = isAltHeld;
    enter(State::Character);
    collected_ = static_cast<char>(byte);
    return;
  }
  KeyEvent event = isControl(byte) ? keyOfControl(byte) : KeyEvent{.character = byte};
  event.modifiers.alt = isAltHeld;
  events.emplace_back(event);
}

void InputMachine::takeInCharacter(unsigned char byte, std::vector<InputEvent>& events) {
  constexpr std::size_t kLongestCharacter = 4;
  if ((byte & 0xC0) != 0x80) {
    enter(State::Ground);
    isAltHeld_ = false;
    return takeInGround(byte, events);
  }
  collected_ += static_cast<char>(byte);
  if (const std::size_t size = utf8CharacterSize(collected_); size == collected_.size()) {
    events.emplace_back(KeyEvent{.character = codePointOf(collected_), .modifiers = {.alt = isAltHeld_}});
  } else if (collected_.size() < kLongestCharacter) {
    return;
  }
  isAltHeld_ = false;
  enter(State::Ground);
}

void InputMachine::takeAfterEscape(unsigned char byte, std::vector<InputEvent>& events) {
  if (byte == kEscape) {
    events.emplace_back(KeyEvent{.key = Key::Escape});
  } else if (byte == '[') {
    enter(State::Csi);
  } else if (byte == 'O') {
    enter(State::Ss3);
  } else if (opensString(byte)) {
    enter(State::String);
  } else {
    enter(State::Ground);
    isAltHeld_ = true;
    takeInGround(byte, events);
  }
}

void InputMachine::takeInCsi(unsigned char byte, std::vector<InputEvent>& events) {
  if (byte == kEscape) return enter(State::Escape);
  if (byte == kCancel || byte == kSubstitute) return enter(State::Ground);
  if (byte >= 0x80) {
    enter(State::Ground);
    return takeInGround(byte, events);
  }
  if (isControl(byte)) return;
  if (collected_.empty() && byte == 'M') return enter(State::OldMouse);
  if (collected_.empty() && byte == '[') return enter(State::LinuxConsole);
  if (collected_.size() < kLongestSequence) collected_ += static_cast<char>(byte);
  if (byte < 0x40) return;
  if (collected_ == kPasteStart) return enter(State::Paste);
  if (collected_.size() < kLongestSequence) {
    if (const std::optional<InputEvent> event = eventOfCsi(collected_)) events.push_back(*event);
  }
  enter(State::Ground);
}

void InputMachine::takeInPaste(char byte, std::vector<InputEvent>& events) {
  // Room for the end is kept by shifting the last bytes.
  if (collected_.size() == kLongestPaste + kPasteEnd.size()) collected_.erase(kLongestPaste, 1);
  collected_ += byte;
  if (!collected_.ends_with(kPasteEnd)) return;
  collected_.resize(collected_.size() - kPasteEnd.size());
  events.emplace_back(PasteEvent{collected_});
  enter(State::Ground);
}

void InputMachine::takeInSs3(unsigned char byte, std::vector<InputEvent>& events) {
  if (byte == kEscape) return enter(State::Escape);
  const bool isParameter = ('0' <= byte && byte <= '9') || byte == ';';
  if (collected_.size() < kLongestSequence) collected_ += static_cast<char>(byte);
  if (isParameter) return;
  if (const std::optional<InputEvent> event = eventOfSs3(collected_)) events.push_back(*event);
  enter(State::Ground);
}

}  // namespace vesk
