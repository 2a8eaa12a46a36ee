// The bytes are what a user does at screens full of hostile values: the next screen, a key, another size, or that the
// stores shrink from then on whenever the table asks for something.

#include "hostile_stage.h"
#include "property.h"
#include "support/pictures.h"
#include "terminal/device/difference.h"
#include "terminal_language.h"

namespace vesk {
namespace {

constexpr std::uint8_t kNextScreen = 0;
constexpr std::uint8_t kShrink = 1;
constexpr std::uint8_t kFirstSize = 2;
constexpr Size kSizes[] = {{60, 20}, {31, 17}, {300, 90}, {1, 1}};
constexpr std::uint8_t kFirstKey = 6;
constexpr Key kKeys[] = {Key::Down, Key::Up, Key::PageDown, Key::PageUp, Key::Home, Key::End, Key::Tab};

/// Does what the byte stands for, which may be a letter typed.
void act(Desk& desk, std::uint8_t action) {
  if (kFirstSize <= action && action < kFirstSize + std::size(kSizes)) {
    desk.resize(kSizes[action - kFirstSize]);
  } else if (kFirstKey <= action && action < kFirstKey + std::size(kKeys)) {
    desk.press(kKeys[action - kFirstKey]);
  } else {
    const char32_t letter = action;
    desk.type({&letter, 1});
  }
}

void checkScreens(HostileStage& stage, std::span<const std::uint8_t> actions) {
  TerminalLanguage language;
  Desk desk(stage.stack(), kSizes[0], stage.surroundings());
  for (const std::uint8_t action : actions) {
    if (action == kNextScreen) {
      stage.openNextScreen();
    } else if (action == kShrink) {
      stage.shrink();
    } else {
      act(desk, action);
    }
    std::string bytes;
    appendDifference(bytes, {}, desk.grid(), stage.terminal());
    language.take(bytes);
    require(!language.fault(), "the terminal is sent nothing but text and what the program means");
  }
  stage.leave();
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  // For as long as the program lives.
  static auto& stage = *new vesk::HostileStage;
  vesk::checkScreens(stage, {data, size});
  return 0;
}
