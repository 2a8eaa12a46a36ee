#include "diag/nas/esm.h"

#include <string>
#include <utility>

#include "diag/nas/elements.h"
#include "diag/nas/name_servers.h"

namespace vesk::diag {

namespace {

using namespace metrics;

enum EsmType : std::uint8_t {
  defaultBearerRequest = 0xC1,
  defaultBearerAccept = 0xC2,
  defaultBearerReject = 0xC3,
  dedicatedBearerRequest = 0xC5,
  dedicatedBearerAccept = 0xC6,
  dedicatedBearerReject = 0xC7,
  deactivateBearerAccept = 0xCE,
};

/// The labels of an access point name, joined by dots; none when one of them is cut off.
std::optional<std::string> joinLabels(ByteSpan labels) {
  std::string name;
  ByteReader reader(labels);
  for (std::size_t at = 0; at < labels.size();) {
    const std::size_t size = labels[at++];
    const ByteSpan label = reader.part(at, size);
    if (reader.isCutOff()) return std::nullopt;
    if (at > 1) name += '.';
    name.append(label.begin(), label.end());
    at += size;
  }
  return name;
}

void setAddress(BearerContext& bearer, ByteSpan address) {
  if (address.empty()) return;
  // IPv4, IPv6 or both, of a packet data network.
  constexpr unsigned kBeforeTypesOfNetworks = 2;
  bearer.setPdpType(static_cast<PdpType>(kBeforeTypesOfNetworks + (address[0] & 7U)));
  if (address.size() > 1) bearer.setPdpAddr(Data::copy(address.subspan(1)));
}

std::optional<RequestedBearer> readDefaultRequest(std::uint8_t identity, ByteSpan bytes) {
  constexpr std::uint8_t kProtocolOptions = 0x27;
  ByteReader message(bytes);
  std::size_t at = 3;
  // Each of these has its length before it.
  const auto nextPart = [&message, &at] {
    const std::size_t size = message.byte(at);
    const ByteSpan part = message.part(at + 1, size);
    at += 1 + size;
    return part;
  };
  nextPart();  // the quality of service
  const ByteSpan accessPoint = nextPart();
  const ByteSpan address = nextPart();
  const ByteSpan rest = message.rest(at);
  const auto name = joinLabels(accessPoint);
  if (message.isCutOff() || !name) return std::nullopt;

  auto bearer = makeMessage<BearerContext>();
  bearer->setNsapi(identity);
  if (!name->empty()) bearer->setApn(Text::copy(*name));
  setAddress(*bearer, address);
  if (const auto options = Elements(rest, kEpsElements).find(kProtocolOptions)) setNameServers(*bearer, *options);
  return RequestedBearer{std::move(bearer), std::nullopt};
}

std::optional<RequestedBearer> readDedicatedRequest(std::uint8_t identity, ByteSpan bytes) {
  ByteReader message(bytes);
  const auto linkedTo = static_cast<std::uint8_t>(message.byte(3) & 15U);
  if (message.isCutOff()) return std::nullopt;
  auto bearer = makeMessage<BearerContext>();
  bearer->setNsapi(identity);
  return RequestedBearer{std::move(bearer), linkedTo};
}

}  // namespace

std::optional<EsmMessage> readEsmMessage(ByteSpan bytes) {
  if (bytes.size() < 3) return std::nullopt;
  EsmMessage message{static_cast<std::uint8_t>(bytes[0] >> 4), bytes[2], std::nullopt};
  const bool isDefault = message.type == defaultBearerRequest;
  if (!isDefault && message.type != dedicatedBearerRequest) return message;
  message.requested =
      isDefault ? readDefaultRequest(message.identity, bytes) : readDedicatedRequest(message.identity, bytes);
  if (!message.requested) return std::nullopt;
  return message;
}

bool apply(const EsmMessage& message, Bearers& bearers) {
  switch (message.type) {
    case defaultBearerRequest:
    case dedicatedBearerRequest:
      bearers.request(message.identity, *message.requested);
      return false;
    case defaultBearerAccept:
    case dedicatedBearerAccept:
      return bearers.accept(message.identity);
    case defaultBearerReject:
    case dedicatedBearerReject:
      bearers.dropRequest(message.identity);
      return false;
    case deactivateBearerAccept:
      return bearers.deactivate(message.identity);
    default:
      return false;
  }
}

}  // namespace vesk::diag
