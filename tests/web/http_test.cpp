#include <arpa/inet.h>
#include <cstring>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>

#include "support/manual_clock.h"
#include "web/http/http_server.h"

namespace vesk::web {
namespace {

using namespace std::string_literals;

constexpr std::string_view kHost = "Host: 127.0.0.1:8080\r\n\r\n";

TEST(RequestHead, RefusesWhatIsNotARequestOfThisHost) {
  const std::string longHead = "GET / HTTP/1.1\r\nX: " + std::string(kLongestHead, 'x');
  const std::vector<std::pair<std::string, int>> cases{
      {"GET / HTTP/1.1\r\nHost: 127.0.0.1:8080\r\n\r\n", 0},
      {"GET / HTTP/1.1\r\nhOsT:localhost\r\n\r\n", 0},
      {"HEAD / HTTP/1.1\r\nHost: [::1]:8080\r\n\r\n", 0},
      {"GET / HTTP/1.1\r\nHost: van-3.example.net\r\n\r\n", 0},
      {"GET / HTTP/1.1\r\nHost: evil.example\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\nHost: 127.0.0.1.evil.example\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\nHost: localhost.\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\n\r\n", 400},
      {"GET / HTTP/1.0\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\nHost: localhost:http\r\n\r\n", 400},
      {"GET / HTTP/1.1\r\nHost: 127.0.0.1:65536\r\n\r\n", 400},
      {"GET / HTTP/1.1\r\nHost: 127.0.0.1\0.evil.example\r\n\r\n"s, 400},
      {"GET / HTTP/1.1\r\nHost: localhost\nX: y\r\n\r\n", 400},
      {"GET /\x7f HTTP/1.1\r\nHost: localhost\r\n\r\n", 400},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: none\r\n\r\n", 0},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: same-origin\r\nSec-Fetch-Mode: cors\r\n\r\n", 0},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: same-site\r\nSec-Fetch-Mode: cors\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: cross-site\r\nSec-Fetch-Mode: cors\r\n\r\n", 403},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: cross-site\r\nSec-Fetch-Mode: navigate\r\n"
       "Sec-Fetch-Dest: document\r\n\r\n",
       0},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nSec-Fetch-Site: cross-site\r\nSec-Fetch-Mode: navigate\r\n"
       "Sec-Fetch-Dest: iframe\r\n\r\n",
       403},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nHost: evil.example\r\n\r\n", 400},
      {"POST / HTTP/1.1\r\nHost: localhost\r\n\r\n", 405},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 5\r\n\r\n", 413},
      {"GET / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: chunked\r\n\r\n", 413},
      {"GET /%4 HTTP/1.1\r\nHost: localhost\r\n\r\n", 400},
      {"GET http://localhost/ HTTP/1.1\r\nHost: localhost\r\n\r\n", 400},
      {"GET / HTTP/1.1\r\nHost : localhost\r\n\r\n", 400},
      {"GET / HTTP/2.0\r\nHost: localhost\r\n\r\n", 505},
      {"\r\n\r\n", 400},
      {longHead, 431},
  };
  for (const auto& [bytes, refusal] : cases) {
    const RequestHead head = readRequestHead(bytes, {"van-3.example.net"});
    EXPECT_EQ(head.refusal, refusal) << bytes.substr(0, 80);
    EXPECT_EQ(head.request.has_value(), refusal == 0) << bytes.substr(0, 80);
    for (std::size_t size = 0; refusal == 0 && size < bytes.size(); ++size)
      EXPECT_EQ(readRequestHead(bytes.substr(0, size), {}).size, 0U) << "cut at " << size;
  }
}

TEST(RequestHead, DecodesPathAndParameters) {
  const RequestHead head = readRequestHead(
      "GET /live/screen%3f?area=LTE&category=Tx+Power%26&area=GSM&=&x HTTP/1.0\r\n" + std::string(kHost), {});
  ASSERT_TRUE(head.request);
  EXPECT_EQ(head.request->path, "/live/screen?");
  EXPECT_EQ(head.request->parameter("area"), "LTE");
  EXPECT_EQ(head.request->parameter("category"), "Tx Power&");
  EXPECT_EQ(head.request->parameter("none"), "");
  EXPECT_TRUE(head.request->isLast);
}

/// A server on a free port whose "/stream" goes on, and whose other pages say their path.
class ServerTest : public testing::Test {
 protected:
  ServerTest() {
    std::string reason;
    server_ = HttpServer::open(
        {.address = "127.0.0.1", .port = 0}, clock_,
        [this](const Request& request) {
          ++answers_;
          Response response = plainResponse(200, request.path);
          if (request.path == "/stream") response.begin = [this](StreamId stream) { streams_.push_back(stream); };
          return response;
        },
        reason);
    server_->setStreamEndHandler([this](StreamId stream) { std::erase(streams_, stream); });
  }

