#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "insight/insight.h"
#include "system/run_loop.h"
#include "system/timer.h"
#include "toolkit/interface_layout.h"
#include "web/drive_record.h"
#include "web/http/http_server.h"
#include "web/screen_json.h"

namespace vesk::web {

/// What the live page shows; all must outlive it.
struct LiveSources {
  const insight::Insight& insight;
  const InterfaceLayout& layout;
  RowReadings readings;
  /// What the source of the events is at: "simulated", "replaying 3:12 of 9:40".
  std::function<std::string()> state;
  /// Told what keeps visitors away, in one line. May be null.
  std::function<void(const std::string& reason)> remark{};
};

/// Serves the live page, its JSON and the metrics for Prometheus, on the main run loop. Whatever a visitor is shown is
/// written on the main queue, where the stores are; twice a second all are sent the same piece of news.
class LiveServer {
 public:
  /// Null, with the reason, when the address cannot be listened on.
  static std::unique_ptr<LiveServer> open(const ServerOptions& options, LiveSources sources, std::string& reason);
  LiveServer(const LiveServer&) = delete;
  LiveServer& operator=(const LiveServer&) = delete;
  ~LiveServer();

  /// A step of the drive, as the handler of the insight is told it.
  void take(const insight::Report& report, const insight::Step& step);
  [[nodiscard]] std::uint16_t port() const { return server_->port(); }

  /// Answers a request as a visitor's; for tests too.
  [[nodiscard]] Response answer(const Request& request);

 private:
  struct Route;
  /// An answer that stays the same until another event has come, or what is known is a second older.
  struct Kept {
    std::uint64_t events = 0;
    std::int64_t second = 0;
    SharedText text;
  };

  explicit LiveServer(LiveSources sources);
  void start(std::unique_ptr<HttpServer> server);
  void sendNews();
  using AppendDrive = void (*)(std::string& out, const DriveRecord& record, const insight::Insight& insight);
  [[nodiscard]] std::string driveMessage(std::string_view event, const DriveRecord& record, AppendDrive append) const;
  /// The time of the drive, as far as it makes a difference to what is told.
  [[nodiscard]] std::int64_t secondOfDrive() const;

  /// What `write` appends to a text, written once for all who ask as long as it stays the same.
  template <class Write>
  [[nodiscard]] Response kept(const Request& request, Write write);
  [[nodiscard]] Response beginDrive(const Request& request);
  [[nodiscard]] Response menu(const Request& request);
  [[nodiscard]] Response screens(const Request& request);
  [[nodiscard]] Response cells(const Request& request);
  [[nodiscard]] Response timeline(const Request& request);
  [[nodiscard]] Response series(const Request& request);
  [[nodiscard]] Response summary(const Request& request);
  [[nodiscard]] Response metrics(const Request& request);
  [[nodiscard]] Response page(const Request& request);

  LiveSources sources_;
  DriveRecord whole_;
  /// What came since the visitors were told last.
  DriveRecord news_;
  std::string lastState_;
  std::int64_t lastSecond_ = 0;
  std::optional<Clock::Instant> lastEvent_;
  std::unique_ptr<HttpServer> server_;
  /// Those who watch the drive.
  std::set<StreamId> watchers_;
  /// The beginning of a watcher's stream, for those who come before the next news.
  SharedText beginning_;
  /// By path.
  std::map<std::string, Kept, std::less<>> kept_;
  /// A comment of an event stream.
  SharedText silence_ = std::make_shared<const std::string>(":\n\n");
  std::optional<Timer> newsTimer_;
  std::optional<Timer> tendTimer_;
};

}  // namespace vesk::web
