#pragma once

#include <algorithm>
#include <cstddef>
#include <string_view>
#include <utility>

#include "values/shared_bytes.h"

namespace vesk {

/// Immutable text in UTF-8, one pointer wide, shared by its copies. Bytes from outside are kept as they came,
/// valid or not; what shows them replaces the invalid ones (utf8.h). A literal, written "…"_text, lies in
/// static storage and is never allocated.
class Text {
 public:
  Text() = default;
  static Text copy(std::string_view text) { return Text(SharedBytes::copy(text)); }
  /// A text over an immortal block of static storage, the only one of this text.
  static Text ofLiteral(SharedBytes::Block* block) { return Text(SharedBytes::ofImmortal(block)); }

  [[nodiscard]] std::string_view view() const { return bytes_.view(); }
  [[nodiscard]] bool empty() const { return view().empty(); }

  /// Whether it is a literal. Two literals are equal only when they are the same.
  [[nodiscard]] bool isLiteral() const { return bytes_.isImmortal(); }
  /// Whether both share their bytes, which makes them equal.
  [[nodiscard]] bool isSameAs(const Text& other) const { return bytes_.isSameAs(other.bytes_); }

  friend bool operator==(const Text&, const Text&) = default;
  friend bool operator==(const Text& a, std::string_view b) { return a.view() == b; }

 private:
  explicit Text(SharedBytes bytes) : bytes_(std::move(bytes)) {}

  SharedBytes bytes_;
};

namespace detail {

template <std::size_t Size>
struct LiteralCharacters {
  char characters[Size];

  consteval LiteralCharacters(const char (&literal)[Size]) { std::copy_n(literal, Size, characters); }
};

template <LiteralCharacters literal>
inline constexpr LiteralCharacters kLiteral = literal;

template <LiteralCharacters literal>
inline constinit SharedBytes::Block literalBlock{kLiteral<literal>.characters, sizeof(literal.characters) - 1, 1};

}  // namespace detail

template <detail::LiteralCharacters literal>
Text operator""_text() {
  return Text::ofLiteral(&detail::literalBlock<literal>);
}

}  // namespace vesk
