#include "hostile_recording.h"

#include <cstdint>
#include <memory>

#include "filled_message.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_of_message.h"
#include "recording/recorded_event.h"
#include "support/metric_events.h"

namespace vesk {

namespace {

using namespace metrics;

constexpr std::size_t kLongest = 65536;

std::string repeatedTo(std::size_t size, std::string_view text) {
  std::string whole;
  while (whole.size() + text.size() <= size)
    whole += text;
  return whole;
}

Data dataOf(std::string_view bytes) {
  return Data::copy({reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
}

using Events = std::vector<HostileEvent>;

template <class Message>
void add(Events& events, const Message& message) {
  events.push_back({kMetricId<Message>, encoded(message)});
}

void addFiles(Events& events) {
  KCellularSimCardFiles files;
  for (const std::size_t size : {kLongest, std::size_t{0}, std::size_t{1}, kLongest - 1}) {
    auto file = std::make_shared<ElementaryFile>();
    file->setEfId(0x6F07);
    file->setContent(dataOf(repeatedTo(size, "\x1B")));
    files.addEfList(file);
  }
  add(events, files);
  KCellularSimCardFiles many;
  for (std::uint32_t number = 0; number < 500; ++number) {
    many.addEfList(std::make_shared<ElementaryFile>());
    many.efListAtIndex(number)->setEfId(0xFFFFFFFF - number);
  }
  add(events, many);
}

void addTexts(Events& events) {
  KCellularActivatedBearerContexts bearers;
  for (const std::size_t size : {std::size_t{64}, kLongest / 8}) {
    for (const std::string_view text : kHostileTexts) {
      auto bearer = std::make_shared<BearerContext>();
      bearer->setApn(Text::copy(repeatedTo(size, text)));
      bearer->setPdpAddr(dataOf(text));
      bearers.addBearerContexts(bearer);
      KCellularLteRsrpRsrqSinr levels;
      levels.setCallId(Text::copy(repeatedTo(size, text)));
      add(events, levels);
    }
  }
  bearers.bearerContextsAtIndex(0)->setApn(Text::copy(repeatedTo(kLongest, kHostileTexts[0])));
  add(events, bearers);
}

void addNumbers(Events& events) {
  KCellularLteSelReselCellInfo bands;
  for (std::uint32_t number = 0; number < 20000; ++number)
    bands.addMultiBandInfo(0xFFFFFFFF - number);
  add(events, bands);
}

}  // namespace

std::vector<HostileEvent> hostileEvents() {
  Events events;
  addFiles(events);
  addTexts(events);
  addNumbers(events);
  for (std::int64_t id = 0; id < 0x10000; ++id) {
    const std::int64_t metricId = 0x3C0000 | id;
    const MetricClass* metricClass = findMetricClass(metricId);
    if (metricClass == nullptr) continue;
    for (const Filling filling : {Filling::small, Filling::extreme}) {
      Bytes payload = filledMessage(metricClass->name, filling).payload;
      events.push_back({metricId, Data::copy(payload)});
      payload.pop_back();
      events.push_back({metricId, Data::copy(payload)});
    }
    events.push_back({metricId, Data()});
  }
  events.push_back({-1, Data()});
  return events;
}

std::string hostileRecording() {
  std::string lines;
  double at = 0;
  for (const auto& [metricId, payload] : hostileEvents())
    appendRecordedEvent(lines, {at += 0.1, metricId, payload.bytes()});
  return lines;
}

}  // namespace vesk
