// write_recording COUNT: writes a recording of that many mixed events.

#include <charconv>
#include <cstdio>
#include <cstring>
#include <string>

#include "bench/corpus.h"
#include "bench/stop.h"
#include "recording/recorded_event.h"

int main(int argc, char** argv) {
  using namespace vesk::bench;
  std::size_t count = 0;
  if (argc != 2 || std::from_chars(argv[1], argv[1] + std::strlen(argv[1]), count).ec != std::errc{}) {
    std::fputs("usage: write_recording COUNT\n", stderr);
    return 2;
  }
  const Corpus corpus = mixedCorpus(count);
  std::string line;
  for (const Event& event : corpus.events()) {
    line.clear();
    vesk::appendRecordedEvent(line, {event.at, event.kind->metricId, event.payload});
    std::fputs(line.c_str(), stdout);
  }
  if (std::fflush(stdout) != 0) stop("the recording cannot be written");
}
