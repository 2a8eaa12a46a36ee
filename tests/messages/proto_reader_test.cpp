#include "messages/codec/proto_reader.h"

#include <gtest/gtest.h>
#include <vector>

#include "messages/codec/field_cursor.h"
#include "support/bytes.h"

namespace vesk {
namespace {

constexpr auto kMax64 = std::numeric_limits<std::uint64_t>::max();
constexpr auto kMin32 = std::numeric_limits<std::int32_t>::min();
constexpr auto kMax32 = std::numeric_limits<std::int32_t>::max();

struct VarintCase {
  std::string input;
  std::uint64_t value;
  std::uint64_t pos;
  bool error = false;
};

const std::vector<VarintCase>& varintCases() {
  static const std::vector<VarintCase> kCases{
      {"00", 0, 1},
      {"7F", 127, 1},
      {"80 01", 128, 2},
      {"96 01", 150, 2},
      {"FF 7F FF", 16383, 2},
      {"80 80 01", 16384, 3},
      {"FF FF FF FF 0F", 0xFFFFFFFF, 5},
      {"80 80 80 80 10", 0x100000000, 5},
      {"FF FF FF FF FF FF FF FF 7F", kMax64 >> 1, 9},
      {"80 80 80 80 80 80 80 80 80 01", kMax64 / 2 + 1, 10},
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
  return kCases;
}

template <auto read>
auto readWith(const Bytes& input) {
  ProtoReader reader(input);
  FieldCursor cursor(reader);
  return (cursor.*read)();
}

TEST(ProtoReader, ReadsVarints) {
  for (const VarintCase& row : varintCases()) {
    const Bytes input = bytesOf(row.input);
    ProtoReader reader(input);
    EXPECT_EQ(reader.readVarint(), row.value) << row.input;
    EXPECT_EQ(reader.pos, row.pos) << row.input;
    EXPECT_EQ(reader.error, row.error) << row.input;
  }
}

// The cursor looks at eight bytes at a time: what stands around a number, in its section or beyond, must not matter.
TEST(FieldCursor, ReadsVarintsWhateverStandsAroundThem) {
  for (const VarintCase& row : varintCases()) {
    for (std::size_t before = 0; before <= 8; ++before) {
      for (std::size_t behind = 0; behind <= 10; ++behind) {
        Bytes input(before, 0xFF);
        const Bytes number = bytesOf(row.input);
        input.insert(input.end(), number.begin(), number.end());
        input.insert(input.end(), behind, 0x01);
        ProtoReader reader(input);
        reader.pos = before;
        reader.length = before + number.size();
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

TEST(ProtoReader, KeepsAFieldNumberTo16Bits) {
  struct Case {
    std::string input;
    std::uint32_t number;
    unsigned wireType;
  };
  const Case cases[] = {
      {"08", 1, 0},       {"7F", 15, 7},      {"F2 B0 1A", 54030, 2}, {"FD FF 1F", 65535, 5},
      {"80 80 20", 0, 0}, {"8A 80 20", 1, 2}, {"FC FF 3F", 65535, 4}, {"FF FF FF FF FF FF FF FF FF 01", 65535, 7},
  };
  for (const Case& row : cases) {
    const Bytes input = bytesOf(row.input);
    const FieldKey key = FieldKey::of(ProtoReader(input).readVarint());
    EXPECT_EQ(key.number, row.number) << row.input;
    EXPECT_EQ(static_cast<unsigned>(key.wireType), row.wireType) << row.input;
  }
}

TEST(FieldCursor, MakesEveryScalarFromTheSameVarint) {
  struct Case {
    std::string input;
    std::uint64_t uint64;
    std::uint32_t uint32;
    std::int32_t int32;
    std::int32_t sint32;
    bool boolean;
  };
  const Case cases[] = {
      {"00", 0, 0, 0, 0, false},
      {"01", 1, 1, 1, -1, true},
      {"02", 2, 2, 2, 1, true},
      {"03", 3, 3, 3, -2, true},
      {"8B 01", 139, 139, 139, -70, true},
      {"FE FF FF FF 07", 0x7FFFFFFE, 0x7FFFFFFE, 0x7FFFFFFE, 0x3FFFFFFF, true},
      {"80 80 80 80 08", 0x80000000, 0x80000000, kMin32, 0x40000000, true},
      {"FE FF FF FF 0F", 0xFFFFFFFE, 0xFFFFFFFE, -2, kMax32, true},
      {"FF FF FF FF 0F", 0xFFFFFFFF, 0xFFFFFFFF, -1, kMin32, true},
      {"80 80 80 80 10", 0x100000000, 0, 0, 0, true},
      {"85 80 80 80 10", 0x100000005, 5, 5, -3, true},
      {"FF FF FF FF FF FF FF FF FF 01", kMax64, 0xFFFFFFFF, -1, kMin32, true},
  };
  for (const Case& row : cases) {
    const Bytes input = bytesOf(row.input);
    EXPECT_EQ(readWith<&FieldCursor::readUInt64>(input), row.uint64) << row.input;
    EXPECT_EQ(readWith<&FieldCursor::readUInt32>(input), row.uint32) << row.input;
    EXPECT_EQ(readWith<&FieldCursor::readInt32>(input), row.int32) << row.input;
    EXPECT_EQ(readWith<&FieldCursor::readSInt32>(input), row.sint32) << row.input;
    EXPECT_EQ(readWith<&FieldCursor::readBool>(input), row.boolean) << row.input;
  }
}

TEST(ProtoReader, ReadsWhatHasALength) {
  const Bytes input = bytesOf("00 02 61 FF 01 62");
  ProtoReader reader(input);
  EXPECT_EQ(reader.readString(), "");
  EXPECT_EQ(reader.readString(), "a\xFF");
  EXPECT_EQ(hexOf(reader.readBytes().bytes()), "62");
  EXPECT_FALSE(reader.error);
}

TEST(ProtoReader, KeepsItsErrorAndReadsNothingMore) {
  for (const char* length : {"03", "FF FF FF FF FF FF FF FF FF 01", "FF FF FF FF FF FF FF FF 7F"}) {
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
    EXPECT_FALSE(reader.skipField(1, WireType::varint));
    EXPECT_FALSE(reader.skipField(1, WireType::lengthDelimited));
    EXPECT_EQ(reader.pos, pos);
    EXPECT_TRUE(reader.error);
  }
}

TEST(ProtoReader, NarrowsItsRangeToASection) {
  const Bytes input = bytesOf("05 02 08 07 0A 0B 0C");
  ProtoReader reader(input);
  ReaderMark outer{};
  ReaderMark inner{};
  ASSERT_TRUE(reader.enterSection(outer));
  EXPECT_EQ(reader.length, 6U);
  ASSERT_TRUE(reader.enterSection(inner));
  EXPECT_EQ(reader.readByte(), 0x08);
  // Left in the middle: reading goes on behind the section.
  reader.leaveSection(inner);
  EXPECT_EQ(reader.readByte(), 0x0A);
  ReaderMark tooLong{};
  EXPECT_FALSE(reader.enterSection(tooLong));
  EXPECT_FALSE(reader.error);
  reader.leaveSection(outer);
  EXPECT_EQ(reader.readByte(), 0x0C);
  EXPECT_EQ(reader.pos, reader.length);
}

TEST(ProtoReader, DoesNotReadBeyondASection) {
  const Bytes input = bytesOf("01 80 01");
  ProtoReader reader(input);
  ReaderMark mark{};
  ASSERT_TRUE(reader.enterSection(mark));
  EXPECT_EQ(reader.readVarint(), 0U);
  EXPECT_TRUE(reader.error);
}

TEST(ProtoReader, SkipsAFieldOfEveryWireType) {
  struct Case {
    unsigned wireType;
    std::string input;
    bool skipped;
    std::uint64_t pos = 0;
  };
  const std::string deepestGroup = repeated(99, "0B") + repeated(100, "0C");
  const Case cases[] = {
      {0, "80 01 FF", true, 2},
      {0, repeated(10, "80") + "FF", true, 10},
      {0, "80", false},
      {1, "01 02 03 04 05 06 07 08 09", true, 8},
      {1, "01 02 03 04 05 06 07", false},
      {2, "00 FF", true, 1},
      {2, "02 01 02 FF", true, 3},
      {2, "02 01", false},
      {2, "FF FF FF FF FF FF FF FF FF 01 00", false},
      {5, "01 02 03 04 05", true, 4},
      {5, "01 02 03", false},
      {4, "00", false},
      {6, "00 00 00 00 00 00 00 00", false},
      {7, "00 00 00 00 00 00 00 00", false},

      // Groups end with the key 0C, the end of field 1.
      {3, "0C FF", true, 1},
      {3, "10 05 1A 02 0C 0C 0C", true, 7},
      {3, "13 1B 1C 14 0C", true, 5},
      {3, "11 0C 0C 0C 0C 0C 0C 0C 0C 15 0C 0C 0C 0C 0C", true, 15},
      {3, "", false},
      {3, "08", false},
      {3, "14", false},
      {3, "13 0C 14", false},
      {3, "13 14", false},
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
