#include "terminal/input/input_sequence.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace vesk {

namespace {

struct LetterKey {
  char letter;
  Key key;
};

/// The last byte of CSI and SS3 sequences alike.
constexpr std::array kLetterKeys{
    LetterKey{'A', Key::Up},   LetterKey{'B', Key::Down}, LetterKey{'C', Key::Right},
    LetterKey{'D', Key::Left}, LetterKey{'F', Key::End},  LetterKey{'H', Key::Home},
};

struct NumberKey {
  int number;
  Key key;
};

/// The first parameter of sequences that end in "~".
constexpr std::array kNumberKeys{
    NumberKey{1, Key::Home},   NumberKey{2, Key::Insert},   NumberKey{3, Key::Delete}, NumberKey{4, Key::End},
    NumberKey{5, Key::PageUp}, NumberKey{6, Key::PageDown}, NumberKey{7, Key::Home},   NumberKey{8, Key::End},
};

/// Decimal parameters between semicolons; one that is missing is 0. At most three matter here.
struct Parameters {
  std::array<int, 3> numbers{};
  std::size_t count = 0;
};

std::optional<Parameters> parametersOf(std::string_view text) {
  Parameters parameters;
  while (!text.empty() && parameters.count < parameters.numbers.size()) {
    const std::size_t end = std::min(text.find(';'), text.size());
    if (end > 0) {
      int& number = parameters.numbers[parameters.count];
      const auto [stop, error] = std::from_chars(text.data(), text.data() + end, number);
      if (error != std::errc{} || stop != text.data() + end) return std::nullopt;
    }
    ++parameters.count;
    text.remove_prefix(std::min(end + 1, text.size()));
  }
  return parameters;
}

/// A modifier parameter is one more than a sum of 1 for shift, 2 for alt, 4 for control.
Modifiers modifiersOf(int parameter) {
  const int bits = parameter > 0 ? parameter - 1 : 0;
  return {.shift = (bits & 1) != 0, .alt = (bits & 2) != 0, .control = (bits & 4) != 0};
}

std::optional<InputEvent> letterEvent(char letter, int modifierParameter) {
  const auto* found = std::find_if(kLetterKeys.begin(), kLetterKeys.end(),
                                   [&](const LetterKey& each) { return each.letter == letter; });
  if (found == kLetterKeys.end()) return std::nullopt;
  return KeyEvent{.key = found->key, .modifiers = modifiersOf(modifierParameter)};
}

std::optional<InputEvent> numberEvent(const Parameters& parameters) {
  const auto* found = std::find_if(kNumberKeys.begin(), kNumberKeys.end(),
                                   [&](const NumberKey& each) { return each.number == parameters.numbers[0]; });
  if (found == kNumberKeys.end()) return std::nullopt;
  return KeyEvent{.key = found->key, .modifiers = modifiersOf(parameters.numbers[1])};
}

/// An SGR mouse report: button;column;line, counted from 1, then M for press and motion or m for release.
std::optional<InputEvent> mouseEvent(const Parameters& parameters, bool isRelease) {
  constexpr int kShift = 4;
  constexpr int kAlt = 8;
  constexpr int kControl = 16;
  constexpr int kMotion = 32;
  constexpr int kWheelUp = 64;
  constexpr int kWheelDown = 65;

  const auto [code, column, line] = parameters.numbers;
  if (parameters.count != 3 || column < 1 || line < 1) return std::nullopt;
  MouseEvent event{.column = column - 1,
                   .line = line - 1,
                   .modifiers = {(code & kShift) != 0, (code & kAlt) != 0, (code & kControl) != 0}};
  const int button = code & ~(kShift | kAlt | kControl);
  if (isRelease) {
    event.action = MouseAction::Release;
  } else if (button == 0) {
    event.action = MouseAction::Press;
  } else if (button == kMotion) {
    event.action = MouseAction::Drag;
  } else if (button == kWheelUp) {
    event.action = MouseAction::WheelUp;
  } else if (button == kWheelDown) {
    event.action = MouseAction::WheelDown;
  } else {
    return std::nullopt;
  }
  return event;
}

}  // namespace

std::optional<InputEvent> eventOfCsi(std::string_view sequence) {
  const char last = sequence.back();
  sequence.remove_suffix(1);
  const bool isMouse = sequence.starts_with('<');
  if (isMouse) sequence.remove_prefix(1);
  const std::optional<Parameters> parameters = parametersOf(sequence);
  if (!parameters) return std::nullopt;
  if (isMouse) {
    if (last != 'M' && last != 'm') return std::nullopt;
    return mouseEvent(*parameters, last == 'm');
  }
  if (last == '~') return numberEvent(*parameters);
  if (last == 'Z') return KeyEvent{.key = Key::Tab, .modifiers = {.shift = true}};
  return letterEvent(last, parameters->numbers[1]);
}

std::optional<InputEvent> eventOfSs3(std::string_view sequence) {
  const char last = sequence.back();
  sequence.remove_suffix(1);
  const std::optional<Parameters> parameters = parametersOf(sequence);
  if (!parameters) return std::nullopt;
  if (last == 'M') return KeyEvent{.key = Key::Enter};
  return letterEvent(last, parameters->numbers[parameters->count > 1 ? 1 : 0]);
}

}  // namespace vesk
