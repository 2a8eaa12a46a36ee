#include <benchmark/benchmark.h>
#include <cstdio>
#include <string>

#include "agreement.h"
#include "rows.h"

namespace vesk::bench {
namespace {

void registerRows(const Corpus& corpus) {
  for (const Row& row : rowsOver(corpus)) {
    const auto count = static_cast<std::int64_t>(corpus.events().size());
    const auto measure = [row, count, bytes = static_cast<std::int64_t>(corpus.bytes())](benchmark::State& state) {
      for ([[maybe_unused]] auto _ : state)
        row.pass();
      state.SetItemsProcessed(count * static_cast<std::int64_t>(state.iterations()));
      state.SetBytesProcessed(bytes * static_cast<std::int64_t>(state.iterations()));
    };
    benchmark::RegisterBenchmark((std::string(row.name) + '/' + std::to_string(count)).c_str(), measure);
  }
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  using namespace vesk::bench;
  benchmark::Initialize(&argc, argv);
  const Corpus shortOne = mixedCorpus(kShortRecording);
  const Corpus longOne = mixedCorpus(kLongRecording);
  requireAgreement(longOne);
  std::printf("mean message: %.1f bytes\n", static_cast<double>(longOne.bytes()) / static_cast<double>(kLongRecording));
  registerRows(shortOne);
  registerRows(longOne);
  benchmark::RunSpecifiedBenchmarks();
}
