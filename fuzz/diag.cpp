// The first byte says into what pieces the others come. They are read as frames and as a list of packets, and each
// frame's content also when it is framed anew.

#include <algorithm>
#include <string>
#include <vector>

#include "diag/framing/frame_reader.h"
#include "diag/framing/packet_list_reader.h"
#include "diag/receiver.h"
#include "messages/registry/metric_classes.h"
#include "property.h"

namespace vesk::diag {

namespace {

using Bytes = std::vector<std::uint8_t>;
using Contents = std::vector<Bytes>;

const Bytes kGoodContent = {0x73, 0x01};

void check(std::span<const Event> events) {
  for (const Event& event : events) {
    const MetricClass* metricClass = findMetricClass(event.metricId);
    require(metricClass != nullptr && metricClass->decode(event.payload), "an event is one that can be decoded");
  }
}

/// Gives `bytes` to the reader in pieces, and all that it finds to `use`.
template <class Reader, class Use>
void readAll(Reader& reader, std::span<const std::uint8_t> bytes, std::size_t pieceSize, Use use) {
  for (; !bytes.empty(); bytes = bytes.subspan(std::min(pieceSize, bytes.size()))) {
    reader.take(bytes.first(std::min(pieceSize, bytes.size())));
    while (const auto found = reader.next())
      use(*found);
  }
}

Contents readFrames(std::span<const std::uint8_t> bytes, std::size_t pieceSize) {
  Contents contents;
  FrameReader reader;
  Receiver receiver(std::nullopt);
  readAll(reader, bytes, pieceSize, [&](const Frame& frame) {
    if (frame.isSound) check(receiver.take(readPacket(frame.content)));
    contents.emplace_back(frame.content.begin(), frame.content.end());
  });
  return contents;
}

}  // namespace

}  // namespace vesk::diag

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace vesk::diag;
  if (size == 0) return 0;
  const std::span bytes(data + 1, size - 1);
  const Contents contents = readFrames(bytes, bytes.size() + 1);
  vesk::require(readFrames(bytes, 1 + data[0]) == contents, "the pieces in which bytes come do not matter");

  // What is no frame may be the content of one: that is how a layout is reached without its checksum.
  Bytes framed(bytes.begin(), bytes.end());
  framed.push_back(kFrameEnd);
  if (!bytes.empty()) appendFrame(framed, bytes);
  appendFrame(framed, kGoodContent);
  const Contents surrounded = readFrames(framed, framed.size());
  const bool isRead = bytes.empty() || *(surrounded.end() - 2) == Bytes(bytes.begin(), bytes.end());
  vesk::require(isRead && surrounded.back() == kGoodContent, "a frame is read whatever stands before it");

  PacketListReader list;
  Receiver receiver(std::nullopt);
  readAll(list, bytes, 1 + data[0], [&receiver](const LogPacket& packet) { check(receiver.take(packet)); });
  return 0;
}
