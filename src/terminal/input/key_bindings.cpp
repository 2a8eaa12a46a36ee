#include "terminal/input/key_bindings.h"

#include <algorithm>

#include "values/utf8.h"

namespace vesk {

namespace {

constexpr BoundKey letter(char32_t character) {
  return {Key::Character, character};
}

const KeyBinding kBindings[] = {
    {Action::Help, {letter(U'?')}, "help", "show or leave this help"},
    {Action::Open, {{Key::Enter}, {Key::Right}, letter(U'l')}, "open", "open the selected row"},
    {Action::Back, {{Key::Escape}, {Key::Left}, letter(U'h'), {Key::Backspace}}, "back", "clear the filter, go back"},
    {Action::Filter, {letter(U'/')}, "filter", "show only rows with what is typed"},
    {Action::Freeze, {letter(U'f')}, "freeze", "hold the screen; intake goes on"},
    {Action::Diagnostics, {letter(U'd')}, "lines", "show or hide the diagnostic lines"},
    {Action::OlderLines, {letter(U'[')}, "", "older diagnostic lines"},
    {Action::NewerLines, {letter(U']')}, "", "newer diagnostic lines"},
    {Action::Quit, {letter(U'q')}, "quit", "end the program"},
    {Action::Up, {{Key::Up}, letter(U'k')}, "", "one row up"},
    {Action::Down, {{Key::Down}, letter(U'j')}, "", "one row down"},
    {Action::PageUp, {{Key::PageUp}}, "", "one page up"},
    {Action::PageDown, {{Key::PageDown}}, "", "one page down"},
    {Action::First, {{Key::Home}}, "", "the first row"},
    {Action::Last, {{Key::End}}, "", "the last row"},
};

}  // namespace

std::span<const KeyBinding> keyBindings() {
  return kBindings;
}

std::optional<Action> actionOf(const KeyEvent& event) {
  if (event.modifiers.alt || event.modifiers.control) return std::nullopt;
  for (const KeyBinding& binding : kBindings) {
    const bool isBound = std::any_of(binding.keys.begin(), binding.keys.end(), [&](const BoundKey& bound) {
      return bound.key == event.key && bound.character == event.character;
    });
    if (isBound) return binding.action;
  }
  return std::nullopt;
}

std::string nameOf(const BoundKey& key) {
  switch (key.key) {
    case Key::Character: {
      std::string name;
      appendCodePoint(name, key.character);
      return name;
    }
    case Key::Enter:
      return "Enter";
    case Key::Escape:
      return "Esc";
    case Key::Backspace:
      return "Backspace";
    case Key::Tab:
      return "Tab";
    case Key::Up:
      return "↑";
    case Key::Down:
      return "↓";
    case Key::Left:
      return "←";
    case Key::Right:
      return "→";
    case Key::PageUp:
      return "PgUp";
    case Key::PageDown:
      return "PgDn";
    case Key::Home:
      return "Home";
    case Key::End:
      return "End";
    case Key::Insert:
      return "Ins";
    case Key::Delete:
      return "Del";
  }
  return {};
}

std::string namesOf(const KeyBinding& binding) {
  std::string names;
  for (const BoundKey& key : binding.keys) {
    if (!names.empty()) names += ' ';
    names += nameOf(key);
  }
  return names;
}

}  // namespace vesk
