#include "terminal/input/key_bindings.h"

#include <algorithm>
#include <array>
#include <iterator>

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
    {Action::Freeze, {letter(U' '), letter(U'f')}, "hold", "hold all that shows, and the replay; intake goes on"},
    {Action::Backward, {letter(U'<')}, "10 s back", "10 s back in the replay"},
    {Action::Forward, {letter(U'>')}, "10 s forward", "10 s forward in the replay"},
    {Action::Faster, {letter(U'+')}, "faster", "a faster replay"},
    {Action::Slower, {letter(U'-')}, "slower", "a slower replay"},
    {Action::Readings, {letter(U'u')}, "", "show or hide what the values mean"},
    {Action::Overview, {letter(U'o')}, "overview", "where the phone is and how it is doing, on one screen"},
    {Action::Trend, {letter(U't')}, "trend", "the course of the selected figure"},
    {Action::Timeline, {letter(U'e')}, "events", "what happened and when; Enter shows all fields"},
    {Action::Cells, {letter(U'c')}, "cells", "the cells heard"},
    {Action::Sort, {letter(U's')}, "sort", "sort the cells by the next column"},
    {Action::Area,
     {letter(U'1'), letter(U'2'), letter(U'3'), letter(U'4')},
     "to 4 areas",
     "open an area of the first screen"},
    {Action::Diagnostics, {letter(U'd')}, "lines", "the diagnostic lines: some, half a screen, none"},
    {Action::OlderLines, {letter(U'[')}, "", "older diagnostic lines"},
    {Action::NewerLines, {letter(U']')}, "", "newer diagnostic lines"},
    {Action::Quit, {letter(U'q')}, "quit", "end the program"},
    {Action::Up, {{Key::Up}, letter(U'k')}, "", "one row up; on a trend: the figure before"},
    {Action::Down, {{Key::Down}, letter(U'j')}, "figure", "one row down; on a trend: the next figure"},
    {Action::PageUp, {{Key::PageUp}}, "longer", "one page up; on a trend: a longer time"},
    {Action::PageDown, {{Key::PageDown}}, "shorter", "one page down; on a trend: a shorter time"},
    {Action::First, {{Key::Home}, letter(U'g')}, "", "the first row"},
    {Action::Last, {{Key::End}, letter(U'G')}, "", "the last row"},
    {Action::NextSection, {{Key::Tab}}, "", "the next section, after the last the first"},
};

constexpr TypingBinding kTypingBindings[] = {
    {Typing::RemoveAll, U'u', "Ctrl-U", "remove all that is typed into the filter"},
    {Typing::RemoveWord, U'w', "Ctrl-W", "remove its last word"},
};

}  // namespace

std::span<const TypingBinding> typingBindings() {
  return kTypingBindings;
}

std::optional<Typing> typingOf(const KeyEvent& event) {
  if (!event.modifiers.control || event.modifiers.alt) return std::nullopt;
  for (const TypingBinding& binding : kTypingBindings)
    if (binding.letter == event.character) return binding.typing;
  return std::nullopt;
}

std::span<const KeyBinding> keyBindings() {
  return kBindings;
}

const KeyBinding& bindingOf(Action action) {
  return *std::find_if(std::begin(kBindings), std::end(kBindings),
                       [&](const KeyBinding& binding) { return binding.action == action; });
}

std::span<const Action> tableHints() {
  static constexpr std::array kHints{Action::Help,   Action::Open,        Action::Back,     Action::Filter,
                                     Action::Freeze, Action::Diagnostics, Action::Overview, Action::Quit};
  return kHints;
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
      if (key.character == U' ') return "Space";
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
      return "Up";
    case Key::Down:
      return "Down";
    case Key::Left:
      return "Left";
    case Key::Right:
      return "Right";
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
