#include "messages/codec/proto_reader.h"

#include <gtest/gtest.h>
#include <vector>

#include "messages/codec/field_cursor.h"
#include "support/bytes.h"

namespace vesk {
namespace {

constexpr auto kMax64 = std::numeric_limits<std::uint64_t>::max();

struct VarintCase {
  std::string input;
  std::uint64_t value;
  std::uint64_t pos;
  bool error = false;
};

const std::vector<VarintCase> kVarints{
    {"00", 0, 1},
    {"80 01", 128, 2},
    {"FF 7F FF", 16383, 2},
    {"80 80 80 80 10", 0x100000000, 5},
    {"FF FF FF FF FF FF FF FF 7F", kMax64 / 2, 9},
    {"FF FF FF FF FF FF FF FF FF 01", kMax64, 10},
    // Bits beyond the 64th are lost, and a number may be longer than it need be.
    {"80 80 80 80 80 80 80 80 80 7E", 0, 10},
    {"81 80 80 80 00", 1, 5},
    // Ten bytes without an end read as 0, and the next number starts behind them.
    {"FF FF FF FF FF FF FF FF FF FF 01", 0, 10},
    {"80 80 80 80 80 80 80 80 80 80", 0, 10},
    // The input ends before the number does.
    {"", 0, 0, true},
    {"FF", 0, 1, true},
    {"FF FF FF FF FF FF FF FF FF", 0, 9, true},
};

// The cursor looks at eight bytes at a time: what stands around a number, in its section or beyond, must not matter.
TEST(FieldCursor, ReadsVarintsWhateverStandsAroundThem) {
  for (const VarintCase& row : kVarints) {
    for (std::size_t before = 0; before <= 8; ++before) {
      for (std::size_t behind = 0; behind <= 10; ++behind) {
        Bytes input(before, 0xFF);
        const Bytes number = bytesOf(row.input);
        input.insert(input.end(), number.begin(), number.end());
        input.insert(input.end(), behind, 0x01);
        ProtoReader reader(input);
        reader.pos = before;
        reader.length = before + number.size();
        ProtoReader plain = reader;
        EXPECT_EQ(plain.readVarint(), row.value) << row.input;
        EXPECT_EQ(plain.pos, before + row.pos) << row.input;
        FieldCursor cursor(reader);
        EXPECT_EQ(cursor.readUInt64(), row.value)
            << row.input << " with " << before << " before, " << behind << " behind";
        EXPECT_EQ(cursor.finish(), !row.error) << row.input;
        EXPECT_EQ(reader.pos, before + row.pos) << row.input;
      }
    }
  }
}

TEST(FieldCursor, ReadsTheNextKeyOnlyIfItIsTheOneAskedFor) {
  const auto isRead = [](const std::string& bytes, auto readKeyIf) {
    const Bytes input = bytesOf(bytes);
    ProtoReader reader(input);
    FieldCursor cursor(reader);
    const bool wasRead = readKeyIf(cursor);
    EXPECT_TRUE(cursor.finish());
    EXPECT_EQ(reader.pos, wasRead ? (input[0] < 0x80 ? 1U : 2U) : 0U) << bytes;
    return wasRead;
  };
  const auto field2 = [](FieldCursor& cursor) { return cursor.readKeyIf<2, WireType::varint>(); };
  EXPECT_TRUE(isRead("10 05", field2));
  for (const char* other : {"", "08 05", "12 05", "90 00 05", "90 01 05"})
    EXPECT_FALSE(isRead(other, field2)) << other;
  const auto field300 = [](FieldCursor& cursor) { return cursor.readKeyIf<300, WireType::lengthDelimited>(); };
  EXPECT_TRUE(isRead("E2 12 00", field300));
  for (const char* other : {"", "E2", "E2 13", "E0 12", "E2 92 00", "62 12"})
    EXPECT_FALSE(isRead(other, field300)) << other;
  // Keys of three bytes are left to the ordinary way.
  const auto field65535 = [](FieldCursor& cursor) { return cursor.readKeyIf<65535, WireType::varint>(); };
  EXPECT_FALSE(isRead("F8 FF 1F 00", field65535));
}

TEST(ProtoReader, KeepsItsErrorAndReadsNothingMore) {
  for (const char* length : {"03", "FF FF FF FF FF FF FF FF FF 01"}) {
    const Bytes input = bytesOf(std::string(length) + " 01 02");
    ProtoReader reader(input);
    EXPECT_EQ(hexOf(reader.readBytes().bytes()), "");
    EXPECT_TRUE(reader.error);
    const std::uint64_t pos = reader.pos;
    EXPECT_EQ(pos, input.size() - 2);
    ReaderMark mark{};
    EXPECT_EQ(reader.readByte(), 0);
    EXPECT_EQ(reader.readVarint(), 0U);
    EXPECT_EQ(reader.readString(), "");
    EXPECT_FALSE(reader.enterSection(mark));
    EXPECT_FALSE(reader.skipField(1, WireType::lengthDelimited));
    EXPECT_EQ(reader.pos, pos);
    EXPECT_TRUE(reader.error);
  }
}

TEST(ProtoReader, SkipsAFieldOfEveryWireType) {
  struct Case {
    unsigned wireType;
    std::string input;
    bool skipped;
    unsigned pos = 0;
  };
  const std::string deepestGroup = repeated(99, "0B") + repeated(100, "0C");
  const Case cases[] = {
      {0, "80 01 FF", true, 2},
      {0, repeated(10, "80") + "FF", true, 10},
      {0, "80", false},
      {1, "01 02 03 04 05 06 07 08 09", true, 8},
      {1, "01 02 03 04 05 06 07", false},
      {2, "02 01 02 FF", true, 3},
      {2, "02 01", false},
      {2, "FF FF FF FF FF FF FF FF FF 01 00", false},
      {5, "01 02 03 04 05", true, 4},
      {5, "01 02 03", false},
      {6, "00 00 00 00 00 00 00 00", false},
      {7, "00 00 00 00 00 00 00 00", false},

      // Groups end with the key 0C, the end of field 1.
      {3, "0C FF", true, 1},
      {3, "13 1B 1C 14 0C", true, 5},
      {3, "11 0C 0C 0C 0C 0C 0C 0C 0C 15 0C 0C 0C 0C 0C", true, 15},
      {3, "", false},
      {3, "13 0C 14", false},
      {3, "1A 05 0C", false},
      {3, "0E 0C", false},
      {3, deepestGroup, true, 199},
      {3, "0B" + deepestGroup + "0C", false},
      {3, repeated(1'000'000, "0B") + repeated(1'000'001, "0C"), false},
  };
  for (const Case& row : cases) {
    const Bytes input = bytesOf(row.input);
    ProtoReader reader(input);
    EXPECT_EQ(reader.skipField(1, static_cast<WireType>(row.wireType)), row.skipped)
        << row.wireType << ": " << row.input.substr(0, 60);
    if (row.skipped) {
      EXPECT_EQ(reader.pos, row.pos) << row.wireType << ": " << row.input.substr(0, 60);
    }
  }
}

}  // namespace
}  // namespace vesk
