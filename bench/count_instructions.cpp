// count_instructions [RECORDING]: takes every row once over the short mixed recording, or over another one, so that
// callgrind counts its instructions: one dump for each row, marked with the row's name and the number of events. To be
// run with --instr-atstart=no.

#include <string>
#include <valgrind/callgrind.h>

#include "bench/rows.h"

int main(int argc, char** argv) {
  using namespace vesk::bench;
  const Corpus corpus = argc > 1 ? recordedCorpus(argv[1]) : mixedCorpus(kShortRecording);
  const std::string events = std::to_string(corpus.events().size());
  for (const Row& row : rowsOver(corpus)) {
    // The first pass makes what is made once and binds what is bound at the first call.
    row.pass();
    CALLGRIND_START_INSTRUMENTATION;
    row.pass();
    CALLGRIND_STOP_INSTRUMENTATION;
    const std::string mark = std::string(row.name) + ' ' + events;
    CALLGRIND_DUMP_STATS_AT(mark.c_str());
  }
}