  FileDescriptor visitor(const std::string& says) {
    FileDescriptor connection = newcomer(says);
    serve();
    return connection;
  }

  /// Who has not been noticed yet.
  FileDescriptor newcomer(const std::string& says) {
    FileDescriptor connection(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0));
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(server_->port());
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    constexpr int kSmall = 4096;
    setsockopt(connection.get(), SOL_SOCKET, SO_RCVBUF, &kSmall, sizeof kSmall);
    // NOLINTNEXTLINE(cppcoreguidelines-pro-type-reinterpret-cast): the interface of sockets
    EXPECT_EQ(connect(connection.get(), reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    EXPECT_EQ(send(connection.get(), says.data(), says.size(), 0), static_cast<ssize_t>(says.size()));
    return connection;
  }

  void serve() {
    pollfd ready{server_->descriptor(), POLLIN, 0};
    constexpr int kPatience = 5000;
    for (int timeout = kPatience; poll(&ready, 1, timeout) > 0; timeout = 0)
      server_->serve();
  }

  static std::string heard(const FileDescriptor& connection) {
    std::string text(65536, '\0');
    const ssize_t size = recv(connection.get(), text.data(), text.size(), MSG_DONTWAIT);
    text.resize(size < 0 ? 0 : static_cast<std::size_t>(size));
    return text;
  }

  ManualClock clock_;
  std::unique_ptr<HttpServer> server_;
  std::vector<StreamId> streams_;
  int answers_ = 0;
};

TEST_F(ServerTest, AnswersRequestsBehindEachOther) {
  FileDescriptor connection =
      newcomer("GET /one HTTP/1.1\r\n" + std::string(kHost) + "HEAD /two HTTP/1.1\r\n" + std::string(kHost) +
               "GET /three HTTP/1.1\r\nConnection: close\r\n" + std::string(kHost));
  for (int before = 0; before < 3; before = answers_) {
    pollfd ready{server_->descriptor(), POLLIN, 0};
    ASSERT_EQ(poll(&ready, 1, 5000), 1);
    server_->serve();
    ASSERT_LE(answers_, before + 1) << "one has one turn";
  }
  const std::string text = heard(connection);
  EXPECT_NE(text.find("\r\n\r\n/one\n"), std::string::npos);
  EXPECT_EQ(text.find("/two\n"), std::string::npos);
  EXPECT_TRUE(text.ends_with("\r\n\r\n/three\n")) << text;
  connection = FileDescriptor();
  serve();
  EXPECT_EQ(server_->visitorCount(), 0U);
}

TEST_F(ServerTest, SendsAStreamUntilItsVisitorGoes) {
  FileDescriptor connection = visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost));
  ASSERT_EQ(streams_.size(), 1U);
  server_->send(streams_[0], std::make_shared<const std::string>("more"));
  EXPECT_TRUE(heard(connection).ends_with("/stream\nmore"));
  connection = FileDescriptor();
  serve();
  EXPECT_TRUE(streams_.empty());
}

TEST_F(ServerTest, DropsWhoStopsReadingAndServesTheOthers) {
  const FileDescriptor deaf = visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost));
  const StreamId stream = streams_.at(0);
  const FileDescriptor other = visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost));
  const auto piece = std::make_shared<const std::string>(HttpServer::kMostWaiting / 8, 'x');
  int sent = 0;
  for (; sent < 20 && streams_.size() == 2; ++sent)
    server_->send(stream, piece);
  EXPECT_EQ(streams_.size(), 1U);
  EXPECT_GE(sent, 8);
  heard(other);
  server_->send(streams_[0], std::make_shared<const std::string>("news"));
  EXPECT_EQ(heard(other), "news");
}

TEST_F(ServerTest, DropsWhoIsWaitedForTooLong) {
  const FileDescriptor slow = visitor("GET / HT");
  const FileDescriptor watcher = visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost));
  clock_.advance(HttpServer::kPatience + std::chrono::seconds(1));
  server_->tend();
  EXPECT_EQ(server_->visitorCount(), 1U);
  EXPECT_EQ(streams_.size(), 1U) << "who has nothing to be sent is not waited for";
  const auto silence = std::make_shared<const std::string>(":");
  server_->sendToQuiet(HttpServer::kPatience, silence);
  server_->sendToQuiet(HttpServer::kPatience, silence);
  EXPECT_TRUE(heard(watcher).ends_with("/stream\n:")) << "he is quiet no more";
}

