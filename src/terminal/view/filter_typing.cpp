#include "terminal/view/filter_typing.h"

#include <utility>

#include "terminal/input/key_bindings.h"
#include "values/utf8.h"

namespace vesk {

namespace {

void removeLastCharacter(std::string& text) {
  while (!text.empty() && (static_cast<unsigned char>(text.back()) & 0xC0) == 0x80)
    text.pop_back();
  if (!text.empty()) text.pop_back();
}

void removeLastWord(std::string& text) {
  text.resize(text.find_last_not_of(' ') + 1);
  text.resize(text.find_last_of(' ') + 1);
}

}  // namespace

std::optional<TypedFilter> typeInto(std::string filter, const KeyEvent& event) {
  if (const std::optional<Typing> typing = typingOf(event)) {
    if (*typing == Typing::RemoveAll) filter.clear();
    if (*typing == Typing::RemoveWord) removeLastWord(filter);
    return TypedFilter{std::move(filter), true};
  }
  switch (event.key) {
    case Key::Character:
      if (!event.modifiers.alt && !event.modifiers.control) appendCodePoint(filter, event.character);
      return TypedFilter{std::move(filter), true};
    case Key::Backspace: {
      const bool goesOn = !filter.empty();
      removeLastCharacter(filter);
      return TypedFilter{std::move(filter), goesOn};
    }
    case Key::Enter:
      return TypedFilter{std::move(filter), false};
    case Key::Escape:
      return TypedFilter{{}, false};
    case Key::Left:
    case Key::Right:
      return TypedFilter{std::move(filter), true};
    case Key::Tab:
    case Key::Up:
    case Key::Down:
    case Key::PageUp:
    case Key::PageDown:
    case Key::Home:
    case Key::End:
    case Key::Insert:
    case Key::Delete:
      return std::nullopt;
  }
  return std::nullopt;
}

std::string pasteInto(std::string filter, std::string_view text) {
  for (const char byte : text.substr(0, text.find_first_of("\r\n"))) {
    const bool isControl = static_cast<unsigned char>(byte) < 0x20 || byte == 0x7F;
    if (!isControl) filter += byte;
  }
  return filter;
}

}  // namespace vesk
