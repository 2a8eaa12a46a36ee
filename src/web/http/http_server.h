#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "system/clock.h"
#include "system/file_descriptor.h"
#include "web/http/request.h"

namespace vesk::web {

/// Bytes that several visitors are sent.
using SharedText = std::shared_ptr<const std::string>;

/// A visitor whose answer goes on for as long as he stays.
using StreamId = std::uint64_t;

struct Response {
  int status = 200;
  std::string_view type = "text/plain; charset=utf-8";
  /// Of a stream: what it begins with. Null is empty.
  SharedText body;
  /// Not null: the answer is a stream, told here, once its beginning is on the way.
  std::function<void(StreamId)> begin{};
};

[[nodiscard]] Response plainResponse(int status, std::string text);

struct ServerOptions {
  std::string address = "127.0.0.1";
  /// 0 for any that is free.
  std::uint16_t port = 8080;
  /// Of this host, beside its addresses and "localhost".
  std::vector<std::string> names{};
};

/// A web server for a page that is only read. It works on the main thread and never waits for anybody: whoever stops
/// reading, or does not finish his request, is dropped. Visitors, requests and what waits for a visitor are bounded.
class HttpServer {
 public:
  using Handler = std::function<Response(const Request&)>;

  static constexpr std::size_t kMostVisitors = 256;
  /// What may wait for a visitor beyond the beginning of his stream: bytes.
  static constexpr std::size_t kMostWaiting = std::size_t{4} << 20U;
  /// What may wait for all of them, where a piece that several are sent counts once: bytes.
  static constexpr std::size_t kMostWaitingInAll = std::size_t{64} << 20U;
  /// How long a request may take to come, and a reader to take anything.
  static constexpr std::chrono::seconds kPatience{20};

  /// Null, with the reason, when the address cannot be listened on. `clock` must outlive the server.
  static std::unique_ptr<HttpServer> open(const ServerOptions& options, const Clock& clock, Handler handler,
                                          std::string& reason);
  HttpServer(const HttpServer&) = delete;
  HttpServer& operator=(const HttpServer&) = delete;
  ~HttpServer() = default;

  /// Readable when serve() has something to do.
  [[nodiscard]] int descriptor() const { return events_.get(); }
  void serve();
  /// Drops those who have been waited for too long, and while too much waits, him for whom most does; to be called
  /// every second or so.
  void dropSlow();

  /// Sends more of a stream; nothing when its visitor has gone.
  void send(StreamId stream, const SharedText& piece);
  /// Told when a stream's visitor has gone.
  void setStreamEndHandler(std::function<void(StreamId)> handler) { onStreamEnd_ = std::move(handler); }

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
    bool isWatchedForRoom = false;
    Clock::Instant lastProgress;
  };
  using Visitors = std::unordered_map<StreamId, Visitor>;

  HttpServer(FileDescriptor listener, const Clock& clock, Handler handler, std::vector<std::string> names);

  void acceptAll();
  void watch(StreamId id, Visitor& visitor, bool forRoom, bool isNew);
  void receive(StreamId id, Visitor& visitor);
  void answerNext(StreamId id, Visitor& visitor);
  void answer(StreamId id, Visitor& visitor, const Request& request);
  /// Sends what there is room for; false when the visitor is to be dropped.
  [[nodiscard]] bool flush(StreamId id, Visitor& visitor);
  static void queue(Visitor& visitor, SharedText piece);
  void dropIdle();
  /// For whom most waits, while all that waits is too much; absent otherwise.
  [[nodiscard]] std::optional<StreamId> heaviest() const;
  void drop(StreamId id);

  FileDescriptor listener_;
  FileDescriptor events_;
  const Clock& clock_;
  Handler handler_;
  std::vector<std::string> names_;
  std::uint16_t port_ = 0;
  std::function<void(StreamId)> onStreamEnd_;
  /// 0 is the listener's.
  StreamId lastId_ = 0;
  Visitors visitors_;
};

}  // namespace vesk::web