TEST_F(ServerTest, DropsWhoTakesLittleByLittle) {
  const FileDescriptor slow = visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost));
  server_->send(streams_.at(0), std::make_shared<const std::string>(HttpServer::kMostWaiting, 'x'));
  const auto begin = clock_.now();
  while (!streams_.empty() && clock_.now() < begin + 2 * HttpServer::kLongestWait) {
    for (std::size_t taken = 0; !streams_.empty() && taken < HttpServer::kMostWaiting / 16; server_->serve())
      taken += heard(slow).size();
    clock_.advance(HttpServer::kPatience * 3 / 4);
    server_->tend();
  }
  EXPECT_TRUE(streams_.empty());
  EXPECT_GE(clock_.now(), begin + HttpServer::kLongestWait);
}

TEST_F(ServerTest, LetsOneReadWhyHeIsRefused) {
  const FileDescriptor teller =
      visitor("POST / HTTP/1.1\r\nContent-Length: 20000\r\n" + std::string(kHost) + std::string(20000, 'x'));
  EXPECT_TRUE(heard(teller).starts_with("HTTP/1.1 405 "));
  char rest = 0;
  EXPECT_EQ(recv(teller.get(), &rest, 1, MSG_DONTWAIT), 0) << "the end, not a reset";
  EXPECT_EQ(server_->visitorCount(), 1U);
  clock_.advance(HttpServer::kFarewell + std::chrono::seconds(1));
  server_->tend();
  EXPECT_EQ(server_->visitorCount(), 0U);
}

TEST_F(ServerTest, ListensAgainWhenThereAreDescriptors) {
  std::vector<std::string> remarks;
  server_->setRemarkHandler([&](const std::string& remark) { remarks.push_back(remark); });
  std::vector<FileDescriptor> newcomers;
  newcomers.reserve(2);
  for (int count = 0; count < 2; ++count)
    newcomers.push_back(newcomer("GET / HTTP/1.1\r\n" + std::string(kHost)));
  rlimit usual{};
  getrlimit(RLIMIT_NOFILE, &usual);
  const FileDescriptor last(dup(server_->descriptor()));
  const rlimit none{static_cast<rlim_t>(last.get()) + 1, usual.rlim_max};
  setrlimit(RLIMIT_NOFILE, &none);
  for (int count = 0; count < 2; ++count) {
    pollfd ready{server_->descriptor(), POLLIN, 0};
    EXPECT_EQ(poll(&ready, 1, 5000), 1) << "newcomers wait";
    server_->serve();
    EXPECT_EQ(poll(&ready, 1, 0), 0) << "and are not announced again";
    server_->tend();
  }
  setrlimit(RLIMIT_NOFILE, &usual);
  EXPECT_EQ(remarks, std::vector<std::string>{"visitors wait to enter: Too many open files"});
  serve();
  for (const FileDescriptor& each : newcomers)
    EXPECT_TRUE(heard(each).starts_with("HTTP/1.1 200 "));
}

TEST_F(ServerTest, BoundsWhatWaitsForAllAtOnce) {
  std::vector<FileDescriptor> visitors;
  visitors.reserve(30);
  for (int count = 0; count < 30; ++count)
    visitors.push_back(visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost)));
  const auto send = [&](std::size_t count, std::size_t size) {
    for (std::size_t at = 0; at < count; ++at)
      server_->send(streams_.at(at), std::make_shared<const std::string>(size, 'x'));
  };
  const std::string request = "GET / HTTP/1.1\r\n" + std::string(kHost);
  constexpr std::size_t kSize = std::size_t{3} << 20U;
  send(15, kSize);
  EXPECT_TRUE(heard(visitor(request)).starts_with("HTTP/1.1 200 "));
  const auto shared = std::make_shared<const std::string>(kSize, 'x');
  for (const StreamId each : std::vector(streams_.begin() + 15, streams_.end()))
    server_->send(each, shared);
  EXPECT_EQ(streams_.size(), 30U) << "what all are sent is held once";
  EXPECT_TRUE(heard(visitor(request)).starts_with("HTTP/1.1 503 ")) << "as much waits as leaves room for streams";
  send(15, kSize / 3);
  EXPECT_EQ(streams_.size(), 30U);
  send(1, kSize / 2);
  EXPECT_EQ(streams_.size(), 29U) << "he for whom most waits has gone, nobody had to tend";
}

TEST_F(ServerTest, RefusesMoreVisitorsThanItHasRoomFor) {
  std::vector<FileDescriptor> visitors;
  for (std::size_t count = 0; count < HttpServer::kMostVisitors; ++count)
    visitors.push_back(visitor("GET /stream HTTP/1.1\r\n" + std::string(kHost)));
  EXPECT_TRUE(heard(visitor("GET / HTTP/1.1\r\n" + std::string(kHost))).starts_with("HTTP/1.1 503 "));
  visitors.pop_back();
  serve();
  EXPECT_TRUE(heard(visitor("GET / HTTP/1.1\r\n" + std::string(kHost))).starts_with("HTTP/1.1 200 "));
}

}  // namespace
}  // namespace vesk::web
