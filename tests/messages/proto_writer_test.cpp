#include "messages/codec/proto_writer.h"

#include <bit>
#include <gtest/gtest.h>

#include "messages/codec/repeated_scalar.h"
#include "support/bytes.h"
#include "values/text_form.h"

namespace vesk {
namespace {

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
  const std::pair<std::size_t, std::string> lengths[] = {
      {0, "00"}, {127, "7F"}, {128, "80 01"}, {16'383, "FF 7F"}, {16'384, "80 80 01"}, {2'097'152, "80 80 80 01"},
  };
  for (const auto& [size, length] : lengths) {
    ProtoWriter writer;
    WriterMark mark{};
    writer.writeUInt32(7, 1);
    writer.beginSection(mark, 2);
    for (std::size_t index = 0; index < size; ++index)
      writer.writeUInt32(static_cast<std::uint32_t>(index % 128), ProtoWriter::kNoKey);
    writer.endSection(mark);
    writer.writeUInt32(9, 5);

    Bytes expected = bytesOf("08 07 12" + length);
    for (std::size_t index = 0; index < size; ++index)
      expected.push_back(index % 128);
    expected.insert(expected.end(), {0x28, 9});
    EXPECT_EQ(Bytes(writer.written().begin(), writer.written().end()), expected) << size;
  }
}

TEST(RepeatedScalar, HoldsValuesInTheirOrder) {
  RepeatedInt32 values;
  values.add(-3);
  values.add(5);
  RepeatedInt32 copy = values;
  values.append(values);
  EXPECT_EQ(textOf(values.toArray()), "[-3, 5, -3, 5]");
  values.set(values.values() + 1, 3);
  EXPECT_EQ(textOf(values.toArray()), "[5, -3, 5]");
  values.set(copy.values(), 2);
  EXPECT_TRUE(values.isEqual(copy));
  EXPECT_EQ(values.hash(), copy.hash());

  const std::int32_t turned[] = {5, -3};
  copy.set(turned, 2);
  EXPECT_FALSE(values.isEqual(copy));
  EXPECT_NE(values.hash(), copy.hash());
  try {
    (void)values.at(2);
    FAIL() << "no error";
  } catch (const std::out_of_range& error) {
    EXPECT_STREQ(error.what(), "idx (2) is out of range (2)");
  }
  values.clear();
  EXPECT_TRUE(values.isEqual(RepeatedInt32()));
}

}  // namespace
}  // namespace vesk
