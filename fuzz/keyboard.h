#pragma once

#include <algorithm>
#include <vector>

#include "property.h"
#include "support/allocations.h"
#include "terminal/input/input_machine.h"

namespace vesk {

using namespace std::chrono_literals;

using Events = std::vector<InputEvent>;

/// An input machine and the clock that it is told the time of.
class Keyboard {
 public:
  void send(std::string_view bytes) { machine_.feed(bytes, now_, events_); }
  void wait(Clock::Duration time) {
    now_ += time;
    machine_.advance(now_, events_);
  }
  /// Until whatever was begun is given up.
  void pause() { wait(InputMachine::kUnfinishedSequence); }

  [[nodiscard]] bool isWaiting() const { return machine_.deadline().has_value(); }
  [[nodiscard]] const Events& events() const { return events_; }

 private:
  InputMachine machine_;
  Clock::Instant now_{1h};
  Events events_;
};

inline void requireMeaningful(const InputEvent& event) {
  if (const auto* key = std::get_if<KeyEvent>(&event)) {
    const bool isSurrogate = 0xD800 <= key->character && key->character <= 0xDFFF;
    require(key->character <= 0x10FFFF && !isSurrogate, "a key types a character");
    require((key->key == Key::Character) == (key->character != 0), "only character keys type");
  } else if (const auto* mouse = std::get_if<MouseEvent>(&event)) {
    require(mouse->column >= 0 && mouse->line >= 0, "the mouse is in the terminal");
  }
}

/// Sent as a whole and given time.
inline Events eventsOf(std::string_view bytes) {
  Keyboard keyboard;
  const std::uint64_t before = allocatedBytes();
  keyboard.send(bytes);
  require(allocatedBytes() - before <= 8192 + 4 * bytes.size() + 4 * sizeof(InputEvent) * keyboard.events().size(),
          "what a sequence has collected is bounded");
  if (!keyboard.isWaiting()) {
    Keyboard same = keyboard;
    same.pause();
    require(same.events() == keyboard.events(), "a machine that waits for nothing has nothing");
  }
  keyboard.pause();
  require(!keyboard.isWaiting(), "nothing is waited for for ever");
  require(keyboard.events().size() <= bytes.size(), "an event takes at least a byte");
  std::for_each(keyboard.events().begin(), keyboard.events().end(), requireMeaningful);

  Events expected = keyboard.events();
  expected.emplace_back(KeyEvent{.character = 'q'});
  keyboard.send("q");
  require(keyboard.events() == expected, "after a pause a key is that key");
  expected.pop_back();
  return expected;
}

}  // namespace vesk
