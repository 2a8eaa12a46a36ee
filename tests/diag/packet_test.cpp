#include <gtest/gtest.h>
#include <string>
#include <string_view>

#include "diag/framing/packet_list_reader.h"
#include "diag/framing/packet_reader.h"
#include "support/bytes.h"

namespace vesk::diag {
namespace {

constexpr std::string_view kTime = "00 00 00 00 00 00 00 00";

std::string textOf(const LogPacket& packet) {
  return hexOf(Bytes{static_cast<std::uint8_t>(packet.code >> 8), static_cast<std::uint8_t>(packet.code)}) + " sim " +
         std::to_string(packet.sim) + " at " + std::to_string(packet.milliseconds) + ": " + hexOf(packet.body);
}

std::string textOf(const Packet& packet) {
  switch (packet.kind) {
    case PacketKind::log:
      return textOf(*packet.log);
    case PacketKind::events:
      return "events";
    case PacketKind::debugMessage:
      return "debug message";
    case PacketKind::answer:
      return "answer " + hexOf(packet.content);
    case PacketKind::refusal:
      return "refusal";
    case PacketKind::encryptedLog:
      return "encrypted";
    case PacketKind::unknown:
      return "unknown";
    case PacketKind::damaged:
      return "damaged";
  }
  return "";
}

TEST(Packet, IsToldByItsFirstByteAndReadWithinItsLength) {
  const std::string time(kTime);
  const struct {
    std::string content;
    std::string read;
  } cases[] = {
      {"10 00 0E 00 0E 00 C2 B0 " + time + "03 07", "B0 C2 sim 1 at 315964800000: 03 07"},
      {"10 00 00 00 0D 00 C2 B0 " + time + "03 07", "B0 C2 sim 1 at 315964800000: 03"},
      {"10 00 0C 00 0C 00 C2 B0 " + time, "B0 C2 sim 1 at 315964800000: "},
      {"10 00 0C 00 0C 00 C2 B0 FF FF 07 00 00 00 00 00", "B0 C2 sim 1 at 315964800008: "},
      {"10 00 0C 00 0C 00 C2 B0 FF FF FF FF FF FF FF FF", "B0 C2 sim 1 at 352159685688318: "},
      {"10 00 0C 00 0D 00 C2 B0 " + time, "damaged"},
      {"10 00 0C 00 0B 00 C2 B0 " + time, "damaged"},
      {"10 00 0C 00 0C 00 C2 B0 00 00 00 00 00 00 00", "damaged"},
      {"10", "damaged"},

      {"98 01 00 00 02 00 00 00 10 00 0C 00 0C 00 7F B1 " + time, "B1 7F sim 2 at 315964800000: "},
      {"98 01 00 00 00 00 00 00 10 00 0C 00 0C 00 7F B1 " + time, "B1 7F sim 1 at 315964800000: "},
      {"98 01 00 00 FF FF FF FF 10 00 0C 00 0C 00 7F B1 " + time, "B1 7F sim 1 at 315964800000: "},
      {"98 01 00 00 02 00 00 00 73 01", "answer 73 01"},
      {"98 01 00 00 02 00 00 00 98 01 00 00 01 00 00 00 73", "unknown"},
      {"98 01 00 00 02 00 00 00", "damaged"},
      {"98", "damaged"},

      {"60 00 00", "events"},
      {"92 01", "debug message"},
      {"13 73", "refusal"},
      {"9E 01", "encrypted"},
      {"FF", "unknown"},
  };
  for (const auto& row : cases)
    EXPECT_EQ(textOf(readPacket(bytesOf(row.content))), row.read) << row.content;
}

TEST(PacketList, EndsWithTheFirstDamage) {
  const std::string time(kTime);
  const std::string first = "0E 00 C2 B0 " + time + "03 07 ";
  const std::string second = "0C 00 79 B1 " + time;
  const std::string both = "B0 C2 sim 1 at 315964800000: 03 07\nB1 79 sim 1 at 315964800000: \n";
  const struct {
    std::string bytes;
    std::string read;
  } cases[] = {
      {first + second, both},
      {first + second + "0B 00" + first, both + "damaged"},
      {first + second + "0D 00 C2 B0" + time, both + "damaged"},
      {first + second + "0C", both + "damaged"},
      {"", ""},
  };
  for (const auto& row : cases) {
    const Bytes bytes = bytesOf(row.bytes);
    for (const std::size_t pieceSize : {1U, 5U, 16U, 100U}) {
      std::string read;
      PacketListReader reader;
      for (std::size_t begin = 0; begin < bytes.size(); begin += pieceSize) {
        reader.take(std::span(bytes).subspan(begin, std::min(pieceSize, bytes.size() - begin)));
        while (const auto packet = reader.next())
          read += textOf(*packet) + '\n';
      }
      reader.end();
      if (reader.isDamaged()) read += "damaged";
      EXPECT_EQ(read, row.read) << pieceSize;
    }
  }
}

}  // namespace
}  // namespace vesk::diag
