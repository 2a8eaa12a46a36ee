#pragma once

#include <initializer_list>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "terminal/input/input_event.h"

namespace vesk {

/// What a key does.
enum class Action {
  Help,
  Open,
  Back,
  Filter,
  Freeze,
  Backward,
  Forward,
  Faster,
  Slower,
  Readings,
  Overview,
  Trend,
  Timeline,
  Cells,
  Sort,
  Area,
  Diagnostics,
  OlderLines,
  NewerLines,
  Quit,
  Up,
  Down,
  PageUp,
  PageDown,
  First,
  Last,
  NextSection,
};

struct BoundKey {
  Key key;
  char32_t character = 0;
};

/// A row of the table that the program, its line of hints and its help all read.
struct KeyBinding {
  Action action;
  std::initializer_list<BoundKey> keys;
  /// For the line of hints, beside the first key; empty where no line names it.
  std::string_view hint;
  std::string_view help;
};

/// What a key with Control does while a filter is typed.
enum class Typing { RemoveAll, RemoveWord };

struct TypingBinding {
  Typing typing;
  char32_t letter;
  std::string_view name;
  std::string_view help;
};

[[nodiscard]] std::span<const TypingBinding> typingBindings();
[[nodiscard]] std::optional<Typing> typingOf(const KeyEvent& event);

/// In the order in which the help shows them.
[[nodiscard]] std::span<const KeyBinding> keyBindings();

/// The row of the table that has that action.
[[nodiscard]] const KeyBinding& bindingOf(Action action);
/// The keys that the line of hints names for a table screen.
[[nodiscard]] std::span<const Action> tableHints();

[[nodiscard]] std::optional<Action> actionOf(const KeyEvent& event);

/// "Enter", "Up", "f".
[[nodiscard]] std::string nameOf(const BoundKey& key);
/// The names of all keys of a binding, with blanks between them.
[[nodiscard]] std::string namesOf(const KeyBinding& binding);

}  // namespace vesk
