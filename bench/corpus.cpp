#include "bench/corpus.h"

#include <algorithm>
#include <random>
#include <variant>

#include "bench/stop.h"
#include "handset/handset.h"
#include "intake/metric_table.h"
#include "recording/recording_reader.h"

namespace vesk::bench {

namespace {

/// 2026-01-01 00:00:00 UTC.
constexpr std::uint64_t kStartMs = 1767225600000;
constexpr std::uint64_t kDrives = 12;
/// Long enough for a way through the tunnel, where the handset leaves LTE.
constexpr std::int64_t kDriveMs = 240'000;

/// What drives told, sorted by kind.
class Pool {
 public:
  void add(const handset::HandsetEvent& event) {
    if (findHandledMetric(event.id) == nullptr) return;
    const Kind* kind = findKind(event.id);
    const auto place = std::find_if(kinds_.begin(), kinds_.end(), [&](const Told& told) { return told.kind == kind; });
    (place != kinds_.end() ? *place : kinds_.emplace_back(Told{kind, {}})).payloads.push_back(event.payload);
  }

  [[nodiscard]] std::size_t kindCount() const { return kinds_.size(); }

  [[nodiscard]] Event draw(std::mt19937& random, double at) const {
    const Told& told = kinds_[random() % kinds_.size()];
    return {at, told.kind, told.payloads[random() % told.payloads.size()].bytes()};
  }

 private:
  struct Told {
    const Kind* kind;
    std::vector<Data> payloads;
  };

  std::vector<Told> kinds_;
};

Pool drivePool() {
  Pool pool;
  for (std::uint64_t seed = 1; seed <= kDrives; ++seed) {
    handset::Handset handset(seed, kStartMs);
    for (handset::HandsetEvent event = handset.next(); event.atMs <= kDriveMs; event = handset.next()) {
      if (event.kind == handset::HandsetEvent::Kind::metric) pool.add(event);
    }
    pool.add(handset.simFiles());
  }
  return pool;
}

std::size_t totalSize(std::span<const Event> events) {
  std::size_t size = 0;
  for (const Event& event : events)
    size += event.payload.size();
  return size;
}

}  // namespace

Corpus::Corpus(std::span<const Event> events) {
  payloads_.reserve(totalSize(events));
  events_.reserve(events.size());
  for (const Event& event : events) {
    const std::uint8_t* start = payloads_.data() + payloads_.size();
    payloads_.insert(payloads_.end(), event.payload.begin(), event.payload.end());
    events_.push_back({event.at, event.kind, {start, event.payload.size()}});
  }
}

Corpus mixedCorpus(std::size_t count) {
  const Pool pool = drivePool();
  if (pool.kindCount() != kHandledMetricCount) {
    stop("the simulated drives have " + std::to_string(pool.kindCount()) + " kinds of metric, not all " +
         std::to_string(kHandledMetricCount));
  }
  std::mt19937 random(1);
  std::vector<Event> events;
  events.reserve(count);
  for (std::size_t index = 0; index < count; ++index)
    events.push_back(pool.draw(random, static_cast<double>(index) / 100));
  return Corpus(events);
}

Corpus recordedCorpus(const std::string& path) {
  RecordingReader reader(path);
  std::vector<std::vector<std::uint8_t>> payloads;
  std::vector<Event> events;
  for (auto step = reader.next(); !std::holds_alternative<EndOfRecording>(step); step = reader.next()) {
    if (const auto* failure = std::get_if<ReadFailure>(&step)) stop(failure->message);
    if (const auto* bad = std::get_if<BadLine>(&step)) stop(bad->message);
    const auto& event = std::get<RecordedEvent>(step);
    const Kind* kind = findKind(event.metricId);
    if (kind == nullptr) continue;
    const auto& payload = payloads.emplace_back(event.payload.begin(), event.payload.end());
    // A vector that moves keeps its bytes where they are.
    events.push_back({event.at, kind, payload});
  }
  if (events.empty()) stop(path + ": no event of it has a class");
  return Corpus(events);
}

}  // namespace vesk::bench
