#include "diag/port/session.h"

#include <functional>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <vector>

#include "diag/framing/frame_reader.h"
#include "support/bytes.h"

namespace vesk::diag {
namespace {

using namespace std::chrono_literals;
using Phase = Session::Phase;
using Texts = std::vector<std::string>;

const std::string kMasksOff = "73 00 00 00 00 00 00 00";
const std::string kSizes = "73 00 00 00 01 00 00 00";
const std::string kDone = " 00 00 00 00";

std::string word(std::uint32_t value) {
  return hexOf(Bytes{static_cast<std::uint8_t>(value), static_cast<std::uint8_t>(value >> 8), 0, 0});
}

/// The answer that tells how many items equipment 4, 5, 7 and 11 have.
std::string sizesAnswer(std::uint32_t umts, std::uint32_t gsm, std::uint32_t nas, std::uint32_t lte) {
  std::string answer = kSizes + kDone;
  for (const std::uint32_t size : {0U, 0U, 0U, 0U, umts, gsm, 0U, nas, 0U, 0U, 0U, lte, 0U, 0U, 0U, 0U})
    answer += ' ' + word(size);
  return answer;
}

std::string contentOf(const Command& command) {
  FrameReader reader;
  reader.take(command.frame());
  return hexOf(reader.next().value().content);
}

/// A session with a modem that gives prepared answers: by what a command begins with, the longest such first; none to
/// what is not listed.
class Talk {
 public:
  using Answers = std::map<std::string, std::string, std::greater<>>;

  explicit Talk(const Answers& changed = {}) {
    for (const auto& [command, answer] : changed)
      answers_[command] = answer;
    go();
  }

  /// Until the modem has nothing more to answer.
  void go() {
    while (const auto command = session.takeCommand()) {
      sent.push_back(contentOf(*command));
      for (const auto& [start, answer] : answers_) {
        if (!sent.back().starts_with(start)) continue;
        if (!answer.empty()) session.takeAnswer(bytesOf(answer), now);
        break;
      }
    }
  }
  void pass(Clock::Duration time) {
    now += time;
    session.advance(now);
    go();
  }

  Session::Instant now{};
  Session session{now};
  Texts sent;

