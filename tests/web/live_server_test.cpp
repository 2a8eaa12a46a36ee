#include "web/live_server.h"

#include <gtest/gtest.h>

#include "insight/drive.h"
#include "support/fake_interface.h"
#include "support/manual_clock.h"
#include "web/report_page.h"

namespace vesk::web {
namespace {

using namespace insight;

/// What a payload may hold to take a page over.
constexpr std::string_view kHostile = "</script><img src=x onerror=alert(1)>";

class LiveServerTest : public testing::Test {
 protected:
  LiveServerTest() {
    std::string reason;
    server_ = LiveServer::open({.address = "127.0.0.1", .port = 0},
                               {drive_.insight, interface_.layout(), {}, [this] { return state_; }}, reason);
    drive_.insight.setStepHandler(
        [this](const insight::Report& report, const Step& step) { server_->take(report, step); });
    drive_.play({lteCell(0, 850, 443), lteLevel(500, -125, -20), bearersWithName(600)});
  }

  static DriveEvent bearersWithName(std::int64_t at) {
    return event<KCellularActivatedBearerContexts>(at, K_CELLULAR_ACTIVE_BEARER, [](auto& message) {
      auto bearer = std::make_shared<BearerContext>();
      bearer->setNsapi(5);
      bearer->setApn(Text::copy(kHostile));
      message.addBearerContexts(bearer);
    });
  }

  Response ask(const std::string& target) {
    const RequestHead head = readRequestHead("GET " + target + " HTTP/1.1\r\nHost: localhost\r\n\r\n", {});
    return server_->answer(head.request.value());
  }

  ManualClock clock_;
  RunLoop loop_{clock_};
  FakeInterface interface_;
  Drive drive_;
  std::string state_ = "simulated";
  std::unique_ptr<LiveServer> server_;
};

TEST_F(LiveServerTest, AnswersEveryPath) {
  const std::vector<std::tuple<std::string, std::string_view, std::string_view>> cases{
      {"/", "text/html", "<script src=\"/page.js\"></script>"},
      {"/page.js", "text/javascript", "textContent"},
      {"/page.css", "text/css", ".dygraph"},
      {"/charts.js", "text/javascript", "Dygraph"},
      {"/api/menu", "application/json", R"({"area":"LTE","categories":["NAS","RRC State")"},
      {"/api/screens", "application/json", R"({"area":"LTE","category":"NAS","sections":)"},
      {"/api/screens?area=LTE&category=Tx+Power", "application/json", R"({"area":"LTE","category":"Tx Power")"},
      {"/api/cells", "application/json", R"("code":443,"role":"serving","level":-125)"},
      {"/api/timeline", "application/json", R"("kind":"bearer-up")"},
      {"/api/series", "application/json", R"("lte.rsrp":[500,-125])"},
      {"/api/summary", "application/json", R"({"events":3,"stored":3)"},
      {"/live", "text/event-stream", R"(data: {"state":"simulated","drive":)"},
      {"/metrics", "text/plain; version=0.0.4", "vesk_lte_rsrp_dbm{"},
  };
  for (const auto& [target, type, part] : cases) {
    const Response response = ask(target);
    EXPECT_EQ(response.status, 200) << target;
    EXPECT_TRUE(response.type.starts_with(type)) << target << " is " << response.type;
    EXPECT_NE(response.body->find(part), std::string::npos) << target << " is\n" << *response.body;
    EXPECT_EQ(response.begin != nullptr, target == "/live") << target;
  }
  for (const char* unknown : {"/api", "/live/", "/api/screens?area=LTE&category=None", "/../etc/passwd"})
    EXPECT_EQ(ask(unknown).status, 404) << unknown;
}

TEST_F(LiveServerTest, SharesAnAnswerUntilAnotherEventComes) {
  for (const char* target : {"/api/series", "/api/summary", "/api/screens"}) {
    const SharedText first = ask(target).body;
    EXPECT_EQ(ask(target).body, first) << target;
    drive_.play({lteLevel(700, -120, -20)});
    EXPECT_NE(ask(target).body, first) << target;
  }
  EXPECT_EQ(ask("/charts.js").body, ask("/charts.js").body);
}

TEST_F(LiveServerTest, LetsNoTextOfAPayloadLeaveItsPlace) {
  std::string page;
  writeReport({std::string(kHostile), DriveRecord(kWholeDrive), drive_.insight, interface_.layout(), {}},
              [&](std::string_view piece) { page += piece; });
  EXPECT_NE(page.find("\\u003c/script>\\u003cimg src=x"), std::string::npos);
  EXPECT_EQ(page.find("<img"), std::string::npos);
  EXPECT_EQ(ask("/live").body->find('\n' + std::string("data: ")), std::string("event: drive").size());
  EXPECT_TRUE(ask("/live").body->ends_with("}\n\n"));
}

}  // namespace
}  // namespace vesk::web
