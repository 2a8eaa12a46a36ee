#include "diag/nas/name_servers.h"

#include <algorithm>
#include <array>

namespace vesk::diag {

namespace {

using namespace metrics;

/// What the options hold, by their identifiers.
constexpr std::uint32_t kIpcp = 0x8021;
constexpr std::uint32_t kIpv4NameServer = 0x000D;
constexpr std::uint32_t kIpv6NameServer = 0x0003;
constexpr std::size_t kIpv4Size = 4;
constexpr std::size_t kIpv6Size = 16;

/// The first two different addresses, in order; the size of one tells its type.
class FirstTwo {
 public:
  void add(ByteSpan address) {
    const auto isSame = [address](ByteSpan held) { return std::ranges::equal(held, address); };
    const bool isNone = std::ranges::all_of(address, [](std::uint8_t byte) { return byte == 0; });
    if (isNone || count_ == addresses_.size() || std::any_of(begin(), end(), isSame)) return;
    addresses_[count_++] = address;
  }
  [[nodiscard]] const ByteSpan* begin() const { return addresses_.data(); }
  [[nodiscard]] const ByteSpan* end() const { return addresses_.data() + count_; }

 private:
  std::array<ByteSpan, 2> addresses_{};
  std::size_t count_ = 0;
};

/// The options of IPCP begin behind its own header.
void addFromIpcp(ByteSpan packet, FirstTwo& servers) {
  constexpr std::uint8_t kPrimary = 0x81;
  constexpr std::uint8_t kSecondary = 0x83;
  constexpr std::size_t kHeaderSize = 4;
  constexpr std::size_t kLeastSize = 2;
  ByteReader reader(packet);
  for (std::size_t at = kHeaderSize; at < packet.size();) {
    const std::uint8_t type = reader.byte(at);
    const std::size_t size = reader.byte(at + 1);
    if (size < kLeastSize) return;
    const ByteSpan value = reader.part(at + kLeastSize, size - kLeastSize);
    if (reader.isCutOff()) return;
    if ((type == kPrimary || type == kSecondary) && value.size() == kIpv4Size) servers.add(value);
    at += size;
  }
}

FirstTwo findNameServers(ByteSpan options) {
  FirstTwo servers;
  ByteReader reader(options);
  // The first byte tells the protocol that the options are of.
  for (std::size_t at = 1; at < options.size();) {
    const std::uint32_t id = reader.bigEndian(at, 2);
    const std::size_t size = reader.byte(at + 2);
    const ByteSpan value = reader.part(at + 3, size);
    if (reader.isCutOff()) break;
    if (id == kIpcp) addFromIpcp(value, servers);
    if (id == kIpv4NameServer && size == kIpv4Size) servers.add(value);
    if (id == kIpv6NameServer && size == kIpv6Size) servers.add(value);
    at += 3 + size;
  }
  return servers;
}

PdpType typeOf(ByteSpan address) {
  return address.size() == kIpv4Size ? PdpType::PDP_TYPE_IPv4 : PdpType::PDP_TYPE_IPv6;
}

}  // namespace

void setNameServers(BearerContext& bearer, ByteSpan options) {
  const FirstTwo servers = findNameServers(options);
  const ByteSpan* server = servers.begin();
  if (server == servers.end()) return;
  bearer.setPrimaryDnsType(typeOf(*server));
  bearer.setPrimaryDnsAddr(Data::copy(*server));
  if (++server == servers.end()) return;
  bearer.setSecondaryDnsType(typeOf(*server));
  bearer.setSecondaryDnsAddr(Data::copy(*server));
}

}  // namespace vesk::diag
