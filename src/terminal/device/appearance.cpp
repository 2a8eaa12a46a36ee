#include "terminal/device/appearance.h"

#include <algorithm>
#include <array>

#include "values/parse_number.h"

namespace vesk {

namespace {

/// In the order of the roles.
constexpr std::array<std::string_view, kRoleCount> kRoleNames{"plain",
                                                              "faint",
                                                              "bar",
                                                              "status",
                                                              "title",
                                                              "held",
                                                              "section-header",
                                                              "value",
                                                              "changed",
                                                              "selected",
                                                              "selected-changed",
                                                              "prompt",
                                                              "pane-header",
                                                              "key",
                                                              "excellent",
                                                              "good",
                                                              "fair",
                                                              "poor",
                                                              "alarm"};

constexpr std::array<std::string_view, 8> kColors{"black", "red",     "green", "yellow",
                                                  "blue",  "magenta", "cyan",  "white"};

std::optional<std::uint8_t> colorNamed(std::string_view word) {
  if (const auto* named = std::find(kColors.begin(), kColors.end(), word); named != kColors.end())
    return static_cast<std::uint8_t>(named - kColors.begin());
  return parseNumber<std::uint8_t>(word);
}

/// Takes the first word off; empty when there is none.
std::string_view takeWord(std::string_view& text) {
  text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
  const std::string_view word = text.substr(0, text.find(' '));
  text.remove_prefix(word.size());
  return word;
}

}  // namespace

std::optional<Role> roleNamed(std::string_view name) {
  const auto* found = std::find(kRoleNames.begin(), kRoleNames.end(), name);
  if (found == kRoleNames.end()) return std::nullopt;
  return static_cast<Role>(found - kRoleNames.begin());
}

std::string roleNames() {
  std::string names;
  for (const std::string_view name : kRoleNames) {
    if (!names.empty()) names += ", ";
    names += name;
  }
  return names;
}

std::optional<Look> parseLook(std::string_view text) {
  Look look;
  std::string_view word = takeWord(text);
  if (word.empty()) return std::nullopt;
  for (; !word.empty(); word = takeWord(text)) {
    if (word == "bold") {
      look.isBold = true;
    } else if (word == "reverse") {
      look.isReversed = true;
    } else if (word == "underline") {
      look.isUnderlined = true;
    } else if (word == "on") {
      look.background = colorNamed(takeWord(text));
      if (!look.background) return std::nullopt;
    } else if (word != "plain") {
      look.foreground = colorNamed(word);
      if (!look.foreground) return std::nullopt;
    }
  }
  return look;
}

std::optional<Signs> signsNamed(std::string_view name) {
  if (name == "ascii") return Signs::ascii;
  if (name == "block") return Signs::blocks;
  if (name == "braille") return Signs::braille;
  return std::nullopt;
}

Palette withLooksOf(const Appearance& appearance, Palette palette, int colors) {
  for (auto [role, look] : appearance.looks) {
    for (auto* color : {&look.foreground, &look.background})
      if (*color && **color >= colors) color->reset();
    palette[static_cast<std::size_t>(role)] = look;
  }
  return palette;
}

}  // namespace vesk
