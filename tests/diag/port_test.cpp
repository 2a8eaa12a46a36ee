#include <algorithm>
#include <condition_variable>
#include <gtest/gtest.h>
#include <iterator>
#include <mutex>
#include <string>
#include <vector>

#include "diag/modem.h"
#include "diag/port/port_remarks.h"
#include "diag/port/port_service.h"
#include "messages/registry/metric_identifiers.h"
#include "support/manual_clock.h"

namespace vesk::diag {
namespace {

using namespace std::chrono_literals;
using Texts = std::vector<std::string>;

const std::string kNoMasks = "73 00 00 00 00 00 00 00";
/// An LTE cell, which gives two events.
const std::string kCellPacket =
    "10 00 29 00 29 00 C2 B0 4C 6B 4E 4E 2A CA D3 00 03 B9 00 94 16 00 00 E4 5C 00 00 32 32 11 86 A4 02 08 54 11 00 00 "
    "00 36 01 03 9A 01 00";

/// A client that always wants metrics, and notes what it gets in words.
class NotingClient final : public ::corvik::EventStream {
 public:
  void raise(const Text&, InterProcessDictionary) override {}
  void deliver(const Text&, InterProcessDictionary message) override {
    std::string text = std::to_string(message.integer(::corvik::kKeyMetricID).value());
    note(text);
  }
  void afterDelivery(Task task) override { task(); }
  [[nodiscard]] bool waitUntilWanted(const std::stop_token& stop) override { return !stop.stop_requested(); }

  void note(std::string text) {
    const std::lock_guard lock(mutex_);
    texts_.push_back(std::move(text));
    noted_.notify_all();
  }
  /// All up to one that holds `text`; what there was, if that never came.
  Texts upTo(const std::string& text) {
    std::unique_lock lock(mutex_);
    const auto isLast = [&text](const std::string& each) { return each.find(text) != std::string::npos; };
    const auto hasCome = [&] { return std::any_of(texts_.begin(), texts_.end(), isLast); };
    EXPECT_TRUE(noted_.wait_for(lock, 10s, hasCome)) << text;
    Texts taken;
    while (!texts_.empty() && (taken.empty() || !isLast(taken.back()))) {
      taken.push_back(texts_.front());
      texts_.erase(texts_.begin());
    }
    return taken;
  }

 private:
  std::mutex mutex_;
  std::condition_variable noted_;
  Texts texts_;
};

class PortServiceTest : public testing::Test {
 protected:
  void connect() {
    service_.emplace(Port(modem_.path()), std::nullopt, clock_);
    service_->setRemarkHandler([this](const std::string& remark) { client_.note(remark); });
    service_->setEndHandler([this](const std::string& failure) { client_.note("end: " + failure); });
    service_->setFrameHandler([this](std::span<const std::uint8_t> content) {
      if (content[0] == 0x10) client_.note("frame");
    });
    service_->connect(client_);
  }
  /// The service stops in a thread of its own, for it waits for the modem.
  void stop() {
    std::jthread stopping([this] { service_->disconnect(client_); });
    EXPECT_EQ(modem_.next(), kNoMasks);
    modem_.send(kNoMasks + " 00 00 00 00");
  }
  /// Lets the time pass that the service waits, and no more.
  void passTime() { clock_.advance(clock_.waitForSleeper()); }

