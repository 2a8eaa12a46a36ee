#include <cstddef>
#include <gtest/gtest.h>
#include <string>
#include <string_view>
#include <vector>

#include "diag/framing/frame_reader.h"
#include "support/bytes.h"

namespace vesk::diag {
namespace {

using Read = std::vector<std::string>;

/// The frames in `bytes`, read in pieces of `pieceSize`: each one's content, or "damaged".
Read readFrames(const Bytes& bytes, std::size_t pieceSize = 1 << 20) {
  Read read;
  FrameReader reader;
  for (std::size_t begin = 0; begin < bytes.size(); begin += pieceSize) {
    reader.take(std::span(bytes).subspan(begin, std::min(pieceSize, bytes.size() - begin)));
    while (const auto frame = reader.next())
      read.push_back(frame->isSound ? hexOf(frame->content) : "damaged");
  }
  if (reader.endsWithinFrame()) read.emplace_back("damaged");
  return read;
}

Bytes frameOf(const Bytes& content) {
  Bytes frame;
  appendFrame(frame, content);
  return frame;
}

TEST(Frame, IsWrittenAndReadInAnyPieces) {
  struct Case {
    std::string_view content;
    std::string_view frame;
  };
  const Case cases[] = {
      {"00", "00 78 F0 7E"},
      {"7C", "7C 93 49 7E"},
      {"60 00", "60 00 12 6A 7E"},
      {"7D 05 00 00 00 00 00 00", "7D 5D 05 00 00 00 00 00 00 74 41 7E"},
      {"73 00 00 00 01 00 00 00", "73 00 00 00 01 00 00 00 61 9D 7E"},
      {"73 00 00 00 00 00 00 00", "73 00 00 00 00 00 00 00 DA 81 7E"},
      {"7E 7D", "7D 5E 7D 5D F1 CD 7E"},
  };
  Bytes all;
  Read contents;
  for (const Case& row : cases) {
    EXPECT_EQ(hexOf(frameOf(bytesOf(row.content))), row.frame);
    for (const std::uint8_t byte : bytesOf(row.frame))
      all.push_back(byte);
    contents.push_back(hexOf(bytesOf(row.content)));
  }
  for (std::size_t size = 1; size <= all.size(); ++size)
    EXPECT_EQ(readFrames(all, size), contents) << size;
}

TEST(Frame, IsDamagedOrNot) {
  struct Case {
    std::string_view bytes;
    Read read;
  };
  const Case cases[] = {
      {"7E 7E 00 78 F0 7E 7E", {"00"}},
      {"01 78 F0 7E 00 78 F0 7E", {"damaged", "00"}},
      {"7D 20 78 F0 7E", {"00"}},
      {"00 78 F0 7D 7E 00 78 F0 7E", {"damaged", "00"}},
      {"7D 7E", {"damaged"}},
      {"5D 18 79 7E 7D 7D 18 79 7E", {"5D", "damaged"}},
      {"00 00 7E", {"damaged"}},
      {"00 78 F0", {"damaged"}},
      {"00 78 F0 7E 00", {"00", "damaged"}},
      {"", {}},
  };
  for (const Case& row : cases) {
    for (const std::size_t pieceSize : {1U, 2U, 100U})
      EXPECT_EQ(readFrames(bytesOf(row.bytes), pieceSize), row.read) << row.bytes;
  }
}

TEST(Frame, IsNoLongerThanIsKept) {
  for (const std::size_t excess : {0U, 1U, 1'000'000U}) {
    Bytes bytes = frameOf(Bytes(kLongestFrame - kChecksumSize + excess, 0x11));
    ASSERT_EQ(bytes.size(), kLongestFrame + excess + 1);
    const Bytes next = frameOf({0});
    bytes.insert(bytes.end(), next.begin(), next.end());
    for (const std::size_t pieceSize : {1000U, 10'000'000U}) {
      const Read read = readFrames(bytes, pieceSize);
      ASSERT_EQ(read.size(), 2U);
      EXPECT_EQ(read[0] == "damaged", excess > 0) << excess;
      EXPECT_EQ(read[1], "00");
    }
  }
}

}  // namespace
}  // namespace vesk::diag
