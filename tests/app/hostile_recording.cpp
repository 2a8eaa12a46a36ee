#include "app/hostile_recording.h"

#include <cstdint>
#include <memory>

#include "messages/filled_message.h"
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

/// Writes the lines one after another, a tenth of a second apart.
class Recording {
 public:
  void add(std::int64_t metricId, std::span<const std::uint8_t> payload) {
    appendRecordedEvent(lines, {static_cast<double>(++events_) / 10, metricId, payload});
  }
  template <class Message>
  void add(const Message& message) {
    add(kMetricId<Message>, encoded(message).bytes());
  }

  std::string lines;

 private:
  int events_ = 0;
};

void addFiles(Recording& recording) {
  KCellularSimCardFiles files;
  for (const std::size_t size : {kLongest, std::size_t{0}, std::size_t{1}, kLongest - 1}) {
    auto file = std::make_shared<ElementaryFile>();
    file->setEfId(0x6F07);
    file->setContent(dataOf(repeatedTo(size, "\x1B")));
    files.addEfList(file);
  }
  recording.add(files);
  KCellularSimCardFiles many;
  for (std::uint32_t number = 0; number < 500; ++number) {
    many.addEfList(std::make_shared<ElementaryFile>());
    many.efListAtIndex(number)->setEfId(0xFFFFFFFF - number);
  }
  recording.add(many);
}

void addTexts(Recording& recording) {
  KCellularActivatedBearerContexts bearers;
  for (const std::size_t size : {std::size_t{64}, kLongest / 8}) {
    for (const std::string_view text : kHostileTexts) {
      auto bearer = std::make_shared<BearerContext>();
      bearer->setApn(Text::copy(repeatedTo(size, text)));
      bearer->setPdpAddr(dataOf(text));
      bearers.addBearerContexts(bearer);
      KCellularLteRsrpRsrqSinr levels;
      levels.setCallId(Text::copy(repeatedTo(size, text)));
      recording.add(levels);
    }
  }
  bearers.bearerContextsAtIndex(0)->setApn(Text::copy(repeatedTo(kLongest, kHostileTexts[0])));
  recording.add(bearers);
}

void addNumbers(Recording& recording) {
  KCellularLteSelReselCellInfo bands;
  for (std::uint32_t number = 0; number < 20000; ++number)
    bands.addMultiBandInfo(0xFFFFFFFF - number);
  recording.add(bands);
}

}  // namespace

std::string hostileRecording() {
  Recording recording;
  addFiles(recording);
  addTexts(recording);
  addNumbers(recording);
  for (std::int64_t id = 0; id < 0x10000; ++id) {
    const std::int64_t metricId = 0x3C0000 | id;
    const MetricClass* metricClass = findMetricClass(metricId);
    if (metricClass == nullptr) continue;
    for (const Filling filling : {Filling::small, Filling::extreme}) {
      Bytes payload = filledMessage(metricClass->name, filling).payload;
      recording.add(metricId, payload);
      payload.pop_back();
      recording.add(metricId, payload);
    }
    recording.add(metricId, {});
  }
  recording.add(-1, {});
  return recording.lines;
}

}  // namespace vesk
