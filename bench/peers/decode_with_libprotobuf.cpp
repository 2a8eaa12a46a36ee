// decode_with_libprotobuf RECORDING: what `vesk decode` does, with the same reader of recordings and the same output,
// but with libprotobuf's classes and its reflection.

#include <cstdio>
#include <string>
#include <variant>

#include "app/output/data_output.h"
#include "bench/kinds.h"
#include "bench/stop.h"
#include "recording/recording_reader.h"
#include "values/json_form.h"
#include "values/text_form.h"

namespace vesk::bench {
namespace {

void appendDecoded(std::string& out, ReflectionWalk& walk, const Kind& kind, std::span<const std::uint8_t> payload) {
  appendJson(out, kind.name);
  const std::size_t end = out.size();
  out += R"(,"status":"decoded","fields":)";
  if (kind.libprotobuf.readIntoJsonByReflection(payload, walk, out)) return;
  out.resize(end);
  out += R"(,"status":"undecodable","fields":null)";
}

void appendDecodedEvent(std::string& out, ReflectionWalk& walk, const RecordedEvent& event) {
  out += "{\"at\":";
  appendDecimal(out, event.at);
  out += ",\"metric\":";
  appendMetricId(out, event.metricId);
  out += ",\"class\":";
  if (const Kind* kind = findKind(event.metricId)) {
    appendDecoded(out, walk, *kind, event.payload);
  } else {
    out += R"(null,"status":"ignored","fields":null)";
  }
  out += '}';
}

Outcome decode(const std::string& path) {
  RecordingReader reader(path);
  DataOutput output;
  std::string line;
  ReflectionWalk walk;
  for (auto step = reader.next(); !std::holds_alternative<EndOfRecording>(step); step = reader.next()) {
    if (const auto* failure = std::get_if<ReadFailure>(&step)) stop(failure->message);
    if (const auto* bad = std::get_if<BadLine>(&step)) stop(bad->message);
    line.clear();
    appendDecodedEvent(line, walk, std::get<RecordedEvent>(step));
    output.writeLine(line);
  }
  return output.finish(Outcome::done);
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fputs("usage: decode_with_libprotobuf RECORDING\n", stderr);
    return 2;
  }
  return static_cast<int>(vesk::bench::decode(argv[1]));
}
