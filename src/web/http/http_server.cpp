#include "web/http/http_server.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <sys/epoll.h>
#include <sys/socket.h>
#include <utility>

#include "web/http/listener.h"

namespace vesk::web {

namespace {

constexpr StreamId kListener = 0;

}  // namespace

std::unique_ptr<HttpServer> HttpServer::open(const ServerOptions& options, const Clock& clock, Handler handler,
                                             std::string& reason) {
  FileDescriptor listener = listenOn(options.address, options.port, reason);
  if (!listener.isOpen()) return nullptr;
  return std::unique_ptr<HttpServer>(new HttpServer(std::move(listener), clock, std::move(handler), options.names));
}

HttpServer::HttpServer(FileDescriptor listener, const Clock& clock, Handler handler, std::vector<std::string> names)
    : listener_(std::move(listener)),
      events_(epoll_create1(EPOLL_CLOEXEC)),
      clock_(clock),
      handler_(std::move(handler)),
      names_(std::move(names)),
      port_(portOf(listener_)) {
  listen(true);
}

void HttpServer::listen(bool isListening) {
  if (isListening == isListening_) return;
  isListening_ = isListening;
  epoll_event event{.events = EPOLLIN, .data = {.u64 = kListener}};
  epoll_ctl(events_.get(), isListening ? EPOLL_CTL_ADD : EPOLL_CTL_DEL, listener_.get(), &event);
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
    Visitor& visitor = found->second;
    const bool isGone = (event.events & (EPOLLERR | EPOLLHUP)) != 0;
    if (!isGone && visitor.isLeaving) {
      hearOut(id, visitor);
    } else if (!isGone && (event.events & EPOLLIN) != 0) {
      receive(id, visitor);
    } else if (isGone || !flush(id, visitor)) {
      drop(id);
    } else {
      answerNext(id, visitor);
    }
  }
}

void HttpServer::acceptAll() {
  for (;;) {
    FileDescriptor socket(accept4(listener_.get(), nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC));
    if (socket.isOpen()) {
      enter(std::move(socket));
      continue;
    }
    if (errno == EINTR || errno == ECONNABORTED) continue;
    const bool isOutOfRoom = errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM;
    if (!isOutOfRoom) return;
    // He who waits to enter would be announced again and again.
    listen(false);
    if (const auto tell = std::exchange(onRemark_, nullptr))
      tell(std::string("visitors wait to enter: ") + std::strerror(errno));
    return;
  }
}

void HttpServer::enter(FileDescriptor socket) {
  if (visitors_.size() >= kMostVisitors + kMostRefused) return;
  const bool isFull = visitors_.size() >= kMostVisitors;
  const StreamId id = ++lastId_;
  Visitor& visitor = visitors_[id];
  visitor.socket = std::move(socket);
  visitor.lastProgress = clock_.now();
  if (isFull) refuse(visitor, plainResponse(503, "There are too many visitors."));
  if (!flush(id, visitor)) drop(id);
}

void HttpServer::watch(StreamId id, Visitor& visitor) {
  // Who can be sent something has his turn.
  const bool isToBeSent = !visitor.pieces.empty() || visitor.hasMore;
  // One who is being answered is not listened to, but for his going.
  const bool isHeard = !isToBeSent || visitor.isStream;
  const std::uint32_t wanted = (isHeard ? EPOLLIN : 0U) | (isToBeSent ? EPOLLOUT : 0U);
  if (visitor.watchedFor == wanted) return;
  epoll_event event{.events = wanted, .data = {.u64 = id}};
  epoll_ctl(events_.get(), visitor.watchedFor == 0 ? EPOLL_CTL_ADD : EPOLL_CTL_MOD, visitor.socket.get(), &event);
  visitor.watchedFor = wanted;
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

/// Closed with bytes unread, a connection is reset, and what was sent last may be lost with it.
void HttpServer::hearOut(StreamId id, Visitor& visitor) {
  std::array<char, 4096> bytes;
  const ssize_t count = recv(visitor.socket.get(), bytes.data(), bytes.size(), 0);
  if (count < 0 && (errno == EAGAIN || errno == EINTR)) return;
  if (count > 0) visitor.unheard += static_cast<std::size_t>(count);
  if (count <= 0 || visitor.unheard > kMostUnheard) drop(id);
}

/// One request after the other, each when the answer to the one before is on its way.
void HttpServer::answerNext(StreamId id, Visitor& visitor) {
  if (visitor.waiting > 0 || visitor.isStream || visitor.isLast) return;
  RequestHead head = readRequestHead(visitor.received, names_);
  visitor.received.erase(0, head.size);
  visitor.hasMore = head.size > 0 && !visitor.received.empty();
  if (head.request && waiting_.bytes() < kMostWaitingForMore) {
    answer(id, visitor, *head.request);
  } else if (head.request) {
    refuse(visitor, plainResponse(503, "Too much waits for others."));
  } else if (head.size > 0) {
    refuse(visitor, plainResponse(head.refusal));
  }
  if (!flush(id, visitor)) drop(id);
  relieve();
}

/// What the handler sends to others never drops this visitor, for whom nothing waits.
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
  if (visitor.isStream || visitor.isLast) visitor.hasMore = false;
  if (visitor.isStream) response.begin(id);
}

