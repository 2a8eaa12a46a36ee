#include "recording/recording_reader.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "support/input.h"
#include "values/text_form.h"

namespace vesk {
namespace {

/// What next() yields, in one line: "12.5 3952132 0895", the message, or "end".
std::string textOf(const RecordingReader::Step& step) {
  if (const auto* event = std::get_if<RecordedEvent>(&step)) {
    std::string text;
    appendDecimal(text, event->at);
    text += ' ' + std::to_string(event->metricId) + ' ';
    appendHex(text, event->payload);
    return text;
  }
  if (const auto* bad = std::get_if<BadLine>(&step)) return bad->message;
  if (const auto* failure = std::get_if<ReadFailure>(&step)) return failure->message;
  return "end";
}

std::vector<std::string> readAll(std::string_view content, std::size_t longestLine = LineReader::kLongestLine) {
  RecordingReader reader(fileWith(content), "r", longestLine);
  std::vector<std::string> steps;
  do {
    steps.push_back(textOf(reader.next()));
  } while (steps.back() != "end");
  steps.pop_back();
  return steps;
}

/// So many arrays, each in the one before.
std::string nested(std::size_t depth) {
  return std::string(depth, '[') + std::string(depth, ']');
}

TEST(RecordingReader, ReadsOrRefusesALine) {
  using namespace std::string_literals;
  const std::string metric = "r:1: \"metric\": expected an integer or \"0x…\" text, at most 64 bits";
  const std::string notClosed = "r:1: does not end with the object's closing brace: is the line cut off?";
  const std::string notJson = "r:1: not valid JSON";
  const std::pair<std::string, std::string> cases[] = {
      {R"({"at": 12.5, "metric": "0x3C4E04", "payload": "0895"})", "12.5 3952132 0895"},
      {R"({"payload":"aBcD","metric":3952132,"at":0})", "0.0 3952132 abcd"},
      {R"(  {"at": 1e3, "metric": "0Xff", "payload": "" , "more": {"at": [7, "}"]}} )", "1000.0 255 "},
      {R"({"at": 1, "metric": -9223372036854775808, "payload": ""})", "1.0 -9223372036854775808 "},
      {R"({"\u0061t": 1, "metric": 2, "payload": ""})", "1.0 2 "},
      {R"({"at": 1, "metric": "0x\u0032", "payload": "\u0030a"})", "1.0 2 0a"},
      {"{\t\"at\": 1, \"metric\": 2, \"payload\": \"\", \"place\": \"K\u00F6ln, am Rheinufer\"}", "1.0 2 "},
      {R"({"at": 1, "metric": 2, "payload": "", "deep": )" + nested(499) + "}", "1.0 2 "},
      {"\xEF\xBB\xBF{\"at\": 1, \"metric\": 2, \"payload\": \"\"}\r", "1.0 2 "},

      {R"(at 12.5)", "r:1: no JSON object"},
      {R"({})", "r:1: \"at\": missing"},
      {R"({"at": 1, "metric": 2})", "r:1: \"payload\": missing"},
      {R"({"at": "1", "metric": 2, "payload": ""})", "r:1: \"at\": expected seconds, a number"},
      {R"({"at": 1e999, "metric": 2, "payload": ""})", "r:1: \"at\": expected seconds, a number"},
      {R"({"at": -0.5, "metric": 2, "payload": ""})", "r:1: \"at\": expected seconds that are not negative"},
      {R"({"at": 1e10, "metric": 2, "payload": ""})", "r:1: \"at\": expected at most a billion seconds"},
      {R"({"at": 1, "metric": 2.5, "payload": ""})", metric},
      {R"({"at": 1, "metric": 9223372036854775808, "payload": ""})", metric},
      {R"({"at": 1, "metric": "0x8000000000000000", "payload": ""})", metric},
      {R"({"at": 1, "metric": "0x-1", "payload": ""})", metric},
      {R"({"at": 1, "metric": "255", "payload": ""})", metric},
      {R"({"at": 1, "metric": 2, "payload": 12})", "r:1: \"payload\": expected hex text"},
      {R"({"at": 1, "metric": 2, "payload": "089"})", "r:1: \"payload\": odd number of hex digits"},
      {R"({"at": 1, "metric": 2, "payload": "08g5"})", "r:1: \"payload\": character 3 is no hex digit"},
      {R"({"at": 1, "at": 1, "metric": 2, "payload": ""})", "r:1: \"at\": given twice"},
      {R"({"at": 1, "metric": 2, "payload": ""} x)", notClosed},
      {R"({"at": 1, "metric": 2, "payload": ""}})", "r:1: more than one object"},
      {R"({"at": 1 "metric": 2, "payload": ""})", notJson},
      {R"({"at": 1, "metric": 2, "payload": "08)", "r:1: a text has no closing quote: is the line cut off?"},
      {R"({"at": 1, "metric": 2, "payload": "08")", notClosed},
      {R"({"at": 1, "metric": 2, "payload": "", "more": 1e999})", "r:1: a number is beyond all bounds"},
      {R"({"at": 1, "metric": 2, "payload": "", "deep": )" + nested(500) + "}", "r:1: nested too deeply"},
      {R"({"deep": )" + std::string(1'000'000, '['), "r:1: nested too deeply"},
      {R"({"at": 1, "metric": 2, "payload": "\x"})", notJson},
      {"{\"at\": 1, \"metric\": 2, \"payload\": \"\0\"}"s, "r:1: a text holds a control character"},
      {"{\"at\": 1, \"metric\": 2, \"payload\": \"\xC0\"}", "r:1: not valid UTF-8"},
  };
  for (const auto& [line, read] : cases)
    EXPECT_EQ(readAll(line), std::vector<std::string>{read}) << line;
}

TEST(RecordingReader, RefusesControlCharactersWhereverTheyStandInAText) {
  std::string content;
  for (std::size_t place = 0; place < 40; ++place) {
    for (char control = 0; control < 0x20; ++control) {
      if (control == '\n') continue;
      std::string text(40, 'x');
      text[place] = control;
      content += R"({"at": 1, "metric": 2, "payload": "", "more": ")" + text + "\"}\n";
    }
  }
  const std::vector<std::string> read = readAll(content);
  EXPECT_EQ(read.size(), 40U * 31U);
  for (const std::string& line : read)
    EXPECT_TRUE(line.ends_with(": a text holds a control character")) << line;
}

