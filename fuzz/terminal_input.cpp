// The first bytes say how large the terminal is and how its input is cut; the others are what it sends.

#include <bit>

#include "keyboard.h"
#include "odd_interface.h"
#include "shown.h"
#include "support/pictures.h"

namespace vesk {
namespace {

constexpr auto kAlmostAnEscape = InputMachine::kLoneEscape - 1ms;

void checkInput(std::string_view bytes, std::size_t pieceSize) {
  const Events whole = eventsOf(bytes);
  Keyboard keyboard;
  for (std::size_t start = 0; start < bytes.size(); start += pieceSize) {
    if (start > 0) keyboard.wait(kAlmostAnEscape);
    keyboard.send(bytes.substr(start, pieceSize));
  }
  keyboard.pause();
  require(keyboard.events() == whole, "the pieces in which input comes do not matter");

  const std::size_t middle = std::min(pieceSize, bytes.size());
  Events apart = eventsOf(bytes.substr(0, middle));
  for (const InputEvent& event : eventsOf(bytes.substr(middle)))
    apart.push_back(event);
  Keyboard pausing;
  for (const std::string_view piece : {bytes.substr(0, middle), bytes.substr(middle)}) {
    pausing.send(piece);
    pausing.pause();
  }
  require(pausing.events() == apart, "a pause ends a sequence");
}

/// Whatever is typed, there is something to see.
void checkScreens(const Events& events, Size size) {
  const std::shared_ptr<NavigationController> stack = oddInterface().makeRootStack();
  stack->loadViewIfNeeded();
  DiagnosticLines diagnostics(20);
  diagnostics.append("Metric ID in Hex =  3C4E04");
  Surroundings surroundings;
  surroundings.diagnostics = &diagnostics;
  Desk desk(*stack, size, surroundings);
  for (std::size_t index = 0; index < events.size(); ++index) {
    desk.presenter().handle(events[index]);
    // A look takes much longer than an event: few of them, most at the start.
    if (std::has_single_bit(index + 1)) requireDrawable(desk.grid(), size);
  }
  desk.resize({size.lines, size.columns});
  requireDrawable(desk.grid(), {size.lines, size.columns});
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size < 3) return 0;
  const std::string_view bytes(reinterpret_cast<const char*>(data) + 3, size - 3);
  vesk::checkInput(bytes, 1 + data[0] % 32U);
  vesk::checkScreens(vesk::eventsOf(bytes), {data[1] % 130, data[2] % 60});
  return 0;
}