 private:
  Answers answers_ = {
      {"00", "00 31 32"},
      {"7C", "7C 01 00 00 01 00 00 00 02 00 00 00 46 57 1B 31 00 4D 00"},
      {"60 00", "60 00 00"},
      {"7D 05", "7D 05 01 00 00 00 00 00"},
      {kMasksOff, kMasksOff + kDone},
      {kSizes, sizesAnswer(0, 0, 0, 0x0C1)},
      {"73 00 00 00 03 00 00 00", "73 00 00 00 03 00 00 00" + kDone},
  };
};

TEST(Session, AsksForTheLogsThatAreReadAndForNoOthers) {
  const std::string setMask = "73 00 00 00 03 00 00 00 ";
  Talk talk(Talk::Answers{{kSizes, sizesAnswer(0, 0x12F, 0x132, 0x0C3)}});
  const Bytes gsmMask = [] {
    Bytes mask(0x26);
    mask[0x71 / 8] |= 1 << 0x71 % 8;
    mask[0x7A / 8] |= 1 << 0x7A % 8 | 1 << 0x7B % 8;
    return mask;
  }();
  Bytes nasMask(0x27);
  nasMask[0x130 / 8] = 0x03;
  Bytes lteMask(0x19);
  lteMask[0x0C0 / 8] = 0x05;
  const Texts expected = {"00",
                          "7C",
                          "60 00",
                          "7D 05 00 00 00 00 00 00",
                          kMasksOff,
                          kSizes,
                          setMask + word(5) + ' ' + word(0x12F) + ' ' + hexOf(gsmMask),
                          setMask + word(7) + ' ' + word(0x132) + ' ' + hexOf(nasMask),
                          setMask + word(11) + ' ' + word(0x0C3) + ' ' + hexOf(lteMask)};
  EXPECT_EQ(talk.sent, expected);
  EXPECT_EQ(talk.session.phase(), Phase::watching);
  EXPECT_EQ(talk.session.firmware(), "FW1");
  EXPECT_EQ(talk.session.takeRemarks(), Texts{"the modem has no logs of UMTS"});
}

TEST(Session, TellsWhyNoLogComes) {
  const std::string lte = "73 00 00 00 03 00 00 00 0B";
  struct Case {
    Talk::Answers answers;
    std::string failure;
  };
  const Case cases[] = {
      {{{"00", ""}}, "no answer: not a diagnostic port"},
      {{{"00", "00"}}, "no answer: not a diagnostic port"},
      {{{kSizes, "13 " + kSizes}}, "the modem's maker has locked its logs"},
      {{{kMasksOff, "47 " + kMasksOff}, {lte, "47 " + lte}}, "the modem's maker has locked its logs"},
      {{{kSizes, ""}}, "the modem answers, but not which logs it has"},
      {{{kSizes, "18 " + kSizes}}, "the modem does not tell which logs it has (status 24)"},
      {{{kSizes, sizesAnswer(0, 0, 0, 0)}}, "the modem answers, but has none of the logs"},
      {{{lte, "73 00 00 00 03 00 00 00 01 00 00 00"}}, "the modem answers, but has none of the logs"},
      {{{lte, ""}}, "the modem answers, but has none of the logs"},
      {{{"7C", ""}, {"60 00", "13 60 00"}, {"7D 05", ""}, {kMasksOff, ""}}, ""},
  };
  for (const Case& row : cases) {
    Talk talk(row.answers);
    while (talk.session.phase() == Phase::starting || talk.session.phase() == Phase::ending)
      talk.pass(2s);
    EXPECT_TRUE(talk.session.failure().starts_with(row.failure)) << talk.session.failure();
    EXPECT_EQ(talk.session.phase() == Phase::failed, !row.failure.empty()) << row.failure;
    // A modem is never left with logs on; what is none gets nothing more.
    const bool isModem = talk.sent.size() > 2;
    if (talk.session.phase() == Phase::failed) {
      EXPECT_EQ(talk.sent.back(), isModem ? kMasksOff : "00");
    }
  }
}

TEST(Session, GivesAModemTwoTimesTwoSeconds) {
  Talk talk(Talk::Answers{{"00", ""}});
  talk.pass(1999ms);
  EXPECT_EQ(talk.sent, Texts{"00"});
  talk.pass(1ms);
  EXPECT_EQ(talk.sent, (Texts{"00", "00"}));
  EXPECT_EQ(talk.session.deadline(), talk.now + 2s);
  talk.pass(2s);
  EXPECT_EQ(talk.session.phase(), Phase::failed);
}

TEST(Session, NoticesSilenceOnce) {
  Talk talk(Talk::Answers{{kSizes, sizesAnswer(1, 1, 1, 1)}});
  talk.pass(9s);
  talk.session.noteLog(talk.now);
  talk.pass(9s);
  EXPECT_FALSE(talk.session.isSilent());
  talk.pass(1s);
  EXPECT_TRUE(talk.session.isSilent());
  talk.pass(100s);
  EXPECT_EQ(talk.session.takeRemarks().size(), 1U);
  talk.session.noteLog(talk.now);
  EXPECT_FALSE(talk.session.isSilent());
  talk.session.noteEncryptedLog();
  talk.pass(10s);
  EXPECT_TRUE(talk.session.takeRemarks().at(0).starts_with("the modem encrypts its logs"));
}

TEST(Session, EndsTheLogsAndWaitsForTheModemToHaveDoneSo) {
  Talk talk(Talk::Answers{{kMasksOff, ""}});
  talk.pass(2s);
  talk.pass(2s);
  ASSERT_EQ(talk.session.phase(), Phase::watching);
  talk.session.end(talk.now);
  talk.go();
  EXPECT_EQ(talk.sent.back(), kMasksOff);
  // Not the answer to this.
  talk.session.takeAnswer(bytesOf("73 00 00 00 03 00 00 00" + kDone), talk.now);
  EXPECT_EQ(talk.session.phase(), Phase::ending);
  talk.session.takeAnswer(bytesOf(kMasksOff + kDone), talk.now);
  EXPECT_EQ(talk.session.phase(), Phase::ended);
}

}  // namespace
}  // namespace vesk::diag
