#include "terminal/input/input_machine.h"

#include <gtest/gtest.h>
#include <ostream>

namespace vesk {

void PrintTo(const InputEvent& event, std::ostream* out) {
  if (const auto* key = std::get_if<KeyEvent>(&event)) {
    *out << "key " << static_cast<int>(key->key) << " U+" << static_cast<unsigned>(key->character)
         << (key->modifiers.shift ? " shift" : "") << (key->modifiers.alt ? " alt" : "")
         << (key->modifiers.control ? " control" : "");
  } else if (const auto* mouse = std::get_if<MouseEvent>(&event)) {
    *out << "mouse " << static_cast<int>(mouse->action) << " at " << mouse->column << "," << mouse->line;
  } else {
    *out << "paste " << std::get<PasteEvent>(event).text;
  }
}

namespace {

using namespace std::chrono_literals;

constexpr Modifiers kShift{.shift = true};
constexpr Modifiers kAlt{.alt = true};
constexpr Modifiers kControl{.control = true};

KeyEvent key(Key which, Modifiers modifiers = {}) {
  return {.key = which, .modifiers = modifiers};
}
KeyEvent character(char32_t which, Modifiers modifiers = {}) {
  return {.character = which, .modifiers = modifiers};
}
MouseEvent mouse(MouseAction action, int column, int line, Modifiers modifiers = {}) {
  return {action, column, line, modifiers};
}

struct Case {
  std::string_view bytes;
  std::vector<InputEvent> events;
};

/// Each is followed by an "x", which tells whether the sequence was taken whole and no more.
const Case kCases[] = {
    {"\xC3\xA9\xE6\xBC\xA2\xF0\x9F\x93\xB6", {character(U'é'), character(U'漢'), character(U'📶')}},
    {"\r\n\t\x7F\b", {key(Key::Enter), key(Key::Enter), key(Key::Tab), key(Key::Backspace), key(Key::Backspace)}},
    {"\x01\x1A", {character('a', kControl), character('z', kControl)}},
    {"\x1b[A\x1b[B\x1b[C\x1b[D", {key(Key::Up), key(Key::Down), key(Key::Right), key(Key::Left)}},
    {"\x1bOA\x1bOF\x1bOM", {key(Key::Up), key(Key::End), key(Key::Enter)}},
    {"\x1b[H\x1b[1~\x1b[7~\x1b[4~", {key(Key::Home), key(Key::Home), key(Key::Home), key(Key::End)}},
    {"\x1b[5~\x1b[6~\x1b[2~\x1b[3~", {key(Key::PageUp), key(Key::PageDown), key(Key::Insert), key(Key::Delete)}},
    {"\x1b[1;2A\x1b[1;3B\x1b[5;5~", {key(Key::Up, kShift), key(Key::Down, kAlt), key(Key::PageUp, kControl)}},
    {"\x1bO5C\x1bO1;5D\x1b[Z", {key(Key::Right, kControl), key(Key::Left, kControl), key(Key::Tab, kShift)}},
    {"\x1b"
     "f\x1b\xC3\xA9",
     {character('f', kAlt), character(U'é', kAlt)}},
    {"\x1b\x1b[A", {key(Key::Escape), key(Key::Up)}},
    {"\x1b[<0;3;7M\x1b[<32;4;8M\x1b[<0;4;8m",
     {mouse(MouseAction::Press, 2, 6), mouse(MouseAction::Drag, 3, 7), mouse(MouseAction::Release, 3, 7)}},
    {"\x1b[<64;1;1M\x1b[<65;1;1M", {mouse(MouseAction::WheelUp, 0, 0), mouse(MouseAction::WheelDown, 0, 0)}},
    {"\x1b[<16;300;200M", {mouse(MouseAction::Press, 299, 199, kControl)}},
    {"\x1b[200~q\r\x1b[Aé\x1b[201~", {PasteEvent{"q\r\x1b[Aé"}}},
    // Understood as nothing, and swallowed whole.
    {"\x1b[<2;3;7M\x1b[<35;3;7M\x1b[<0;0;1M\x1b[<0;3M\x1b[<0;3;7Q", {}},
    {"\x1b[15~\x1b[201~\x1b[?1;2c\x1b[1;2$y\x1b[99999999999A", {}},
    {"\x1b[M !!\x1b[[A\x1bOP", {}},
    {"\x1b]11;rgb:0000/0000/0000\x1b\\\x1b]0;title\a\x1bPdcs\x1b\\", {}},
    {"\x80\xC3\xFF\xE6\xBC", {}},
    {"\x1b[12\x1b[A", {key(Key::Up)}},
    {"\x1b[\xC3\xA9", {character(U'é')}},
};

TEST(InputMachine, ReadsSequencesWholeHoweverTheyAreCut) {
  for (const Case& each : kCases) {
    SCOPED_TRACE(testing::PrintToString(each.bytes));
    std::vector<InputEvent> expected = each.events;
    expected.emplace_back(character('x'));
    const std::string bytes = std::string(each.bytes) + "x";
    for (std::size_t cut = 0; cut < bytes.size(); ++cut) {
      InputMachine machine;
      std::vector<InputEvent> events;
      machine.feed(std::string_view(bytes).substr(0, cut), Clock::Instant(0ms), events);
      machine.feed(std::string_view(bytes).substr(cut), Clock::Instant(49ms), events);
      EXPECT_EQ(events, expected) << "cut at " << cut;
      EXPECT_EQ(machine.deadline(), std::nullopt);
    }
  }
}

TEST(InputMachine, JudgesWhatFollowsAnEscapeByItsTime) {
  struct {
    std::chrono::milliseconds pause;
    std::vector<InputEvent> events;
  } const cases[] = {
      {49ms, {key(Key::Up)}},
      {50ms, {key(Key::Escape), character('['), character('A')}},
  };
  for (const auto& each : cases) {
    InputMachine machine;
    std::vector<InputEvent> events;
    machine.feed("\x1b", Clock::Instant(0ms), events);
    machine.feed("[A", Clock::Instant(each.pause), events);
    EXPECT_EQ(events, each.events);
  }
}

TEST(InputMachine, GivesAnUnfinishedSequenceUpAfterASecond) {
  for (const std::string_view start : {"\x1b[", "\x1b[<0;3", "\x1bO", "\x1b]11;", "\xE6\xBC", "\x1b[M"}) {
    InputMachine machine;
    std::vector<InputEvent> events;
    machine.feed(start, Clock::Instant(0ms), events);
    machine.advance(Clock::Instant(999ms), events);
    EXPECT_EQ(machine.deadline(), Clock::Instant(1000ms));
    machine.feed("q", Clock::Instant(1000ms), events);
    EXPECT_EQ(events, std::vector<InputEvent>{character('q')});
  }
}

}  // namespace
}  // namespace vesk