TEST(RecordingReader, TellsDigitsFromAllOtherCharactersWhereverTheyStandInAPayload) {
  const std::string head = R"({"at": 1, "metric": 2, "payload": ")";
  const std::string allDigits = "0123456789abcdefABCDEF";
  EXPECT_EQ(readAll(head + allDigits + "\"}"), std::vector<std::string>{"1.0 2 0123456789abcdefabcdef"});
  for (std::size_t place = 0; place < allDigits.size(); ++place) {
    for (char character = ' '; character < 0x7F; ++character) {
      if (character == '"' || character == '\\') continue;
      std::string digits = allDigits;
      digits[place] = character;
      const bool isDigit = allDigits.find(character) != std::string::npos;
      const std::string read = readAll(head + digits + "\"}").front();
      EXPECT_EQ(read.ends_with("character " + std::to_string(place + 1) + " is no hex digit"), !isDigit) << read;
    }
  }
}

TEST(RecordingReader, NumbersLinesPassesOverBlankOnesAndGoesOnBehindBadOnes) {
  const std::string event = R"({"at": 1, "metric": 2, "payload": "01"})";
  EXPECT_EQ(readAll("\n \t\r\n" + event + "\nbad\n\n" + event),
            (std::vector<std::string>{"1.0 2 01", "r:4: no JSON object", "1.0 2 01"}));
  EXPECT_TRUE(readAll("").empty());
}

TEST(RecordingReader, ReadsLinesAsOtherSystemsEndAndMarkThem) {
  const std::string event = R"({"at": 1, "metric": 2, "payload": "01"})";
  const std::string mark = "\xEF\xBB\xBF";
  using Read = std::vector<std::string>;
  EXPECT_EQ(readAll(mark + event + "\r\n\r\n" + event + "\r\n" + event), (Read{"1.0 2 01", "1.0 2 01", "1.0 2 01"}));
  EXPECT_EQ(readAll(mark + "\r\n" + event), (Read{"1.0 2 01"}));
  EXPECT_EQ(readAll(mark), Read{});
  EXPECT_EQ(readAll(event + '\n' + mark + event), (Read{"1.0 2 01", "r:2: no JSON object"}));
  RecordingReader reader(fileWith(mark + event), "r");
  for (int lap = 0; lap < 2; ++lap) {
    EXPECT_EQ(textOf(reader.next()), "1.0 2 01");
    ASSERT_TRUE(reader.rewind());
  }
}

TEST(RecordingReader, EndsWhereTheEndIsWhenItComesThere) {
  const std::string event = R"({"at": 1, "metric": 2, "payload": ""})";
  FileDescriptor growing = fileWith(event + '\n' + event.substr(0, 9));
  const FileDescriptor writer(dup(growing.get()));
  RecordingReader reader(std::move(growing), "r");
  int reads = 0;
  reader.setBeforeRead([&](int) {
    // Behind the first read stands the rest of the line that was cut off, and one line more.
    if (++reads == 2) {
      const std::string rest = event.substr(9) + '\n' + event;
      EXPECT_EQ(pwrite(writer.get(), rest.data(), rest.size(), static_cast<off_t>(event.size()) + 10),
                static_cast<ssize_t>(rest.size()));
    }
    return true;
  });
  for (int line = 0; line < 3; ++line)
    EXPECT_EQ(textOf(reader.next()), "1.0 2 ") << line;
  EXPECT_EQ(textOf(reader.next()), "end");

  // One that was cut shorter meanwhile has its end there.
  ASSERT_TRUE(reader.rewind());
  EXPECT_EQ(ftruncate(writer.get(), static_cast<off_t>(event.size())), 0);
  EXPECT_EQ(textOf(reader.next()), "1.0 2 ");
  EXPECT_EQ(textOf(reader.next()), "end");
}

