#include "terminal/device/capabilities.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <string_view>
// curses.h must come before term.h, and both leave macros behind: they are seen by this file alone.
#include <curses.h>
#include <term.h>

namespace vesk {

namespace {

// Terminals of today that have a mouse at all know these two (motion while a button is held; reports in
// decimal); the others pass over them. Terminfo has no names for them.
constexpr std::string_view kMouseOn = "\x1b[?1002h\x1b[?1006h";
constexpr std::string_view kMouseOff = "\x1b[?1006l\x1b[?1002l";
// The same holds for the marks around pasted text.
constexpr std::string_view kPasteMarksOn = "\x1b[?2004h";
constexpr std::string_view kPasteMarksOff = "\x1b[?2004l";

std::string_view environment(const char* name) {
  const char* value = std::getenv(name);
  return value != nullptr ? value : "";
}

/// Padding, which terminfo writes as $<5>, is for terminals of paper's time and is left out.
std::string withoutPadding(std::string_view capability) {
  std::string bytes;
  while (!capability.empty()) {
    const std::size_t start = std::min(capability.find("$<"), capability.size());
    bytes += capability.substr(0, start);
    const std::size_t end = capability.find('>', start);
    if (end == std::string_view::npos) return bytes += capability.substr(start);
    capability.remove_prefix(end + 1);
  }
  return bytes;
}

std::string textCapability(const char* name) {
  const char* capability = tigetstr(name);
  const bool isMissing = capability == nullptr || reinterpret_cast<std::intptr_t>(capability) == -1;
  return isMissing ? std::string{} : withoutPadding(capability);
}

std::string filledIn(const std::string& capability, int first, int second) {
  if (capability.empty()) return {};
  const char* bytes = tparm(capability.c_str(), first, second, 0, 0, 0, 0, 0, 0, 0);
  return bytes != nullptr ? bytes : std::string{};
}

std::string bytesOf(const Look& look) {
  std::string bytes;
  if (look.isBold) bytes += textCapability("bold");
  if (look.isReversed) bytes += textCapability("rev");
  if (look.isUnderlined) bytes += textCapability("smul");
  if (look.foreground) bytes += filledIn(textCapability("setaf"), *look.foreground, 0);
  if (look.background) bytes += filledIn(textCapability("setab"), *look.background, 0);
  return bytes;
}

/// What stands in for a terminal that this system does not know, as after a login from a newer one. Terminals of today
/// understand the first.
constexpr std::array kStandIns{"xterm-256color", "xterm", "ansi"};

bool hasDescription(const char* name, int descriptor) {
  int status = 0;
  return setupterm(name, descriptor, &status) == OK;
}

/// Loads the description of `name`, or of what stands in for it, and returns whose it is; null for none.
const char* loadDescription(const std::string& name, int descriptor) {
  if (hasDescription(name.c_str(), descriptor)) return name.c_str();
  const auto* found = std::find_if(kStandIns.begin(), kStandIns.end(),
                                   [&](const char* each) { return hasDescription(each, descriptor); });
  return found != kStandIns.end() ? *found : nullptr;
}

}  // namespace

std::string Capabilities::move(int column, int line) const {
  return filledIn(moveTo, line, column);
}

std::optional<Capabilities> readCapabilities(int descriptor, bool showsUtf8, const Appearance& appearance,
                                             std::string& reason) {
  const std::string name(environment("TERM"));
  const char* known = name.empty() ? nullptr : loadDescription(name, descriptor);
  if (known == nullptr) {
    reason = name.empty() ? "TERM is not set: set it to the name of your terminal"
                          : "the terminal \"" + name + "\" is not known to this system: check TERM";
    return std::nullopt;
  }
  Capabilities found;
  if (known != name)
    found.warning = "the terminal \"" + name + "\" is not known to this system: its screens are those of " + known;
  found.moveTo = textCapability("cup");
  found.clear = textCapability("clear");
  if (found.moveTo.empty() || found.clear.empty()) {
    reason = "the terminal \"" + name + "\" cannot place its cursor, which screens need";
    return std::nullopt;
  }
  found.plain = textCapability("sgr0");
  found.enterScreen = textCapability("smcup") + textCapability("civis") + textCapability("rmam");
  found.enterScreen.append(kMouseOn).append(kPasteMarksOn);
  found.leaveScreen.append(kPasteMarksOff).append(kMouseOff);
  found.leaveScreen += found.plain + textCapability("smam") + textCapability("cnorm");
  const std::string leaveOtherScreen = textCapability("rmcup");
  found.leaveScreen += leaveOtherScreen.empty() ? found.clear : leaveOtherScreen;
  found.showsUtf8 = showsUtf8 && !isWithoutUtf8(known);
  found.signs = found.showsUtf8 ? appearance.signs.value_or(signsOf(name, true)) : Signs::ascii;

  const int colors = tigetnum("colors");
  const ColorDepth depth = colorDepthOf(colors, environment("NO_COLOR"));
  const Palette palette = withLooksOf(appearance, makePalette(depth, backgroundOf(environment("COLORFGBG"))),
                                      depth == ColorDepth::None ? 0 : colors);
  for (std::size_t role = 0; role < palette.size(); ++role)
    found.looks[role] = bytesOf(palette[role]);
  return found;
}

}  // namespace vesk
