#pragma once

#include <algorithm>
#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace vesk {

/// Reads all that the program sends to a terminal of the xterm family, and knows no more than what it may send: text
/// that can be seen, the cursor's moves, looks, and what takes the terminal over and gives it back. The first byte that
/// is none of this is a fault, kept with what came before it.
class TerminalLanguage {
 public:
  void take(std::string_view bytes) {
    for (const char byte : bytes) {
      if (fault_) return;
      recent_ += byte;
      if (recent_.size() > kKept * 2) recent_.erase(0, kKept);
      if (!takes(static_cast<std::uint8_t>(byte))) fault_ = "…" + visible(recent_);
    }
  }

  [[nodiscard]] const std::optional<std::string>& fault() const { return fault_; }
  /// Whether it shows its own screen with its cursor, wraps lines and reports no mouse, as before.
  [[nodiscard]] bool isGivenBack() const {
    return state_ == State::ground && std::none_of(kModes.begin(), kModes.end(), [this](const Mode& mode) {
             return isSet_[indexOf(mode)] != mode.isUsual;
           });
  }
  [[nodiscard]] bool isTakenOver() const { return isSet_[0]; }

 private:
  enum class State { ground, character, escape, designation, sequence };

  struct Mode {
    std::string_view number;
    bool isUsual;
  };
  static constexpr std::array kModes{Mode{"?1049", false}, Mode{"?25", true},    Mode{"?7", true},
                                     Mode{"?1002", false}, Mode{"?1006", false}, Mode{"?2004", false},
                                     Mode{"?12", false}};
  static constexpr std::size_t kKept = 200;

  static std::size_t indexOf(const Mode& mode) { return static_cast<std::size_t>(&mode - kModes.data()); }

  bool takes(std::uint8_t byte) {
    switch (state_) {
      case State::ground:
        if (byte == 0x1B) return enter(State::escape);
        if (byte < 0x80) return 0x20 <= byte && byte != 0x7F;
        left_ = byte >= 0xF0 ? 3 : byte >= 0xE0 ? 2 : 1;
        codePoint_ = byte & (0x3FU >> left_);
        return 0xC2 <= byte && byte <= 0xF4 && enter(State::character);
      case State::character:
        if ((byte & 0xC0) != 0x80) return false;
        codePoint_ = codePoint_ << 6 | (byte & 0x3FU);
        if (--left_ > 0) return true;
        return enter(State::ground) && canBeSeen(codePoint_);
      case State::escape:
        if (byte == '[') return enter(State::sequence);
        return byte == '(' && enter(State::designation);
      case State::designation:
        return byte == 'B' && enter(State::ground);
      case State::sequence:
        if (byte < 0x20 || byte > 0x7E || collected_.size() > 20) return false;
        if (byte < 0x40) {
          collected_ += static_cast<char>(byte);
          return true;
        }
        return performs(static_cast<char>(byte)) && enter(State::ground);
    }
    return false;
  }

  bool enter(State state) {
    state_ = state;
    collected_.clear();
    return true;
  }

  bool performs(char last) {
    switch (last) {
      case 'H':
        return collected_.empty() || isPlace();
      case 'J':
        return collected_ == "2" || collected_ == "3";
      case 'm':
        return collected_.find_first_not_of("0123456789;") == std::string::npos;
      case 't':
        return collected_ == "22;0;0" || collected_ == "23;0;0";
      case 'h':
      case 'l':
        for (const Mode& mode : kModes) {
          if (mode.number != collected_) continue;
          isSet_[indexOf(mode)] = last == 'h';
          return true;
        }
        return false;
      default:
        return false;
    }
  }

  [[nodiscard]] bool isPlace() const {
    const std::size_t semicolon = collected_.find(';');
    if (semicolon == std::string::npos) return false;
    const auto isNumber = [](std::string_view digits) {
      return !digits.empty() && digits.size() <= 3 && digits[0] != '0' &&
             digits.find_first_not_of("0123456789") == std::string_view::npos;
    };
    const std::string_view whole = collected_;
    return isNumber(whole.substr(0, semicolon)) && isNumber(whole.substr(semicolon + 1));
  }

  /// Neither a control nor a mark that changes how the text around it is laid out.
  static bool canBeSeen(std::uint32_t code) {
    const bool isControl = code < 0xA0;
    const bool isLayout = code == 0xAD || code == 0x61C || (0x200B <= code && code <= 0x200F) ||
                          (0x2028 <= code && code <= 0x202E) || (0x2060 <= code && code <= 0x206F) || code == 0xFEFF;
    const bool isSurrogate = 0xD800 <= code && code <= 0xDFFF;
    return !isControl && !isLayout && !isSurrogate && code <= 0x10FFFF;
  }

  static std::string visible(std::string_view bytes) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string text;
    for (const char byte : bytes) {
      const auto code = static_cast<std::uint8_t>(byte);
      if (0x20 <= code && code < 0x7F) {
        text += byte;
      } else {
        text += {'<', kDigits[code >> 4], kDigits[code & 0xF], '>'};
      }
    }
    return text;
  }

  State state_ = State::ground;
  std::string collected_;
  int left_ = 0;
  std::uint32_t codePoint_ = 0;
  std::array<bool, kModes.size()> isSet_{false, true, true, false, false, false};
  std::string recent_;
  std::optional<std::string> fault_;
};

}  // namespace vesk