TEST(RecordingReader, GrowsForALongLineAndPassesOverOneBeyondTheLongest) {
  const std::string event = R"({"at": 1, "metric": 2, "payload": ")" + std::string(800, 'a') + "\"}";
  const std::string read = "1.0 2 " + std::string(800, 'a');
  const std::string tooLong(5000, 'x');
  const std::string digits(1'000'000, 'b');
  EXPECT_EQ(readAll(R"({"at": 1, "metric": 2, "payload": ")" + digits + "\"}\n" + event),
            (std::vector<std::string>{"1.0 2 " + digits, read}));
  EXPECT_EQ(readAll(tooLong + '\n' + event + '\n' + event + ' ' + '\n' + tooLong, event.size()),
            (std::vector<std::string>{"r:1: longer than a line may be", read, "r:3: longer than a line may be",
                                      "r:4: longer than a line may be"}));
}

TEST(RecordingReader, HandsOnACompleteLineWhileTheNextIsStillBeingWritten) {
  Pipe pipe;
  RecordingReader reader(std::move(pipe.reading), "pipe");
  std::vector<std::string_view> written = {"1}\n", R"({"at": 2, "metric": 3, "payload": )", "\"\"}\n{\"at\": 3"};
  reader.setBeforeRead([&](int) {
    if (written.empty()) {
      pipe.writing = FileDescriptor();
    } else {
      writeAll(pipe.writing, written.front());
      written.erase(written.begin());
    }
    return true;
  });
  EXPECT_EQ(textOf(reader.next()), "pipe:1: no JSON object");
  EXPECT_EQ(written.size(), 2U);
  EXPECT_EQ(textOf(reader.next()), "2.0 3 ");
  EXPECT_EQ(textOf(reader.next()), "pipe:3: does not end with the object's closing brace: is the line cut off?");
  EXPECT_EQ(textOf(reader.next()), "end");
  reader.setBeforeRead([](int) { return false; });
  EXPECT_EQ(textOf(reader.next()), "end") << "it may not read on";
}

TEST(RecordingReader, TellsWhyItCannotRead) {
  RecordingReader missing("/no/such/recording.jsonl");
  EXPECT_EQ(missing.failure(), "/no/such/recording.jsonl: No such file or directory");
  EXPECT_EQ(textOf(missing.next()), "/no/such/recording.jsonl: No such file or directory");
  EXPECT_EQ(RecordingReader("/tmp").failure(), "/tmp: Is a directory");
  EXPECT_EQ(RecordingReader("-").name(), "standard input");
}

TEST(RecordingReader, KnowsItsDurationAndTheWayBackUnlessItReadsAPipe) {
  RecordingReader file(fileWith("{\"at\": 1, \"metric\": 2, \"payload\": \"\"}\n"
                                "{\"at\": 61.5, \"metric\": 2, \"payload\": \"\"}\nbad\n\n"),
                       "file");
  EXPECT_EQ(file.duration(), 61.5);
  EXPECT_EQ(textOf(file.next()), "1.0 2 ");
  ASSERT_TRUE(file.rewind());
  EXPECT_EQ(textOf(file.next()), "1.0 2 ");
  EXPECT_EQ(file.lineNumber(), 1U);
  EXPECT_EQ(RecordingReader(fileWith("bad"), "file").duration(), std::nullopt);
  const std::string mark = "\xEF\xBB\xBF";
  EXPECT_EQ(RecordingReader(fileWith(mark + R"({"at": 3, "metric": 2, "payload": ""})"), "file").duration(), 3.0);

  Pipe pipe;
  RecordingReader live(std::move(pipe.reading), "pipe");
  EXPECT_EQ(live.duration(), std::nullopt);
  EXPECT_FALSE(live.rewind());
}

TEST(RecordedEvent, IsWrittenAsItIsRead) {
  const std::uint8_t payload[] = {0x08, 0x95};
  std::string lines;
  appendRecordedEvent(lines, {12.5, 0x3C4E04, payload});
  EXPECT_EQ(lines, "{\"at\": 12.5, \"metric\": \"0x3C4E04\", \"payload\": \"0895\"}\n");
  appendRecordedEvent(lines, {1e9, -7, {}});
  appendRecordedEvent(lines, {0, 0, {}});
  appendRecordedEvent(lines, {0.1, std::numeric_limits<std::int64_t>::max(), {}});
  EXPECT_EQ(readAll(lines),
            (std::vector<std::string>{"12.5 3952132 0895", "1000000000.0 -7 ", "0.0 0 ", "0.1 9223372036854775807 "}));
}

}  // namespace
}  // namespace vesk
