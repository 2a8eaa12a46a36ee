#include "bench/rows.h"

#include <array>
#include <benchmark/benchmark.h>
#include <memory>
#include <string>

#include "insight/insight.h"
#include "intake/metric_validator.h"
#include "messages/codec/proto_writer.h"
#include "system/output_lines.h"

namespace vesk::bench {

namespace {

/// Objects as the writing rows find them: all made beforehand.
template <class Held>
struct Made {
  const Kind* kind;
  Held message;
};

template <class Held>
using MadeList = std::shared_ptr<std::vector<Made<Held>>>;

template <class Held, class Make>
MadeList<Held> makeAll(const Corpus& corpus, Make make) {
  auto all = std::make_shared<std::vector<Made<Held>>>();
  all->reserve(corpus.events().size());
  for (const Event& event : corpus.events())
    all->push_back({event.kind, make(event)});
  return all;
}

/// A pass that gives each event to `take`.
template <class Take>
std::function<void()> each(const Corpus& corpus, Take take) {
  return [&corpus, take]() mutable {
    for (const Event& event : corpus.events())
      take(event);
  };
}

/// JSON text is appended to one string, which is emptied for each event and keeps its room.
template <class Append>
std::function<void()> eachIntoJson(const Corpus& corpus, Append append) {
  return each(corpus, [append, json = std::string()](const Event& event) mutable {
    json.clear();
    append(event, json);
    benchmark::DoNotOptimize(json.data());
  });
}

Row readingInArena(const Corpus& corpus) {
  // More than the largest message takes.
  using Block = std::array<char, 65536>;
  struct Room {
    std::unique_ptr<Block> block = std::make_unique<Block>();
    google::protobuf::Arena arena{block->data(), block->size()};
  };
  return {"read/libprotobuf-arena", each(corpus, [room = std::make_shared<Room>()](const Event& event) {
            event.kind->libprotobuf.readInArena(event.payload, room->arena);
            room->arena.Reset();
          })};
}

Row writingOurs(const Corpus& corpus) {
  const auto all = makeAll<std::shared_ptr<ProtoCodable>>(
      corpus, [](const Event& event) { return event.kind->ours.make(event.payload); });
  return {"write/vesk", [all, writer = std::make_shared<ProtoWriter>()] {
            for (const auto& [kind, message] : *all)
              benchmark::DoNotOptimize(kind->ours.write(*message, *writer));
          }};
}

Row writingLibprotobufs(const Corpus& corpus) {
  const auto all = makeAll<std::unique_ptr<LibprotobufMessage>>(
      corpus, [](const Event& event) { return event.kind->libprotobuf.make(event.payload); });
  return {"write/libprotobuf", [all] {
            for (const auto& [kind, message] : *all)
              benchmark::DoNotOptimize(kind->libprotobuf.write(*message));
          }};
}

/// An event as the link hands it on goes into the stores, and `insight`, unless null, learns what it means.
Row takingIn(std::string_view name, const Corpus& corpus, const std::shared_ptr<insight::Insight>& insight) {
  OutputLines::setSink(nullptr);
  const auto intake = MetricValidator::listeningTo(nullptr);
  auto events = std::make_shared<std::vector<Dictionary>>();
  for (const Event& event : corpus.events())
    events->push_back({{"kKeyMetricID"_text, event.kind->metricId}, {"kKeyPayload"_text, Data::copy(event.payload)}});
  if (insight != nullptr) insight->observeEventsOf(*intake);
  return {name, [intake, events, insight] {
            for (const Dictionary& event : *events)
              benchmark::DoNotOptimize(intake->validateMetric(event));
          }};
}

}  // namespace

std::vector<Row> rowsOver(const Corpus& corpus) {
  return {
      {"read/vesk", each(corpus, [](const Event& event) { event.kind->ours.read(event.payload); })},
      {"read/libprotobuf-heap",
       each(corpus, [](const Event& event) { event.kind->libprotobuf.readOnHeap(event.payload); })},
      readingInArena(corpus),
      {"read/protozero-visit",
       each(corpus, [](const Event& event) { benchmark::DoNotOptimize(event.kind->visitByProtozero(event.payload)); })},
      writingOurs(corpus),
      writingLibprotobufs(corpus),
      {"dictionary/vesk", each(corpus, [](const Event& event) { event.kind->ours.readIntoDictionary(event.payload); })},
      {"dictionary/vesk-json",
       eachIntoJson(corpus,
                    [](const Event& event, std::string& json) { event.kind->ours.readIntoJson(event.payload, json); })},
      {"dictionary/libprotobuf-walk",
       eachIntoJson(corpus,
                    [walk = ReflectionWalk()](const Event& event, std::string& json) mutable {
                      event.kind->libprotobuf.readIntoJsonByReflection(event.payload, walk, json);
                    })},
      {"dictionary/libprotobuf-utility", eachIntoJson(corpus,
                                                      [](const Event& event, std::string& json) {
                                                        event.kind->libprotobuf.readIntoJsonByUtility(event.payload,
                                                                                                      json);
                                                      })},
      takingIn("intake/vesk", corpus, nullptr),
      takingIn("intake/vesk-insight", corpus, std::make_shared<insight::Insight>()),
  };
}  // NOLINT(clang-analyzer-cplusplus.NewDeleteLeaks): the functions own what they hold

}  // namespace vesk::bench
