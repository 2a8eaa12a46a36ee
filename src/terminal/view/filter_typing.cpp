#include "terminal/view/filter_typing.h"

#include <utility>

#include "values/utf8.h"

namespace vesk {

namespace {

void removeLastCharacter(std::string& text) {
  while (!text.empty() && (static_cast<unsigned char>(text.back()) & 0xC0) == 0x80)
    text.pop_back();
  if (!text.empty()) text.pop_back();
}

}  // namespace

std::optional<TypedFilter> typeInto(std::string filter, const KeyEvent& event) {
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

}  // namespace vesk
