#pragma once

#include <bit>
#include <cstdint>
#include <cstring>
#include <span>

#include "values/data.h"
#include "values/text.h"

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

/// What stands before every value: which field, and how its value is laid out. The number is kept to 16 bits:
/// 65537 is 1.
struct FieldKey {
  std::uint32_t number;
  WireType wireType;

  static constexpr FieldKey of(std::uint64_t varint) {
    return {static_cast<std::uint32_t>(varint >> 3) & 0xFFFFU, static_cast<WireType>(varint & 7)};
  }
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

  explicit ProtoReader(std::span<const std::uint8_t> input)
      : bytes(input.data()), length(input.size()), inputSize_(input.size()) {}

  std::uint8_t readByte();

  /// A base-128 number. Ten bytes that all announce another one read as 0 and are no error.
  std::uint64_t readVarint();

  /// The next eight bytes, the first one lowest, whatever section they are in; zeros beyond the end of the input.
  [[nodiscard, gnu::always_inline]] std::uint64_t nextWord(std::uint64_t place) const {
    static_assert(std::endian::native == std::endian::little);
    std::uint64_t word = 0;
    if (inputSize_ - place < sizeof word) [[unlikely]]
      return lastWord(place);
    std::memcpy(&word, bytes + place, sizeof word);
    return word;
  }

  /// A length and that many bytes; empty, with `error` set, when they are not all there.
  Text readString();
  Data readBytes();

  /// Passes over one value of a field that nobody declared. False on values that are not all there, groups
  /// without their end or more than kDeepestGroup deep, and undefined wire types.
  [[nodiscard]] bool skipField(std::uint32_t fieldNumber, WireType wireType);

  /// Reads the length of a section and makes its end the end of the readable range. False when `error` is set
  /// or the section is longer than what is left.
  [[nodiscard]] bool enterSection(ReaderMark& mark) { return enterSection(mark, readVarint()); }
  /// The same of a section whose length was read already.
  [[nodiscard]] bool enterSection(ReaderMark& mark, std::uint64_t size) {
    if (error || size > length - pos) return false;
    mark.length = length;
    length = pos + size;
    return true;
  }
  /// Goes to the end of the section, read or not, and makes the former end valid again.
  void leaveSection(const ReaderMark& mark) {
    pos = length;
    length = mark.length;
  }

  static constexpr unsigned kLongestVarint = 10;
  static constexpr unsigned kDeepestGroup = 100;

 private:
  [[nodiscard]] std::uint64_t lastWord(std::uint64_t place) const;
  [[nodiscard]] bool skipBytes(std::uint64_t count);
  [[nodiscard]] bool skipGroup(std::uint32_t fieldNumber);
  std::span<const std::uint8_t> readLengthDelimited();

  /// Of the whole input, whatever section is being read.
  std::uint64_t inputSize_;
};

}  // namespace vesk