void HttpServer::refuse(Visitor& visitor, const Response& response) {
  visitor.isLast = true;
  visitor.hasMore = false;
  queue(visitor, std::make_shared<const std::string>(headOf(response, true)));
  queue(visitor, response.body);
}

void HttpServer::queue(Visitor& visitor, SharedText piece) {
  if (piece == nullptr || piece->empty()) return;
  visitor.lastPiece = clock_.now();
  if (visitor.waiting == 0) visitor.waitingSince = visitor.lastPiece;
  visitor.waiting += piece->size();
  waiting_.add(piece);
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
    waiting_.remove(visitor.pieces.front());
    visitor.pieces.pop_front();
    visitor.sent = 0;
  }
  if (visitor.pieces.empty() && visitor.isLast) {
    visitor.isLeaving = true;
    if (shutdown(visitor.socket.get(), SHUT_WR) != 0) return false;
  }
  watch(id, visitor);
  return true;
}

void HttpServer::send(StreamId stream, const SharedText& piece) {
  const auto found = visitors_.find(stream);
  if (found == visitors_.end()) return;
  Visitor& visitor = found->second;
  const std::size_t beginning = visitor.pieces.empty() ? 0 : visitor.pieces.front()->size();
  // A piece that alone is larger is sent to one for whom nothing else waits.
  const bool isTooMuch = visitor.waiting > 0 && visitor.waiting + piece->size() > kMostWaiting + beginning;
  queue(visitor, piece);
  if (isTooMuch || !flush(stream, visitor)) drop(stream);
  relieve();
}

void HttpServer::sendToQuiet(Clock::Duration quiet, const SharedText& piece) {
  const Clock::Instant now = clock_.now();
  std::vector<StreamId> streams;
  for (const auto& [id, visitor] : visitors_)
    if (visitor.isStream && now - visitor.lastPiece >= quiet) streams.push_back(id);
  for (const StreamId id : streams)
    send(id, piece);
}

void HttpServer::tend() {
  std::vector<StreamId> idle;
  for (const auto& [id, visitor] : visitors_)
    if (isWaitedForTooLong(visitor)) idle.push_back(id);
  for (const StreamId id : idle)
    drop(id);
  listen(true);
}

bool HttpServer::isWaitedForTooLong(const Visitor& visitor) const {
  const Clock::Instant now = clock_.now();
  if (visitor.isLeaving) return now - visitor.lastProgress > kFarewell;
  if (visitor.waiting > 0 && now - visitor.waitingSince > kLongestWait) return true;
  return (!visitor.isStream || visitor.waiting > 0) && now - visitor.lastProgress > kPatience;
}

void HttpServer::relieve() {
  while (waiting_.bytes() > kMostWaitingInAll)
    drop(std::max_element(visitors_.begin(), visitors_.end(), [](const auto& one, const auto& other) {
           return one.second.waiting < other.second.waiting;
         })->first);
}

void HttpServer::drop(StreamId id) {
  const auto found = visitors_.find(id);
  if (found == visitors_.end()) return;
  const bool wasStream = found->second.isStream;
  for (const SharedText& piece : found->second.pieces)
    waiting_.remove(piece);
  visitors_.erase(found);
  if (wasStream && onStreamEnd_) onStreamEnd_(id);
}

}  // namespace vesk::web
