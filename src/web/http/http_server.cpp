#include "web/http/http_server.h"

#include <algorithm>
#include <arpa/inet.h>
#include <array>
#include <cerrno>
#include <cstring>
#include <netinet/in.h>
#include <optional>
#include <sys/epoll.h>
#include <sys/socket.h>
#include <system_error>
#include <unordered_set>
#include <utility>

namespace vesk::web {

namespace {

constexpr StreamId kListener = 0;

std::string lastError() {
  return std::generic_category().message(errno);
}

std::string_view phraseOf(int status) {
  constexpr std::array<std::pair<int, std::string_view>, 9> kPhrases{{
      {200, "OK"},
      {400, "Bad Request"},
      {403, "Forbidden"},
      {404, "Not Found"},
      {405, "Method Not Allowed"},
      {413, "Content Too Large"},
      {431, "Request Header Fields Too Large"},
      {503, "Service Unavailable"},
      {505, "HTTP Version Not Supported"},
  }};
  for (const auto& [known, phrase] : kPhrases)
    if (known == status) return phrase;
  return "Error";
}

std::string headOf(const Response& response, bool isLast) {
  std::string head = "HTTP/1.1 " + std::to_string(response.status);
  head.append(" ").append(phraseOf(response.status)).append("\r\nContent-Type: ").append(response.type);
  head +=
      "\r\nCache-Control: no-store"
      "\r\nContent-Security-Policy: default-src 'none'; script-src 'self'; style-src 'self'; connect-src 'self'; "
      "img-src 'self'; "
      "base-uri 'none'; form-action 'none'; frame-ancestors 'none'"
      "\r\nCross-Origin-Resource-Policy: same-origin"
      "\r\nReferrer-Policy: no-referrer"
      "\r\nX-Content-Type-Options: nosniff";
  if (response.status == 405) head += "\r\nAllow: GET, HEAD";
  if (!response.begin) head += "\r\nContent-Length: " + std::to_string(response.body ? response.body->size() : 0);
  if (isLast || response.begin) head += "\r\nConnection: close";
  return head + "\r\n\r\n";
}

/// An address of either family with its port, as sockets take it.
class SocketAddress {
 public:
  /// Absent for a text that is no address.
  static std::optional<SocketAddress> of(const std::string& text, std::uint16_t port) {
    SocketAddress address;
    sockaddr_in four{};
    four.sin_family = AF_INET;
    four.sin_port = htons(port);
    if (inet_pton(AF_INET, text.c_str(), &four.sin_addr) == 1) return address.holding(four);
    sockaddr_in6 six{};
    six.sin6_family = AF_INET6;
    six.sin6_port = htons(port);
    if (inet_pton(AF_INET6, text.c_str(), &six.sin6_addr) == 1) return address.holding(six);
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

FileDescriptor listenOn(const ServerOptions& options, std::string& reason) {
  std::optional<SocketAddress> address = SocketAddress::of(options.address, options.port);
  if (!address) {
    reason = options.address + " is no address";
    return {};
  }
  FileDescriptor listener(socket(address->family(), SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
  constexpr int kYes = 1;
  constexpr int kMostWaitingToEnter = 128;
  if (listener.isOpen() && setsockopt(listener.get(), SOL_SOCKET, SO_REUSEADDR, &kYes, sizeof kYes) == 0 &&
      bind(listener.get(), address->pointer(), address->size()) == 0 &&
      listen(listener.get(), kMostWaitingToEnter) == 0)
    return listener;
  reason = options.address + " port " + std::to_string(options.port) + ": " + lastError();
  return {};
}

}  // namespace

Response plainResponse(int status, std::string text) {
  return {.status = status, .body = std::make_shared<const std::string>(std::move(text) + "\n")};
}

std::unique_ptr<HttpServer> HttpServer::open(const ServerOptions& options, const Clock& clock, Handler handler,
                                             std::string& reason) {
  FileDescriptor listener = listenOn(options, reason);
  if (!listener.isOpen()) return nullptr;
  return std::unique_ptr<HttpServer>(new HttpServer(std::move(listener), clock, std::move(handler), options.names));
}

HttpServer::HttpServer(FileDescriptor listener, const Clock& clock, Handler handler, std::vector<std::string> names)
    : listener_(std::move(listener)),
      events_(epoll_create1(EPOLL_CLOEXEC)),
      clock_(clock),
      handler_(std::move(handler)),
      names_(std::move(names)),
      port_(SocketAddress::boundTo(listener_.get()).port()) {
  epoll_event event{.events = EPOLLIN, .data = {.u64 = kListener}};
  epoll_ctl(events_.get(), EPOLL_CTL_ADD, listener_.get(), &event);
}

void HttpServer::serve() {
  std::array<epoll_event, 64> events;
  const int count = epoll_wait(events_.get(), events.data(), static_cast<int>(events.size()), 0);
  for (int at = 0; at < count; ++at) {
    const epoll_event& event = events[static_cast<std::size_t>(at)];
    const StreamId id = event.data.u64;
    if (id == kListener) {
      acceptAll();
      continue;
    }
    const auto found = visitors_.find(id);
    if (found == visitors_.end()) continue;
    const bool isGone = (event.events & (EPOLLERR | EPOLLHUP)) != 0;
    if (!isGone && (event.events & EPOLLIN) != 0) {
      receive(id, found->second);
    } else if (isGone || !flush(id, found->second)) {
      drop(id);
    } else {
      answerNext(id, found->second);
    }
  }
}

void HttpServer::acceptAll() {
  for (;;) {
    FileDescriptor socket(accept4(listener_.get(), nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC));
    if (!socket.isOpen()) return;
    if (visitors_.size() >= kMostVisitors) {
      const Response full = plainResponse(503, "too many visitors");
      const std::string text = headOf(full, true) + *full.body;
      [[maybe_unused]] const ssize_t sent = ::send(socket.get(), text.data(), text.size(), MSG_NOSIGNAL);
      continue;
    }
    // What the system holds for a visitor is bounded too.
    constexpr int kBuffer = 256 << 10;
    setsockopt(socket.get(), SOL_SOCKET, SO_SNDBUF, &kBuffer, sizeof kBuffer);
    const StreamId id = ++lastId_;
    Visitor& visitor = visitors_[id];
    visitor.socket = std::move(socket);
    visitor.lastProgress = clock_.now();
    watch(id, visitor, false, true);
  }
}

void HttpServer::watch(StreamId id, Visitor& visitor, bool forRoom, bool isNew) {
  if (!isNew && visitor.isWatchedForRoom == forRoom) return;
  visitor.isWatchedForRoom = forRoom;
  // One who is being answered is not listened to, but for his going.
  const bool isHeard = !forRoom || visitor.isStream;
  epoll_event event{.events = (isHeard ? EPOLLIN : 0U) | (forRoom ? EPOLLOUT : 0U), .data = {.u64 = id}};
  epoll_ctl(events_.get(), isNew ? EPOLL_CTL_ADD : EPOLL_CTL_MOD, visitor.socket.get(), &event);
}

void HttpServer::receive(StreamId id, Visitor& visitor) {
  std::array<char, 4096> bytes;
  const ssize_t count = recv(visitor.socket.get(), bytes.data(), bytes.size(), 0);
  if (count < 0 && (errno == EAGAIN || errno == EINTR)) return;
  // Nobody has anything to say in a stream.
  if (count <= 0 || visitor.isStream) return drop(id);
  if (visitor.received.empty()) visitor.lastProgress = clock_.now();
  visitor.received.append(bytes.data(), static_cast<std::size_t>(count));
  answerNext(id, visitor);
}

/// One request after the other, each when the answer to the one before is on its way.
void HttpServer::answerNext(StreamId id, Visitor& visitor) {
  while (visitor.waiting == 0 && !visitor.isStream && !visitor.isLast) {
    RequestHead head = readRequestHead(visitor.received, names_);
    if (head.size == 0) return;
    visitor.received.erase(0, head.size);
    if (head.request) {
      answer(id, visitor, *head.request);
    } else {
      visitor.isLast = true;
      const Response refusal = plainResponse(head.refusal, std::string(phraseOf(head.refusal)));
      queue(visitor, std::make_shared<const std::string>(headOf(refusal, true)));
      queue(visitor, refusal.body);
    }
    if (!flush(id, visitor)) return drop(id);
  }
}

void HttpServer::answer(StreamId id, Visitor& visitor, const Request& request) {
  const Response response = handler_(request);
  visitor.isStream = response.begin != nullptr && !request.isHead;
  visitor.isLast = request.isLast && !visitor.isStream;
  queue(visitor, std::make_shared<const std::string>(headOf(response, request.isLast)));
  if (request.isHead) {
    visitor.isLast = visitor.isLast || response.begin != nullptr;
  } else {
    queue(visitor, response.body);
  }
  if (visitor.isStream) response.begin(id);
}

void HttpServer::queue(Visitor& visitor, SharedText piece) {
  if (piece == nullptr || piece->empty()) return;
  visitor.waiting += piece->size();
  visitor.pieces.push_back(std::move(piece));
}

bool HttpServer::flush(StreamId id, Visitor& visitor) {
  while (!visitor.pieces.empty()) {
    const std::string& piece = *visitor.pieces.front();
    const ssize_t count =
        ::send(visitor.socket.get(), piece.data() + visitor.sent, piece.size() - visitor.sent, MSG_NOSIGNAL);
    if (count < 0 && errno == EINTR) continue;
    if (count < 0 && errno != EAGAIN) return false;
    if (count < 0) break;
    visitor.lastProgress = clock_.now();
    visitor.sent += static_cast<std::size_t>(count);
    visitor.waiting -= static_cast<std::size_t>(count);
    if (visitor.sent < piece.size()) continue;
    visitor.pieces.pop_front();
    visitor.sent = 0;
  }
  if (visitor.pieces.empty() && visitor.isLast) return false;
  watch(id, visitor, !visitor.pieces.empty(), false);
  return true;
}

void HttpServer::send(StreamId stream, const SharedText& piece) {
  const auto found = visitors_.find(stream);
  if (found == visitors_.end()) return;
  Visitor& visitor = found->second;
  const std::size_t beginning = visitor.pieces.empty() ? 0 : visitor.pieces.front()->size();
  queue(visitor, piece);
  const bool isTooMuch = visitor.waiting > kMostWaiting + beginning;
  if (isTooMuch || !flush(stream, visitor)) drop(stream);
}

void HttpServer::dropSlow() {
  dropIdle();
  while (const auto id = heaviest())
    drop(*id);
}

std::optional<StreamId> HttpServer::heaviest() const {
  std::unordered_set<const std::string*> pieces;
  std::size_t waiting = 0;
  std::pair<std::size_t, StreamId> most{};
  for (const auto& [id, visitor] : visitors_) {
    for (const SharedText& piece : visitor.pieces)
      if (pieces.insert(piece.get()).second) waiting += piece->size();
    most = std::max(most, {visitor.waiting, id});
  }
  return waiting > kMostWaitingInAll ? std::optional(most.second) : std::nullopt;
}

void HttpServer::dropIdle() {
  const Clock::Instant now = clock_.now();
  std::vector<StreamId> idle;
  for (const auto& [id, visitor] : visitors_) {
    const bool isWaitedFor = !visitor.isStream || visitor.waiting > 0;
    if (isWaitedFor && now - visitor.lastProgress > kPatience) idle.push_back(id);
  }
  for (const StreamId id : idle)
    drop(id);
}

void HttpServer::drop(StreamId id) {
  const auto found = visitors_.find(id);
  if (found == visitors_.end()) return;
  const bool wasStream = found->second.isStream;
  visitors_.erase(found);
  if (wasStream && onStreamEnd_) onStreamEnd_(id);
}

}  // namespace vesk::web