  ManualClock clock_;
  NotingClient client_;
  Modem modem_;
  std::optional<PortService> service_;
};

TEST_F(PortServiceTest, RaisesWhatTheModemLogsAndEndsItsLogs) {
  connect();
  modem_.answerUntilItWatches();
  modem_.sendBytes(bytesOf("01 02 03 7E"));
  modem_.send("92 01");
  modem_.send(kCellPacket);
  const std::string cell = std::to_string(K_LTE_SCELL_INFO);
  const std::string carriers = std::to_string(K_LTE_COMPCARR_INFO);
  Texts noted = client_.upTo(carriers);
  std::erase(noted, "frame");
  EXPECT_EQ(Texts(noted.end() - 2, noted.end()), (Texts{cell, carriers}));
  const PortState state = service_->state();
  EXPECT_EQ(state.phase, PortState::Phase::watching);
  EXPECT_EQ(state.damaged, 1U);
  EXPECT_EQ(state.dropped, 0U);
  stop();
  EXPECT_EQ(service_->state().phase, PortState::Phase::ended);
}

TEST_F(PortServiceTest, WaitsForAnUnpluggedModemAndSetsItsMasksAnew) {
  connect();
  modem_.answerUntilItWatches();
  modem_.send(kCellPacket);
  client_.upTo(std::to_string(K_LTE_COMPCARR_INFO));
  modem_.unplug();
  client_.upTo("was unplugged");
  passTime();
  modem_.plugIn();
  passTime();
  client_.upTo("is back");
  modem_.answerUntilItWatches();
  modem_.send(kCellPacket);
  client_.upTo(std::to_string(K_LTE_COMPCARR_INFO));
  stop();
}

TEST_F(PortServiceTest, TellsThatNothingAnswers) {
  connect();
  for (int attempt = 0; attempt < 2; ++attempt) {
    EXPECT_EQ(modem_.next(), "00");
    modem_.sendBytes(bytesOf("0D 0A 45 52 52 4F 52 0D 0A"));
    passTime();
  }
  EXPECT_TRUE(client_.upTo("end: ").back().starts_with("end: " + modem_.path() + ": no answer"));
  service_->disconnect(client_);
}

TEST_F(PortServiceTest, TellsOfSilence) {
  connect();
  modem_.answerUntilItWatches();
  while (service_->state().phase != PortState::Phase::silent)
    passTime();
  client_.upTo("no log for 10 s");
  stop();
}

TEST_F(PortServiceTest, SaysOnceWhatIsWrongWithWhatComes) {
  connect();
  modem_.answerUntilItWatches();
  for (int time = 0; time < 2; ++time) {
    for (int count = 0; count < 10; ++count)
      modem_.sendBytes(bytesOf("01 02 03 7E"));
    modem_.send("98 01 00 00 02 00 00 00 " + kCellPacket);
    modem_.send("10 00 0D 00 0D 00 25 41 00 00 00 00 00 00 00 00 01");
  }
  // What comes before the service has the last answer is another program's. The rest is read at the end.
  Texts noted = client_.upTo("dates are of 1980");
  stop();
  client_.note("end");
  std::ranges::move(client_.upTo("end"), std::back_inserter(noted));
  for (const std::string part :
       {" frames are damaged: does another program", "the SIMs 2 and 1", "dates are of 1980"}) {
    const auto holds = [&part](const std::string& text) { return text.find(part) != std::string::npos; };
    EXPECT_EQ(std::count_if(noted.begin(), noted.end(), holds), 1) << part;
  }
}

TEST(PortRemarks, TellOnceOfASimThatDoesNotCome) {
  PacketCounts counts;
  PortRemarks remarks;
  std::size_t said = 0;
  for (int count = 0; count < 1000; ++count) {
    counts.noteOtherSim();
    said += remarks.take(counts).size();
    EXPECT_LE(said, count < 100 ? 0U : 1U);
  }
  EXPECT_EQ(said, 1U);
}

TEST(Port, TellsWhyItCannotBeOpened) {
  EXPECT_TRUE(Port("/no/such/port").failure().starts_with("/no/such/port: there is no such port"));
  EXPECT_TRUE(Port("/proc/self/exe").failure().find("/proc/self/exe: ") == 0);
  Modem modem;
  const Port port(modem.path());
  EXPECT_TRUE(port.isTerminal());
  const Port second(modem.path());
  EXPECT_FALSE(second.isOpen());
  EXPECT_NE(second.failure().find("another program holds this port"), std::string::npos);
  char file[] = "/tmp/vesk-no-port-XXXXXX";
  const FileDescriptor descriptor(mkstemp(file));
  EXPECT_NE(Port(file).failure().find("this is a file, and no port"), std::string::npos);
  unlink(file);
}

TEST(EventQueue, DropsMeasurementsButNoStatesWhileTheClientIsBehind) {
  EventQueue queue;
  for (std::size_t count = 0; count < EventQueue::kMostWaiting + 5; ++count)
    queue.add({K_LTE_RSRP_RSRQ_SINR, 0, {}}, {});
  queue.add({K_LTE_RRC_STATE, 0, {}}, {});
  EXPECT_EQ(queue.dropped(), 5U);
  std::int64_t last = 0;
  for (std::size_t count = 0; count < EventQueue::kMostWaiting + 1; ++count)
    last = queue.take({}).value().integer(::corvik::kKeyMetricID).value();
  EXPECT_EQ(last, K_LTE_RRC_STATE);
}

}  // namespace
}  // namespace vesk::diag
