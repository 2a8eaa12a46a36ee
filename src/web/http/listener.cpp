#include "web/http/listener.h"

#include <arpa/inet.h>
#include <array>
#include <cerrno>
#include <cstring>
#include <ifaddrs.h>
#include <memory>
#include <net/if.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <optional>
#include <sys/socket.h>
#include <system_error>
#include <tuple>

namespace vesk::web {

namespace {

/// An address of either family with its port, as sockets take it.
class SocketAddress {
 public:
  /// Absent for a text that is no address.
  static std::optional<SocketAddress> of(const std::string& text, std::uint16_t port) {
    SocketAddress address;
    sockaddr_in four{};
    four.sin_family = AF_INET;
    four.sin_port = htons(port);
    const char* number = text == "localhost" ? "127.0.0.1" : text.c_str();
    if (inet_pton(AF_INET, number, &four.sin_addr) == 1) return address.holding(four);
    sockaddr_in6 six{};
    six.sin6_family = AF_INET6;
    six.sin6_port = htons(port);
    if (inet_pton(AF_INET6, number, &six.sin6_addr) == 1) return address.holding(six);
    return std::nullopt;
  }
  static SocketAddress boundTo(int descriptor) {
    SocketAddress address;
    address.size_ = sizeof address.storage_;
    getsockname(descriptor, address.pointer(), &address.size_);
    return address;
  }

  [[nodiscard]] int family() const { return storage_.ss_family; }
  // NOLINTNEXTLINE(cppcoreguidelines-pro-type-reinterpret-cast): the interface of sockets
  [[nodiscard]] sockaddr* pointer() { return reinterpret_cast<sockaddr*>(&storage_); }
  [[nodiscard]] socklen_t size() const { return size_; }
  /// It stands at the same place in both families.
  [[nodiscard]] std::uint16_t port() const {
    sockaddr_in four{};
    std::memcpy(&four, &storage_, sizeof four);
    return ntohs(four.sin_port);
  }

 private:
  template <class Address>
  SocketAddress holding(const Address& address) {
    std::memcpy(&storage_, &address, sizeof address);
    size_ = sizeof address;
    return *this;
  }

  sockaddr_storage storage_{};
  socklen_t size_ = 0;
};

/// What the connections of a listener have from it.
void setOptions(const FileDescriptor& listener) {
  // What the system holds for a visitor is bounded too.
  constexpr int kBuffer = 256 << 10;
  constexpr int kYes = 1;
  // One who does not answer for half a minute is gone: asked after 30 s without a word, or not taking what was sent.
  constexpr int kSecondsUntilAsked = 30;
  constexpr int kSecondsBetween = 10;
  constexpr int kAskedTimes = 3;
  constexpr int kLongestUntaken = 30'000;
  constexpr std::array<std::tuple<int, int, int>, 7> kOptions{{
      {SOL_SOCKET, SO_SNDBUF, kBuffer},
      {SOL_SOCKET, SO_KEEPALIVE, kYes},
      {IPPROTO_TCP, TCP_KEEPIDLE, kSecondsUntilAsked},
      {IPPROTO_TCP, TCP_KEEPINTVL, kSecondsBetween},
      {IPPROTO_TCP, TCP_KEEPCNT, kAskedTimes},
      {IPPROTO_TCP, TCP_USER_TIMEOUT, kLongestUntaken},
      // A head and its body are written one after the other.
      {IPPROTO_TCP, TCP_NODELAY, kYes},
  }};
  for (const auto& [level, name, value] : kOptions)
    setsockopt(listener.get(), level, name, &value, sizeof value);
}

/// The number of an address; empty for one of another family, or that means nothing to other machines.
std::string numberOf(const sockaddr& address) {
  std::array<char, INET6_ADDRSTRLEN> text{};
  if (address.sa_family == AF_INET) {
    sockaddr_in four{};
    std::memcpy(&four, &address, sizeof four);
    inet_ntop(AF_INET, &four.sin_addr, text.data(), text.size());
  } else if (address.sa_family == AF_INET6) {
    sockaddr_in6 six{};
    std::memcpy(&six, &address, sizeof six);
    if (IN6_IS_ADDR_LINKLOCAL(&six.sin6_addr) == 0) inet_ntop(AF_INET6, &six.sin6_addr, text.data(), text.size());
  }
  return text.data();
}

}  // namespace

FileDescriptor listenOn(const std::string& address, std::uint16_t port, std::string& reason) {
  std::optional<SocketAddress> place = SocketAddress::of(address, port);
  if (!place) {
    reason = address + " is no address";
    return {};
  }
  FileDescriptor listener(socket(place->family(), SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
  constexpr int kYes = 1;
  constexpr int kMostWaitingToEnter = 128;
  if (listener.isOpen() && setsockopt(listener.get(), SOL_SOCKET, SO_REUSEADDR, &kYes, sizeof kYes) == 0 &&
      bind(listener.get(), place->pointer(), place->size()) == 0 && listen(listener.get(), kMostWaitingToEnter) == 0) {
    setOptions(listener);
    return listener;
  }
  reason = address + " port " + std::to_string(port) + ": " + std::generic_category().message(errno);
  return {};
}

std::uint16_t portOf(const FileDescriptor& listener) {
  return SocketAddress::boundTo(listener.get()).port();
}

bool isLocal(const std::string& address) {
  return address == "localhost" || address == "::1" || address.starts_with("127.");
}

std::vector<std::string> reachableAddresses(const std::string& address) {
  const bool isAnyFour = address == "0.0.0.0";
  if (!isAnyFour && address != "::") return {address};
  ifaddrs* first = nullptr;
  if (getifaddrs(&first) != 0) return {};
  const std::unique_ptr<ifaddrs, decltype(&freeifaddrs)> all(first, &freeifaddrs);
  std::vector<std::string> addresses;
  for (const ifaddrs* each = first; each != nullptr; each = each->ifa_next) {
    const bool isOthers =
        each->ifa_addr != nullptr && (each->ifa_flags & IFF_UP) != 0 && (each->ifa_flags & IFF_LOOPBACK) == 0;
    if (!isOthers || (isAnyFour && each->ifa_addr->sa_family != AF_INET)) continue;
    if (std::string number = numberOf(*each->ifa_addr); !number.empty()) addresses.push_back(std::move(number));
  }
  return addresses;
}

}  // namespace vesk::web
