#include "recording_outcomes.h"

#include <algorithm>
#include <fcntl.h>
#include <span>
#include <sys/mman.h>
#include <unistd.h>

#include "property.h"
#include "recording/recording_reader.h"
#include "values/text_form.h"

namespace vesk {

namespace {

std::string textOf(const RecordedEvent& event) {
  std::string text;
  appendDecimal(text, event.at);
  text += ' ' + std::to_string(event.metricId) + ' ';
  appendHex(text, event.payload);
  return text;
}

std::string complaint(std::size_t line, std::string_view reason) {
  return "recording:" + std::to_string(line) + ": " + std::string(reason);
}

Outcomes read(RecordingReader& reader) {
  Outcomes outcomes;
  for (;;) {
    const RecordingReader::Step step = reader.next();
    if (std::holds_alternative<EndOfRecording>(step)) return outcomes;
    if (const auto* event = std::get_if<RecordedEvent>(&step)) {
      outcomes.push_back({reader.lineNumber(), textOf(*event)});
    } else if (const auto* bad = std::get_if<BadLine>(&step)) {
      outcomes.push_back({reader.lineNumber(), bad->message});
    } else {
      outcomes.push_back({reader.lineNumber(), reader.failure().value()});
      return outcomes;
    }
  }
}

/// What comes of a line when it is read alone, with bytes behind it that would go on with it.
std::string outcomeOf(std::string_view line, std::size_t number) {
  std::string padded(line);
  while (padded.size() < line.size() + RecordedEventParser::kPadding)
    padded += "7\"}, ";
  RecordedEventParser parser;
  const auto event = parser.parse(std::span(padded).first(line.size()));
  if (!event) return complaint(number, parser.reason());

  std::string written;
  appendRecordedEvent(written, *event);
  std::string text = textOf(*event);
  const Outcomes again = readFile(written, written.size());
  require(again.size() == 1 && again[0].text == text, "an event is written as it is read");
  return text;
}

}  // namespace

FileDescriptor fileOf(std::string_view content) {
  FileDescriptor file(memfd_create("recording", MFD_CLOEXEC));
  require(write(file.get(), content.data(), content.size()) == static_cast<ssize_t>(content.size()), "a file is there");
  lseek(file.get(), 0, SEEK_SET);
  return file;
}

Outcomes readFile(std::string_view content, std::size_t longestLine) {
  RecordingReader reader(fileOf(content), "recording", longestLine);
  Outcomes outcomes = read(reader);
  require(reader.rewind() && read(reader) == outcomes, "a recording reads the same from its start again");
  return outcomes;
}

Outcomes readPipe(std::string_view content, std::size_t longestLine, std::size_t pieceSize) {
  int ends[2];
  require(pipe2(ends, O_CLOEXEC) == 0, "a pipe is there");
  FileDescriptor reading(ends[0]);
  FileDescriptor writing(ends[1]);
  RecordingReader reader(std::move(reading), "recording", longestLine);
  reader.setBeforeRead([&](int) {
    const std::string_view piece = content.substr(0, pieceSize);
    content.remove_prefix(piece.size());
    if (piece.empty()) {
      writing = FileDescriptor();
    } else {
      require(write(writing.get(), piece.data(), piece.size()) == static_cast<ssize_t>(piece.size()),
              "a pipe has room");
    }
    return true;
  });
  return read(reader);
}

Outcomes expectedOutcomes(std::string_view content, std::size_t longestLine) {
  Outcomes outcomes;
  for (std::size_t number = 1; !content.empty(); ++number) {
    const std::size_t end = std::min(content.find('\n'), content.size());
    std::string_view line = content.substr(0, end);
    content.remove_prefix(std::min(end + 1, content.size()));
    if (line.size() > longestLine) {
      outcomes.push_back({number, complaint(number, "longer than a line may be")});
      continue;
    }
    if (number == 1 && line.starts_with("\xEF\xBB\xBF")) line.remove_prefix(3);
    if (line.find_first_not_of(" \t\r") == std::string_view::npos) continue;
    outcomes.push_back({number, outcomeOf(line, number)});
  }
  return outcomes;
}

}  // namespace vesk
