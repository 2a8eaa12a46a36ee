#include <gtest/gtest.h>
#include <string>
#include <vector>
#include <zlib.h>

#include "diag/capture/capture_reader.h"
#include "diag/capture/capture_remarks.h"
#include "diag/capture/content.h"
#include "support/bytes.h"
#include "support/input.h"
#include "values/text_form.h"

namespace vesk::diag {
namespace {

using Texts = std::vector<std::string>;

std::string textOf(const Bytes& bytes) {
  return {bytes.begin(), bytes.end()};
}

Bytes operator+(Bytes left, const Bytes& right) {
  left.insert(left.end(), right.begin(), right.end());
  return left;
}

/// The log packet of a modem that entered UMTS state `state` so many ticks of 1.25 ms after 1980, from its length on.
Bytes stateLog(std::uint64_t ticks, std::uint8_t state) {
  Bytes packet = bytesOf("0D 00 25 41 00 00");
  for (int shift = 0; shift < 48; shift += 8)
    packet.push_back(static_cast<std::uint8_t>(ticks >> shift));
  packet.push_back(state);
  return packet;
}

Bytes framed(const Bytes& content) {
  Bytes frame;
  appendFrame(frame, content);
  return frame;
}

Bytes stateFrame(std::uint64_t ticks, std::uint8_t state = 0) {
  return framed(bytesOf("10 00 0D 00") + stateLog(ticks, state));
}

Bytes ofSim(std::uint8_t sim, const Bytes& log) {
  return framed(bytesOf("98 01 00 00") + Bytes{sim, 0, 0, 0} + bytesOf("10 00 0D 00") + log);
}

/// 2016.
constexpr std::uint64_t kTicks = 900'000'000'000;

struct Import {
  /// When each event is.
  std::vector<double> at;
  Texts remarks;
};

Import import(const std::string& bytes, std::optional<std::uint32_t> sim = std::nullopt) {
  ByteInput input(fileWith(bytes), "c");
  const CaptureForm form = captureFormOf(tellContent(input)).value();
  CaptureReader capture(std::move(input), form, sim);
  Import result;
  for (auto step = capture.next(); const auto* event = std::get_if<RecordedEvent>(&step); step = capture.next())
    result.at.push_back(event->at);
  result.remarks = remarksOn(capture);
  return result;
}

std::string gzipped(const std::string& bytes) {
  z_stream stream{};
  EXPECT_EQ(deflateInit2(&stream, 6, Z_DEFLATED, MAX_WBITS + 16, 8, Z_DEFAULT_STRATEGY), Z_OK);
  std::string packed(deflateBound(&stream, bytes.size()), '\0');
  std::string unpacked = bytes;
  stream.next_in = reinterpret_cast<Bytef*>(unpacked.data());
  stream.avail_in = static_cast<uInt>(unpacked.size());
  stream.next_out = reinterpret_cast<Bytef*>(packed.data());
  stream.avail_out = static_cast<uInt>(packed.size());
  EXPECT_EQ(deflate(&stream, Z_FINISH), Z_STREAM_END);
  packed.resize(stream.total_out);
  deflateEnd(&stream);
  return packed;
}

TEST(Capture, GivesEventsTheTimeBetweenTheirPackets) {
  const std::uint64_t early = 1000;
  const Bytes capture = stateFrame(early) + stateFrame(early + 800) + stateFrame(kTicks) + stateFrame(kTicks + 1) +
                        stateFrame(kTicks - 8000) + stateFrame(kTicks) + stateFrame(kTicks + 80'000'000, 9) +
                        stateFrame(kTicks + 80'000'000);
  // The clock is set: no time passes; nor does any when it is put back. A packet without an event has no say.
  EXPECT_EQ(import(textOf(capture)).at, (std::vector<double>{0, 1, 1, 1.001, 1.001, 11.001, 100011.001}));
}

TEST(Capture, IsReadAsFarAsItIsWholeAndTellsWhatWasNot) {
  const Bytes one = stateFrame(kTicks);
  const Bytes two = ofSim(2, stateLog(kTicks, 1));
  Bytes nineDamaged;
  for (int count = 0; count < 9; ++count)
    nineDamaged = nineDamaged + bytesOf("01 02 7E");
  Bytes manySims;
  for (std::uint8_t sim = 1; sim <= kMostSims + 1; ++sim)
    manySims = manySims + ofSim(sim, stateLog(kTicks, 1));
  const struct {
    Bytes bytes;
    std::size_t events;
    Texts remarks;
    std::optional<std::uint32_t> sim{};
  } cases[] = {
      {one + one, 2, {}},
      {bytesOf("01 02 7E") + one, 1, {"c: 1 damaged packet was passed over"}},
      {bytesOf("01 02 7E") + one + bytesOf("01 7E"), 1, {"c: 2 damaged packets were passed over"}},
      {nineDamaged + one + bytesOf("01 7E"),
       1,
       {"c: 10 of 11 frames are damaged: did another program read the port meanwhile, as ModemManager does? Stop it, "
        "and capture anew"}},
      {one + bytesOf("10 00"),
       1,
       {"c: it ends within a packet, which is left out: was the program that wrote it ended?"}},
      {stateLog(kTicks, 0) + stateLog(kTicks, 1), 2, {}},
      {stateLog(kTicks, 0) + bytesOf("0D 00 25"),
       1,
       {"c: it ends within a packet, which is left out: was the program that wrote it ended?"}},
      {one + two, 2, {"c: it holds the SIMs 1 and 2, and all are taken; --sim N takes one"}},
      {manySims,
       kMostSims + 1,
       {"c: it names more than 16 SIMs, as no handset does: what is known of one is forgotten for the next; --sim N "
        "takes one"}},
      {one + two, 1, {}, 2},
      {two + framed(bytesOf("98 01 00 00 02 00 00")), 1, {"c: 1 damaged packet was passed over"}, 2},
      {one + two, 0, {"c: no packet is of the SIM that --sim chooses"}, 3},
      {framed(bytesOf("9E 01")),
       0,
       {"c: 1 log packet is encrypted and cannot be read: the modem's maker has the key",
        "c: nothing in it could be read; vesk import --count tells what it holds"}},
      {stateFrame(0),
       1,
       {"c: the modem's clock was not set by a network: dates are of 1980, and only the time between events is right"}},
  };
  for (const auto& row : cases) {
    const Import result = import(textOf(row.bytes), row.sim);
    EXPECT_EQ(result.at.size(), row.events) << hexOf(row.bytes);
    EXPECT_EQ(result.remarks, row.remarks) << hexOf(row.bytes);
  }
}

TEST(Capture, IsToldByItsContent) {
  const std::string frame = textOf(stateFrame(kTicks));
  const Bytes unread = bytesOf("0E 00 01 F0 00 00 00 00 00 00 00 00 03 07");
  const std::string event = R"({"at": 1, "metric": 2, "payload": ""})";
  std::string noise;
  for (int piece = 0; piece < 31; ++piece)
    noise += "\x01\x02\x7E\x7E";
  const struct {
    std::string bytes;
    Content content;
  } cases[] = {
      {"", Content::nothing},
      {frame, Content::frames},
      {noise + frame, Content::frames},
      {noise + "\x01\x7E" + frame, Content::unknown},
      {textOf(stateLog(kTicks, 0)), Content::packetList},
      {textOf(unread + stateLog(kTicks, 0)), Content::packetList},
      {textOf(unread + bytesOf("00 00")), Content::unknown},
      {textOf(stateLog(kTicks, 0) + stateLog(~std::uint64_t{0}, 0)), Content::unknown},
      {event, Content::recording},
      {"\n at 12\n " + event, Content::recording},
      {"at 12\n", Content::text},
      {"at 12", Content::text},
      {"\xD4\xC3\xB2\xA1\x02", Content::networkCapture},
      {"PK\x03\x04", Content::archive},
      {"\x7F"
       "ELF\x02\x01",
       Content::unknown},
  };
  for (const auto& row : cases) {
    for (const bool isPacked : {false, true}) {
      ByteInput input(fileWith(isPacked ? gzipped(row.bytes) : row.bytes), "c");
      EXPECT_EQ(tellContent(input), row.content) << row.bytes;
    }
  }
}

TEST(Capture, IsUnpackedAsFarAsItIsWhole) {
  std::string capture;
  for (std::uint64_t count = 0; count < 10000; ++count)
    capture += textOf(stateFrame(kTicks + count));
  const std::string packed = gzipped(capture);
  EXPECT_EQ(import(packed + packed + "behind the last member").at.size(), 20000U);

  for (const bool isCutOff : {true, false}) {
    std::string bytes = packed.substr(0, isCutOff ? packed.size() / 2 : packed.size());
    // Within the checksum at the end.
    if (!isCutOff) bytes[bytes.size() - 8] ^= 1;
    ByteInput input(fileWith(bytes), "c");
    CaptureReader reader(std::move(input), CaptureForm::frames, std::nullopt);
    std::size_t events = 0;
    auto step = reader.next();
    for (; std::holds_alternative<RecordedEvent>(step); step = reader.next())
      ++events;
    EXPECT_TRUE(isCutOff ? events > 1000 : events == 10000) << events;
    EXPECT_EQ(std::get<ReadFailure>(step).message,
              std::string("c: its compressed data are ") + (isCutOff ? "cut off" : "damaged"));
  }
}

TEST(Capture, BeginsAgainAfterRewinding) {
  CaptureReader reader(ByteInput(fileWith(gzipped(textOf(stateFrame(kTicks) + stateFrame(kTicks + 800)))), "c"),
                       CaptureForm::frames, std::nullopt);
  reader.measure();
  EXPECT_EQ(reader.duration(), 1);
  for (int lap = 0; lap < 2; ++lap) {
    EXPECT_EQ(std::get<RecordedEvent>(reader.next()).at, 0);
    EXPECT_EQ(std::get<RecordedEvent>(reader.next()).at, 1);
    EXPECT_TRUE(std::holds_alternative<EndOfRecording>(reader.next()));
    ASSERT_TRUE(reader.rewind());
  }
}

}  // namespace
}  // namespace vesk::diag
