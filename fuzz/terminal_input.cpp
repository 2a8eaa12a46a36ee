// The first bytes say how large the terminal is and how its input is cut; the others are what it sends.

#include <algorithm>
#include <bit>
#include <vector>

#include "property.h"
#include "shown.h"
#include "support/allocations.h"
#include "support/fake_interface.h"
#include "support/pictures.h"
#include "terminal/input/input_machine.h"

namespace vesk {

namespace {

using namespace std::chrono_literals;

using Events = std::vector<InputEvent>;

constexpr auto kAlmostAnEscape = InputMachine::kLoneEscape - 1ms;

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

void requireMeaningful(const InputEvent& event) {
  if (const auto* key = std::get_if<KeyEvent>(&event)) {
    const bool isSurrogate = 0xD800 <= key->character && key->character <= 0xDFFF;
    require(key->character <= 0x10FFFF && !isSurrogate, "a key types a character");
    require((key->key == Key::Character) == (key->character != 0), "only character keys type");
  } else {
    const auto& mouse = std::get<MouseEvent>(event);
    require(mouse.column >= 0 && mouse.line >= 0, "the mouse is in the terminal");
  }
}

/// Sent as a whole and given time.
Events eventsOf(std::string_view bytes) {
  Keyboard keyboard;
  const std::uint64_t before = allocatedBytes();
  keyboard.send(bytes);
  require(allocatedBytes() - before <= 1024 + 4 * sizeof(InputEvent) * keyboard.events().size(),
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
  const Events behind = eventsOf(bytes.substr(middle));
  apart.insert(apart.end(), behind.begin(), behind.end());
  Keyboard pausing;
  pausing.send(bytes.substr(0, middle));
  pausing.pause();
  pausing.send(bytes.substr(middle));
  pausing.pause();
  require(pausing.events() == apart, "a pause ends a sequence");
}

/// Values as no metric should have them.
class OddFields : public FakeTableScreen {
 public:
  OddFields() {
    content = {{"many"_text, {}}, {std::nullopt, {}}, {"odd"_text, {}}};
    for (int index = 0; index < 30; ++index)
      content[0].rows.push_back(row("row " + std::to_string(index), "1"));
    content[2].rows = {
        row("lines", "first\nsecond \x1B[31m\n\n- third"),
        row("", ""),
        row(std::string(300, 'k'), std::string(2000, 'v')),
        row("漢字漢字", "e\u0301\u202E📶\xC3\x80\xFF\t\x9B"),
        {std::nullopt, "alone"_text},
    };
  }
};

const InterfaceLayout& layout() {
  static const InterfaceLayout theLayout({
      .rootStack = makeStackOf<NavigationController>,
      .firstScreen = "Areas",
      .screens = {{"Areas", makeScreenOf<FakeAreas>, "Vesk"},
                  {"Categories", makeScreenOf<FakeCategories>, ""},
                  {"Fields", makeScreenOf<OddFields>, ""}},
      .cells = {{"LaunchView", CellStyle::Basic, CellAccessory::Disclosure},
                {"FirstClickView", CellStyle::Basic, CellAccessory::Disclosure},
                {"SecondClickView", CellStyle::RightDetail, CellAccessory::None}},
      .transitions = {{"Areas", "showArea", "Categories"}, {"Categories", "showCategory", "Fields"}},
  });
  return theLayout;
}

/// Whatever is typed, there is something to see.
void checkScreens(const Events& events, Size size) {
  const std::shared_ptr<NavigationController> stack = layout().makeRootStack();
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
  std::swap(size.columns, size.lines);
  desk.resize(size);
  requireDrawable(desk.grid(), size);
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
