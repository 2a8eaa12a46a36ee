#include "messages/codec/proto_writer.h"

#include <bit>
#include <gtest/gtest.h>
#include <limits>

#include "messages/codec/repeated_scalar.h"
#include "messages/lte/lte.h"
#include "support/bytes.h"
#include "values/text_form.h"

namespace vesk {
namespace {

TEST(ProtoWriter, WritesAKeyAndAValue) {
  struct Case {
    void (*write)(ProtoWriter& to);
    std::string written;
  };
  constexpr auto kMin = std::numeric_limits<std::int32_t>::min();
  constexpr auto kMax = std::numeric_limits<std::int32_t>::max();
  constexpr std::uint32_t kNoKey = ProtoWriter::kNoKey;
  const Case cases[] = {
      {[](ProtoWriter& to) { to.writeUInt32(150, 1); }, "08 96 01"},
      {[](ProtoWriter& to) { to.writeUInt32(0, 15); }, "78 00"},
      {[](ProtoWriter& to) { to.writeUInt32(0xFFFFFFFF, 16); }, "80 01 FF FF FF FF 0F"},
      {[](ProtoWriter& to) { to.writeUInt32(1, 65535); }, "F8 FF 1F 01"},
      {[](ProtoWriter& to) { to.writeUInt64(~0ULL, 1); }, "08 FF FF FF FF FF FF FF FF FF 01"},
      {[](ProtoWriter& to) { to.writeInt32(kMax, 1); }, "08 FF FF FF FF 07"},
      {[](ProtoWriter& to) { to.writeInt32(-1, 1); }, "08 FF FF FF FF FF FF FF FF FF 01"},
      {[](ProtoWriter& to) { to.writeInt32(kMin, 1); }, "08 80 80 80 80 F8 FF FF FF FF 01"},
      {[](ProtoWriter& to) { to.writeSInt32(-1, 1); }, "08 01"},
      {[](ProtoWriter& to) { to.writeSInt32(-110, 1); }, "08 DB 01"},
      {[](ProtoWriter& to) { to.writeSInt32(kMax, 1); }, "08 FE FF FF FF 0F"},
      {[](ProtoWriter& to) { to.writeSInt32(kMin, 1); }, "08 FF FF FF FF 0F"},
      {[](ProtoWriter& to) { to.writeBool(true, 2); }, "10 01"},
      {[](ProtoWriter& to) { to.writeBool(false, 2); }, "10 00"},
      {[](ProtoWriter& to) { to.writeEnumeration(static_cast<metrics::SccState>(-2), 1); },
       "08 FE FF FF FF FF FF FF FF FF 01"},
      {[](ProtoWriter& to) { to.writeString(Text::copy("a\xFF"), 3); }, "1A 02 61 FF"},
      {[](ProtoWriter& to) { to.writeString({}, 3); }, "1A 00"},
      {[](ProtoWriter& to) { to.writeBytes(Data::copy(bytesOf("00 01")), 3); }, "1A 02 00 01"},
      {[](ProtoWriter& to) { to.writeMessage(metrics::TxPowerInfo(), 2); }, "12 00"},
      {[](ProtoWriter& to) { to.writeUInt32(300, kNoKey), to.writeSInt32(-3, kNoKey); }, "AC 02 05"},
      {[](ProtoWriter& to) { to.writeInt32(-1, kNoKey), to.writeBool(true, kNoKey); },
       "FF FF FF FF FF FF FF FF FF 01 01"},
  };
  for (const Case& row : cases) {
    ProtoWriter writer;
    row.write(writer);
    EXPECT_EQ(hexOf(writer.written()), row.written);
  }
}

TEST(ProtoWriter, WritesVarintsThatReadBackInTheFewestBytes) {
  for (unsigned power = 0; power < 64; ++power) {
    for (const std::uint64_t value : {(1ULL << power) - 1, 1ULL << power, (1ULL << power) + 1}) {
      ProtoWriter writer;
      writer.writeUInt64(value, ProtoWriter::kNoKey);
      const auto bits = static_cast<std::size_t>(std::bit_width(value));
      EXPECT_EQ(writer.written().size(), std::max<std::size_t>(1, (bits + 6) / 7)) << value;
      EXPECT_EQ(ProtoReader(writer.written()).readVarint(), value);
    }
  }
}

TEST(ProtoWriter, PutsTheLengthBeforeASectionOfAnySize) {
  for (const std::size_t size : {0U, 1U, 127U, 128U, 129U, 16'383U, 16'384U, 16'385U, 2'097'152U}) {
    ProtoWriter writer;
    WriterMark outer{};
    WriterMark inner{};
    writer.writeUInt32(7, 1);
    writer.beginSection(outer, 2);
    writer.beginSection(inner, 3);
    for (std::size_t index = 0; index < size; ++index)
      writer.writeUInt32(static_cast<std::uint32_t>(index % 128), ProtoWriter::kNoKey);
    writer.endSection(inner);
    writer.writeBool(true, 4);
    writer.endSection(outer);
    writer.writeUInt32(9, 5);

    ProtoReader reader(writer.written());
    ReaderMark outerMark{};
    ReaderMark innerMark{};
    EXPECT_EQ(reader.readVarint(), 0x08U);
    EXPECT_EQ(reader.readVarint(), 7U);
    EXPECT_EQ(reader.readVarint(), 0x12U);
    ASSERT_TRUE(reader.enterSection(outerMark));
    EXPECT_EQ(reader.readVarint(), 0x1AU);
    ASSERT_TRUE(reader.enterSection(innerMark));
    ASSERT_EQ(reader.length - reader.pos, size);
    for (std::size_t index = 0; index < size; ++index)
      ASSERT_EQ(reader.readByte(), index % 128) << size;
    reader.leaveSection(innerMark);
    EXPECT_EQ(hexOf({reader.bytes + reader.pos, reader.bytes + reader.length}), "20 01");
    reader.leaveSection(outerMark);
    EXPECT_EQ(hexOf({reader.bytes + reader.pos, reader.bytes + reader.length}), "28 09");
  }
}

TEST(RepeatedScalar, HoldsValuesInTheirOrder) {
  RepeatedInt32 values;
  EXPECT_EQ(values.count(), 0U);
  EXPECT_EQ(values.hash(), RepeatedInt32().hash());
  values.add(-3);
  values.add(5);
  RepeatedInt32 copy = values;
  values.append(values);
  EXPECT_EQ(textOf(values.toArray()), "[-3, 5, -3, 5]");
  EXPECT_EQ(textOf(copy.toArray()), "[-3, 5]");
  values.set(values.values() + 1, 3);
  EXPECT_EQ(textOf(values.toArray()), "[5, -3, 5]");
  values.set(copy.values(), 2);
  EXPECT_TRUE(values.isEqual(copy));
  EXPECT_EQ(values.hash(), copy.hash());

  const std::int32_t turned[] = {5, -3};
  copy.set(turned, 2);
  EXPECT_FALSE(values.isEqual(copy));
  EXPECT_NE(values.hash(), copy.hash());
  values.clear();
  EXPECT_TRUE(values.isEqual(RepeatedInt32()));
  EXPECT_EQ(textOf(values.toArray()), "[]");
}

TEST(RepeatedScalar, ShowsItsValuesWithTheirOwnSign) {
  RepeatedUInt32 values;
  values.add(0xFFFFFFFF);
  EXPECT_EQ(textOf(values.toArray()), "[4294967295]");
}

TEST(RepeatedScalar, TellsWhichIndexIsOutOfWhichRange) {
  RepeatedUInt32 values;
  for (const char* reason : {"idx (0) is out of range (0)", "idx (1) is out of range (1)"}) {
    try {
      (void)values.at(values.count());
      FAIL() << "no error";
    } catch (const std::out_of_range& error) {
      EXPECT_STREQ(error.what(), reason);
    }
    values.add(7);
  }
  EXPECT_EQ(values.at(0), 7U);
}

}  // namespace
}  // namespace vesk
