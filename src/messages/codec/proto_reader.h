#pragma once

#include <cstdint>
#include <limits>
#include <span>

#include "platform/data.h"
#include "platform/text.h"

namespace vesk {

/// The wire types of the protocol-buffer encoding. 6 and 7 are not defined and never skipped.
enum class WireType : std::uint8_t {
  varint = 0,
  fixed64 = 1,
  lengthDelimited = 2,
  startGroup = 3,
  endGroup = 4,
  fixed32 = 5,
};

/// What stands before every value: which field, and how its value is laid out.
struct FieldKey {
  std::uint32_t number;
  WireType wireType;
};

/// What leaveSection() needs to give back: the end that was in force before a section was entered.
struct ReaderMark {
  std::uint64_t length;
};

/// A cursor over one encoded message. The state is open because it is the contract: `pos` is the next byte to
/// read, `length` the end of the readable range, `error` is set by the first read beyond that end and never
/// cleared; from then on every number reads as 0. The bytes must outlive the reader.
class ProtoReader {
 public:
  const std::uint8_t* bytes;
  std::uint64_t pos = 0;
  std::uint64_t length;
  bool error = false;

  explicit ProtoReader(std::span<const std::uint8_t> input) : bytes(input.data()), length(input.size()) {}

  std::uint8_t readByte() {
    if (pos >= length || error) {
      error = true;
      return 0;
    }
    return bytes[pos++];
  }

  /// A base-128 number. Ten bytes that all announce another one read as 0 and are no error.
  [[gnu::always_inline]] std::uint64_t readVarint() {
    std::uint64_t value = 0;
    for (unsigned count = 0; count < kLongestVarint; ++count) {
      const std::uint8_t byte = readByte();
      value |= std::uint64_t{byte & 0x7FU} << (7 * count);
      if (byte < 0x80) return error ? 0 : value;
    }
    return 0;
  }

  /// The field number is kept to 16 bits: 65537 reads as 1.
  FieldKey readKey() {
    const std::uint64_t key = readVarint();
    return {static_cast<std::uint32_t>(key >> 3) & 0xFFFFU, static_cast<WireType>(key & 7)};
  }

  std::uint32_t readUInt32() { return static_cast<std::uint32_t>(readVarint()); }
  std::int32_t readInt32() { return static_cast<std::int32_t>(readUInt32()); }
  std::int32_t readSInt32() {
    const std::uint32_t zigZag = readUInt32();
    return static_cast<std::int32_t>((zigZag >> 1) ^ (0U - (zigZag & 1)));
  }
  std::uint64_t readUInt64() { return readVarint(); }
  bool readBool() { return readVarint() != 0; }
  template <class Enumeration>
  Enumeration readEnumeration() {
    return static_cast<Enumeration>(readInt32());
  }

  /// A length and that many bytes; empty, with `error` set, when they are not all there.
  Text readString();
  Data readBytes();

  /// Passes over one value of a field that nobody declared. False on values that are not all there, groups
  /// without their end or more than kDeepestGroup deep, and undefined wire types.
  [[nodiscard]] bool skipField(std::uint32_t fieldNumber, WireType wireType);

  /// Reads the length of a section and makes its end the end of the readable range. False when `error` is set
  /// or the section is longer than what is left.
  [[nodiscard]] bool enterSection(ReaderMark& mark);
  /// Goes to the end of the section, read or not, and makes the former end valid again.
  void leaveSection(const ReaderMark& mark) {
    pos = length;
    length = mark.length;
  }

  static constexpr unsigned kLongestVarint = 10;
  static constexpr unsigned kDeepestGroup = 100;

 private:
  [[nodiscard]] bool skipBytes(std::uint64_t count);
  [[nodiscard]] bool skipGroup(std::uint32_t fieldNumber);
  std::span<const std::uint8_t> readLengthDelimited();
};

}  // namespace vesk
