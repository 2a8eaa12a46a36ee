#pragma once

#include <string>
#include <variant>

namespace vesk {

enum class Key {
  Character,
  Enter,
  Escape,
  Backspace,
  Tab,
  Up,
  Down,
  Left,
  Right,
  PageUp,
  PageDown,
  Home,
  End,
  Insert,
  Delete,
};

struct Modifiers {
  bool shift = false;
  bool alt = false;
  bool control = false;

  friend bool operator==(const Modifiers&, const Modifiers&) = default;
};

struct KeyEvent {
  Key key = Key::Character;
  /// The character of Key::Character, 0 for the others. Control with a letter is the small letter.
  char32_t character = 0;
  Modifiers modifiers{};

  friend bool operator==(const KeyEvent&, const KeyEvent&) = default;
};

enum class MouseAction {
  Press,    ///< of the main button, as are drag and release
  Drag,     ///< moved while the button is held
  Release,  ///< of any button: reports do not always tell which
  WheelUp,
  WheelDown,
};

struct MouseEvent {
  MouseAction action = MouseAction::Press;
  /// The cell, from 0 at the top left.
  int column = 0;
  int line = 0;
  Modifiers modifiers{};

  friend bool operator==(const MouseEvent&, const MouseEvent&) = default;
};

/// Text that was pasted, which is never keys.
struct PasteEvent {
  std::string text;

  friend bool operator==(const PasteEvent&, const PasteEvent&) = default;
};

using InputEvent = std::variant<KeyEvent, MouseEvent, PasteEvent>;

}  // namespace vesk
