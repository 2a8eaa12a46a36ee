#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "system/clock.h"
#include "system/file_descriptor.h"
#include "web/http/request.h"
#include "web/http/response.h"
#include "web/http/waiting_bytes.h"

namespace vesk::web {

struct ServerOptions {
  std::string address = "127.0.0.1";
  /// 0 for any that is free.
  std::uint16_t port = 8080;
  /// Of this host, beside its addresses and "localhost".
  std::vector<std::string> names{};
};

/// A web server for a page that is only read. It works on the main thread and never waits for anybody: whoever stops
/// reading, takes too long, or does not finish his request, is dropped. Visitors, requests and what waits for a visitor
/// are bounded.
class HttpServer {
 public:
  using Handler = std::function<Response(const Request&)>;

  static constexpr std::size_t kMostVisitors = 256;
  /// Those beyond, who are told that there is no room for them; more are not told.
  static constexpr std::size_t kMostRefused = 32;
  /// What may wait for a visitor beyond the beginning of his stream: bytes.
  static constexpr std::size_t kMostWaiting = std::size_t{4} << 20U;
  /// What may wait for all of them, where a piece that several are sent counts once: bytes. Beyond, those for whom most
  /// waits are dropped.
  static constexpr std::size_t kMostWaitingInAll = std::size_t{64} << 20U;
  /// While as much waits, nobody's request is carried out; the rest is for those who watch a stream.
  static constexpr std::size_t kMostWaitingForMore = std::size_t{48} << 20U;
  /// How long a request may take to come, and a reader to take anything.
  static constexpr std::chrono::seconds kPatience{20};
  /// How long something may wait for a reader, be it taken little by little.
  static constexpr std::chrono::seconds kLongestWait{120};
  /// How long one who was sent his last answer is heard out, so that he can read it; and how many bytes of his.
  static constexpr std::chrono::seconds kFarewell{2};
  static constexpr std::size_t kMostUnheard = std::size_t{64} << 10U;

  /// Null, with the reason, when the address cannot be listened on. `clock` must outlive the server.
  static std::unique_ptr<HttpServer> open(const ServerOptions& options, const Clock& clock, Handler handler,
                                          std::string& reason);
  HttpServer(const HttpServer&) = delete;
  HttpServer& operator=(const HttpServer&) = delete;
  ~HttpServer() = default;

  /// Readable when serve() has something to do.
  [[nodiscard]] int descriptor() const { return events_.get(); }
  /// One answer for each visitor at most; who asks for more has his turn at the next call.
  void serve();
  /// To be called every second or so: drops those who have been waited for too long, and listens again to new ones
  /// when there was nothing left to hold them with.
  void tend();

  /// Sends more of a stream; nothing when its visitor has gone.
  void send(StreamId stream, const SharedText& piece);
  /// Sends it to all streams that were sent nothing for as long.
  void sendToQuiet(Clock::Duration quiet, const SharedText& piece);
  /// Told when a stream's visitor has gone.
  void setStreamEndHandler(std::function<void(StreamId)> handler) { onStreamEnd_ = std::move(handler); }
  /// Told, once, why visitors cannot enter for a while.
  void setRemarkHandler(std::function<void(const std::string&)> handler) { onRemark_ = std::move(handler); }

  [[nodiscard]] std::uint16_t port() const { return port_; }
  [[nodiscard]] std::size_t visitorCount() const { return visitors_.size(); }

 private:
  struct Visitor {
    FileDescriptor socket;
    std::string received;
    std::deque<SharedText> pieces;
    /// Of the first piece.
    std::size_t sent = 0;
    /// Of all pieces, what has not been sent.
    std::size_t waiting = 0;
    bool isStream = false;
    /// To be closed once all is sent.
    bool isLast = false;
    /// All is sent; what he says still is read and let go of.
    bool isLeaving = false;
    std::size_t unheard = 0;
    /// More than the request that was answered has been received.
    bool hasMore = false;
    /// What the system is to tell of the socket; 0 before it was told.
    std::uint32_t watchedFor = 0;
    Clock::Instant lastProgress;
    /// Since when something has been waiting; while something is.
    Clock::Instant waitingSince;
    /// When he was sent a piece last.
    Clock::Instant lastPiece;
  };
  using Visitors = std::unordered_map<StreamId, Visitor>;

  HttpServer(FileDescriptor listener, const Clock& clock, Handler handler, std::vector<std::string> names);

  void listen(bool isListening);
  void acceptAll();
  void enter(FileDescriptor socket);
  void watch(StreamId id, Visitor& visitor);
  void receive(StreamId id, Visitor& visitor);
  void hearOut(StreamId id, Visitor& visitor);
  void answerNext(StreamId id, Visitor& visitor);
  void answer(StreamId id, Visitor& visitor, const Request& request);
  /// Queues the last answer.
  void refuse(Visitor& visitor, const Response& response);
  /// Sends what there is room for; false when the visitor is to be dropped.
  [[nodiscard]] bool flush(StreamId id, Visitor& visitor);
  void queue(Visitor& visitor, SharedText piece);
  /// Drops those for whom most waits, while all that waits is too much.
  void relieve();
  [[nodiscard]] bool isWaitedForTooLong(const Visitor& visitor) const;
  void drop(StreamId id);

  FileDescriptor listener_;
  FileDescriptor events_;
  const Clock& clock_;
  Handler handler_;
  std::vector<std::string> names_;
  std::uint16_t port_ = 0;
  bool isListening_ = false;
  std::function<void(StreamId)> onStreamEnd_;
  std::function<void(const std::string&)> onRemark_;
  /// 0 is the listener's.
  StreamId lastId_ = 0;
  Visitors visitors_;
  WaitingBytes waiting_;
};

}  // namespace vesk::web
