#include "web/live_server.h"

#include <algorithm>
#include <array>

#include "insight/summary_form.h"
#include "web/drive_json.h"
#include "web/page_parts.h"
#include "web/prometheus_text.h"

namespace vesk::web {

namespace {

constexpr std::chrono::milliseconds kNewsInterval{500};
/// What a chart can show of half a second; and of a burst of events, what a person can read of it.
constexpr RecordLimits kNews{.points = 32, .changes = 32, .eventsOfKind = 50};
/// Twice what the page shows at first is whole.
constexpr RecordLimits kLiveDrive{.points = 4096, .changes = 8192, .eventsOfKind = 200, .whole = 600'000};

/// A connection that says nothing for long is cut on its way, and nobody notices when its visitor is gone.
constexpr std::chrono::seconds kLongestSilence{15};

constexpr std::string_view kJson = "application/json; charset=utf-8";
constexpr std::string_view kStream = "text/event-stream; charset=utf-8";
constexpr std::string_view kScript = "text/javascript; charset=utf-8";

SharedText shared(std::string text) {
  return std::make_shared<const std::string>(std::move(text));
}

/// What `write` writes, as an answer.
template <class Write>
Response jsonResponse(Write write) {
  std::string out;
  JsonWriter json(out);
  write(json);
  json.finish();
  return {.type = kJson, .body = shared(std::move(out))};
}

std::string servedPage() {
  std::string page(kPageHtml.content);
  constexpr std::array<std::pair<std::string_view, std::string_view>, 4> kMarks{{
      {"{{policy}}", ""},
      {"{{style}}", "<link rel=\"stylesheet\" href=\"/page.css\">\n<link rel=\"icon\" href=\"/icon.svg\">"},
      {"{{drive}}", ""},
      {"{{script}}", "<script src=\"/charts.js\"></script>\n<script src=\"/page.js\"></script>"},
  }};
  for (const auto& [mark, content] : kMarks)
    page.replace(page.find(mark), mark.size(), content);
  return page;
}

/// The answers that never change, by their paths: all who ask share them.
const std::map<std::string_view, Response>& pageParts() {
  static const std::map<std::string_view, Response> kParts = [] {
    const auto part = [](std::string_view type, std::string content) {
      return Response{.type = type, .body = shared(std::move(content))};
    };
    return std::map<std::string_view, Response>{
        {"/", part("text/html; charset=utf-8", servedPage())},
        {"/page.css", part("text/css; charset=utf-8", std::string(kPageStyle.content))},
        {"/icon.svg", part("image/svg+xml", std::string(kPageIcon.content))},
        {"/charts.js", part(kScript, std::string(kChartScript.content))},
        {"/page.js", part(kScript, std::string(kPageScript.content))},
    };
  }();
  return kParts;
}

}  // namespace

struct LiveServer::Route {
  std::string_view path;
  Response (LiveServer::*answer)(const Request& request);
};

std::unique_ptr<LiveServer> LiveServer::open(const ServerOptions& options, LiveSources sources, std::string& reason) {
  std::unique_ptr<LiveServer> live(new LiveServer(std::move(sources)));
  auto server = HttpServer::open(
      options, RunLoop::main().clock(), [&page = *live](const Request& request) { return page.answer(request); },
      reason);
  if (server == nullptr) return nullptr;
  live->start(std::move(server));
  return live;
}

LiveServer::LiveServer(LiveSources sources) : sources_(std::move(sources)), whole_(kLiveDrive), news_(kNews) {}

LiveServer::~LiveServer() {
  if (server_ != nullptr) RunLoop::main().removeInput(server_->descriptor());
}

void LiveServer::start(std::unique_ptr<HttpServer> server) {
  server_ = std::move(server);
  server_->setRemarkHandler(std::move(sources_.remark));
  server_->setStreamEndHandler([this](StreamId stream) { watchers_.erase(stream); });
  RunLoop& loop = RunLoop::main();
  loop.addInput(server_->descriptor(), [this] { server_->serve(); });
  newsTimer_.emplace(loop, kNewsInterval, RunLoopMode::defaultMode, [this] { sendNews(); });
  tendTimer_.emplace(loop, std::chrono::seconds(1), RunLoopMode::defaultMode, [this] {
    server_->tend();
    server_->sendToQuiet(kLongestSilence, silence_);
  });
}

void LiveServer::take(const insight::Report& report, const insight::Step& step) {
  lastEvent_ = RunLoop::main().clock().now();
  whole_.take(sources_.insight, report, step);
  news_.take(sources_.insight, report, step);
}

std::string LiveServer::driveMessage(std::string_view event, const DriveRecord& record, AppendDrive append) const {
  std::string message = "event: " + std::string(event) + "\ndata: {\"state\":";
  appendJson(message, std::string_view(sources_.state()));
  message += ",\"drive\":";
  append(message, record, sources_.insight);
  return message + "}\n\n";
}

/// Those who have come since the last news have seen them: they were sent the whole drive.
void LiveServer::sendNews() {
  std::string state = sources_.state();
  const std::int64_t second = secondOfDrive();
  const bool isNothingNew = news_.isEmpty() && state == lastState_ && second == lastSecond_;
  if (!watchers_.empty() && !isNothingNew) {
    const SharedText message = shared(driveMessage("news", news_, appendNewsJson));
    const std::vector<StreamId> watchers(watchers_.begin(), watchers_.end());
    for (const StreamId watcher : watchers)
      server_->send(watcher, message);
  }
  lastState_ = std::move(state);
  lastSecond_ = second;
  news_.clear();
  beginning_.reset();
}

Response LiveServer::answer(const Request& request) {
  static constexpr std::array<Route, 13> kRoutes{{
      {"/", &LiveServer::page},
      {"/page.css", &LiveServer::page},
      {"/icon.svg", &LiveServer::page},
      {"/charts.js", &LiveServer::page},
      {"/page.js", &LiveServer::page},
      {"/live", &LiveServer::beginDrive},
      {"/api/menu", &LiveServer::menu},
      {"/api/screens", &LiveServer::screens},
      {"/api/cells", &LiveServer::cells},
      {"/api/timeline", &LiveServer::timeline},
      {"/api/series", &LiveServer::series},
      {"/api/summary", &LiveServer::summary},
      {"/metrics", &LiveServer::metrics},
  }};
  const auto* route =
      std::find_if(kRoutes.begin(), kRoutes.end(), [&](const Route& each) { return each.path == request.path; });
  return route == kRoutes.end() ? plainResponse(404, "There is no such page.") : (this->*route->answer)(request);
}

template <class Write>
Response LiveServer::kept(const Request& request, Write write) {
  Kept& kept = kept_[request.path];
  const std::uint64_t events = sources_.insight.counts().all;
  const std::int64_t second = secondOfDrive();
  if (kept.text == nullptr || kept.events != events || kept.second != second) {
    std::string text;
    write(text);
    kept = {events, second, shared(std::move(text))};
  }
  return {.type = kJson, .body = kept.text};
}

Response LiveServer::page(const Request& request) {
  return pageParts().at(request.path);
}

/// News that were not sent yet are sent to a new watcher nevertheless: so the others' are sent first.
Response LiveServer::beginDrive(const Request& /*request*/) {
  if (beginning_ == nullptr) {
    if (!news_.isEmpty()) sendNews();
    beginning_ = shared(driveMessage("drive", whole_, appendDriveJson));
  }
  return {.type = kStream, .body = beginning_, .begin = [this](StreamId stream) { watchers_.insert(stream); }};
}

Response LiveServer::menu(const Request& /*request*/) {
  return jsonResponse([&](JsonWriter& json) { writeMenuJson(json, sources_.layout); });
}

Response LiveServer::screens(const Request& request) {
  if (request.query.empty())
    return kept(request, [&](std::string& out) {
      JsonWriter json(out);
      writeScreensJson(json, sources_.layout, sources_.readings);
      json.finish();
    });
  ScreenWalk walk(sources_.layout);
  if (!walk.open(request.parameter("area"), request.parameter("category")))
    return plainResponse(404, "There is no such screen; /api/menu tells which there are.");
  return jsonResponse([&](JsonWriter& json) { walk.writeJson(json, sources_.readings); });
}

Response LiveServer::cells(const Request& /*request*/) {
  return jsonResponse([&](JsonWriter& json) { insight::writeJson(json, sources_.insight.cellsHeard()); });
}

Response LiveServer::timeline(const Request& /*request*/) {
  return jsonResponse([&](JsonWriter& json) {
    writeJsonArray(json, sources_.insight.happenings(),
                   [&](const insight::TimelineEvent& each) { writeJson(json, each); });
  });
}

Response LiveServer::series(const Request& request) {
  return kept(request, [&](std::string& out) { appendDriveJson(out, whole_, sources_.insight); });
}

Response LiveServer::summary(const Request& request) {
  return kept(request, [&](std::string& out) { out = insight::summaryJson(sources_.insight); });
}

Response LiveServer::metrics(const Request& /*request*/) {
  std::optional<std::chrono::milliseconds> quiet;
  if (lastEvent_) {
    quiet = std::chrono::duration_cast<std::chrono::milliseconds>(RunLoop::main().clock().now() - *lastEvent_);
  }
  return {.type = "text/plain; version=0.0.4; charset=utf-8",
          .body = shared(prometheusText(sources_.insight, quiet, server_ == nullptr ? 0 : server_->visitorCount()))};
}

std::int64_t LiveServer::secondOfDrive() const {
  return sources_.insight.now().value_or(0) / 1000;
}

}  // namespace vesk::web
