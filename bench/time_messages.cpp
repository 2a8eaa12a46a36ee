// time_messages [--facts] [--recording FILE]: times every row over the mixed events, or over a recording. --facts
// writes the least disturbed repetition of each row for the table; without it, Google Benchmark says what it measured.
// Its own options are taken too.

#include <algorithm>
#include <benchmark/benchmark.h>
#include <iostream>
#include <optional>
#include <string>
#include <vector>

#include "bench/agreement.h"
#include "bench/fact.h"
#include "bench/rows.h"

namespace vesk::bench {
namespace {

/// A row over a corpus, and the best of its repetitions.
struct Timing {
  const Corpus* corpus;
  Row row;
  std::optional<double> nsPerPass;

  [[nodiscard]] std::size_t events() const { return corpus->events().size(); }
  [[nodiscard]] std::string name() const { return std::string(row.name) + '/' + std::to_string(events()); }
};

void registerTiming(const Timing& timing) {
  benchmark::RegisterBenchmark(timing.name().c_str(), [&timing](benchmark::State& state) {
    for ([[maybe_unused]] auto _ : state)
      timing.row.pass();
    const auto passes = static_cast<std::int64_t>(state.iterations());
    state.SetItemsProcessed(passes * static_cast<std::int64_t>(timing.events()));
    state.SetBytesProcessed(passes * static_cast<std::int64_t>(timing.corpus->bytes()));
  });
}

/// Keeps the least processor time of each row: whatever else the machine does can only add to it.
class BestOfRepetitions : public benchmark::BenchmarkReporter {
 public:
  explicit BestOfRepetitions(std::vector<Timing>& timings) : timings_(timings) {}

  bool ReportContext(const Context& /*context*/) override { return true; }
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& run : runs) {
      if (run.run_type != Run::RT_Iteration) continue;
      const double nsPerPass = run.cpu_accumulated_time * 1e9 / static_cast<double>(run.iterations);
      const auto timing = std::find_if(timings_.begin(), timings_.end(),
                                       [&](const Timing& each) { return each.name() == run.run_name.function_name; });
      timing->nsPerPass = std::min(timing->nsPerPass.value_or(nsPerPass), nsPerPass);
    }
  }

 private:
  std::vector<Timing>& timings_;
};

void writeFacts(const std::vector<Timing>& timings) {
  for (const Timing& timing : timings) {
    if (!timing.nsPerPass) continue;
    writeFact(timing.row.name, timing.events(), "ns", *timing.nsPerPass / static_cast<double>(timing.events()));
    writeFact(timing.row.name, timing.events(), "MB/s",
              static_cast<double>(timing.corpus->bytes()) / *timing.nsPerPass * 1e3);
  }
}

std::vector<Timing> timingsOver(const std::vector<Corpus>& corpora) {
  std::vector<Timing> timings;
  for (const Corpus& corpus : corpora) {
    for (Row& row : rowsOver(corpus))
      timings.push_back({&corpus, std::move(row), std::nullopt});
  }
  return timings;
}

void timeMessages(const std::vector<Corpus>& corpora, bool asFacts) {
  requireAgreement(corpora.back());
  std::vector<Timing> timings = timingsOver(corpora);
  for (const Timing& timing : timings)
    registerTiming(timing);
  if (!asFacts) {
    benchmark::RunSpecifiedBenchmarks();
    return;
  }
  BestOfRepetitions reporter(timings);
  benchmark::RunSpecifiedBenchmarks(&reporter);
  const Corpus& longest = corpora.back();
  const auto count = static_cast<double>(longest.events().size());
  writeFact("message", longest.events().size(), "bytes", static_cast<double>(longest.bytes()) / count);
  writeFacts(timings);
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  using namespace vesk::bench;
  benchmark::Initialize(&argc, argv);
  std::vector<std::string> options(argv + 1, argv + argc);
  const bool asFacts = std::erase(options, "--facts") > 0;
  if (!options.empty() && (options.size() != 2 || options[0] != "--recording")) {
    std::cerr << "usage: time_messages [--facts] [--recording FILE]\n";
    return 2;
  }
  std::vector<Corpus> corpora;
  if (options.empty()) {
    corpora.push_back(mixedCorpus(kShortRecording));
    corpora.push_back(mixedCorpus(kLongRecording));
  } else {
    corpora.push_back(recordedCorpus(options[1]));
  }
  timeMessages(corpora, asFacts);
}
