#include "recording/recording_reader.h"

#include <algorithm>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "values/utf8.h"

namespace vesk {

namespace {

/// How far from the end of a file its last event is looked for.
constexpr off_t kTail = 65536;

std::string_view asText(std::span<char> line) {
  return {line.data(), line.size()};
}

/// What a recording starts with is no part of its first line.
std::span<char> withoutByteOrderMark(std::span<char> line) {
  return line.subspan(byteOrderMarkSize(asText(line)));
}

bool isBlank(std::string_view line) {
  return line.find_first_not_of(" \t\r") == std::string_view::npos;
}

}  // namespace

RecordingReader::RecordingReader(const std::string& path) : RecordingReader(ByteInput(path)) {}

RecordingReader::RecordingReader(FileDescriptor descriptor, std::string name, std::size_t longestLine)
    : RecordingReader(ByteInput(std::move(descriptor), std::move(name)), longestLine) {}

RecordingReader::RecordingReader(ByteInput input, std::size_t longestLine)
    : lines_(std::move(input), RecordedEventParser::kPadding, longestLine) {}

RecordingReader::Step RecordingReader::next() {
  if (failure()) return ReadFailure{*failure()};
  for (;;) {
    switch (lines_.next()) {
      case LineReader::Found::end:
        return EndOfRecording{};
      case LineReader::Found::failure:
        return ReadFailure{*failure()};
      case LineReader::Found::tooLongLine:
        return badLine("longer than a line may be");
      case LineReader::Found::line:
        break;
    }
    std::span<char> line = lines_.line();
    if (lines_.lineNumber() == 1) line = withoutByteOrderMark(line);
    if (isBlank(asText(line))) continue;
    if (const std::optional<RecordedEvent> event = parser_.parse(line)) return *event;
    return badLine(parser_.reason());
  }
}

std::optional<double> RecordingReader::duration() const {
  struct stat status {};
  if (fstat(lines_.input().descriptor(), &status) != 0 || !S_ISREG(status.st_mode)) return std::nullopt;
  const off_t start = std::max<off_t>(0, status.st_size - kTail);
  std::string tail(static_cast<std::size_t>(status.st_size - start), '\0');
  const ssize_t count = pread(lines_.input().descriptor(), tail.data(), tail.size(), start);
  if (count < 0) return std::nullopt;
  const auto size = static_cast<std::size_t>(count);
  tail.resize(size + RecordedEventParser::kPadding);

  RecordedEventParser parser;
  std::span<char> rest(tail.data(), size);
  if (start == 0) rest = withoutByteOrderMark(rest);
  while (!rest.empty()) {
    const std::size_t lineFeed = asText(rest).rfind('\n');
    const std::size_t lineStart = lineFeed == std::string_view::npos ? 0 : lineFeed + 1;
    if (const auto event = parser.parse(rest.subspan(lineStart))) return event->at;
    rest = rest.first(lineStart == 0 ? 0 : lineFeed);
  }
  return std::nullopt;
}

BadLine RecordingReader::badLine(std::string_view reason) const {
  return BadLine{name() + ':' + std::to_string(lines_.lineNumber()) + ": " + std::string(reason)};
}

}  // namespace vesk
