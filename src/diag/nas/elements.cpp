#include "diag/nas/elements.h"

#include <algorithm>
#include <iterator>

#include "diag/translation/event_batch.h"

namespace vesk::diag {

using namespace metrics;

std::optional<ByteSpan> Elements::find(std::uint8_t id) const {
  constexpr std::uint8_t kFirstOfOneByte = 0x80;
  ByteReader reader(bytes_);
  for (std::size_t at = 0; at < bytes_.size();) {
    const std::uint8_t found = bytes_[at++];
    if (found >= kFirstOfOneByte) continue;
    std::size_t size = 0;
    if (const auto fixed = fixedSize(found)) {
      size = *fixed;
    } else {
      size = reader.byte(at++);
    }
    const ByteSpan value = reader.part(at, size);
    if (reader.isCutOff()) break;
    if (found == id) return value;
    at += size;
  }
  return std::nullopt;
}

std::optional<std::uint8_t> Elements::fixedSize(std::uint8_t id) const {
  const auto fixed = std::find_if(fixed_.begin(), fixed_.end(), [id](const FixedElement& row) { return row.id == id; });
  if (fixed == fixed_.end()) return std::nullopt;
  return fixed->size;
}

std::uint32_t bigEndian(ByteSpan bytes) {
  return ByteReader(bytes).bigEndian(0, bytes.size());
}

std::shared_ptr<KCellularLocationAreaId> locationArea(std::span<const std::uint8_t, 5> bytes) {
  auto area = makeMessage<KCellularLocationAreaId>();
  area->setEncodedPlmn(Data::copy(bytes.first<3>()));
  area->setLac(bigEndian(bytes.last<2>()));
  return area;
}

std::optional<std::uint32_t> temporaryIdentity(ByteSpan element) {
  constexpr unsigned kTemporary = 4;
  if (element.size() != 5 || (element[0] & 7U) != kTemporary) return std::nullopt;
  return bigEndian(element.last(4));
}

void addEquivalentNetworks(const Elements& elements, EventBatch& events) {
  constexpr std::uint8_t kNetworksElement = 0x4A;
  const auto networks = elements.find(kNetworksElement);
  if (!networks) return;
  KCellularMmCommonInfo info;
  for (ByteSpan rest = *networks; rest.size() >= 3; rest = rest.subspan(3)) {
    auto plmn = makeMessage<Plmn>();
    plmn->setEncodedPlmn(Data::copy(rest.first(3)));
    info.addEplmnList(std::move(plmn));
  }
  events.add(info);
}

std::optional<TrackingAreas> readTrackingAreas(ByteSpan bytes) {
  // Of each part of a list: one network with areas of any number, with areas that follow each other, or many networks.
  enum Type : unsigned { anyAreas, consecutiveAreas, anyNetworks, endOfList };
  TrackingAreas areas;
  areas.list.emplace();
  ByteReader reader(bytes);
  for (std::size_t at = 0; at < bytes.size();) {
    const std::uint8_t header = bytes[at++];
    const unsigned type = header >> 5 & 3U;
    const unsigned count = (header & 31U) + 1;
    if (type == endOfList) break;
    Data plmn;
    std::uint32_t tac = 0;
    for (unsigned index = 0; index < count; ++index) {
      if (index == 0 || type == anyNetworks) {
        plmn = Data::copy(reader.part(at, 3));
        at += 3;
      }
      if (index == 0 || type != consecutiveAreas) {
        tac = reader.bigEndian(at, 2);
        at += 2;
      } else {
        ++tac;
      }
      if (reader.isCutOff()) return std::nullopt;
      auto area = makeMessage<KCellularTrackingAreaId>();
      area->setEncodedPlmn(plmn);
      area->setTac(tac);
      areas.list->push_back(std::move(area));
    }
  }
  return areas;
}

bool forbidsRegistration(std::uint8_t packetServiceCause) {
  static constexpr std::uint8_t kForbidding[] = {3, 6, 7, 8, 11, 12, 13, 14, 15, 25, 35};
  return std::find(std::begin(kForbidding), std::end(kForbidding), packetServiceCause) != std::end(kForbidding);
}

}  // namespace vesk::diag
