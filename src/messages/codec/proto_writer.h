#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>

#include "messages/codec/proto_reader.h"
#include "values/data.h"
#include "values/text.h"

namespace vesk {

class ProtoCodable;

/// An open section: where its length will stand.
struct WriterMark {
  std::size_t index;
};

/// Builds the encoding of a message. Every write puts the field's key and then the value; a scalar given
/// kNoKey as its field number is written without a key, as the elements of a packed field are.
class ProtoWriter {
 public:
  static constexpr std::uint32_t kNoKey = 0xFFFFFFFF;

  ProtoWriter() = default;
  ProtoWriter(const ProtoWriter&) = delete;
  ProtoWriter& operator=(const ProtoWriter&) = delete;

  [[gnu::always_inline]] void writeUInt32(std::uint32_t value, std::uint32_t fieldNumber) {
    writeUInt64(value, fieldNumber);
  }
  /// A negative value takes ten bytes, as its extension to 64 bits does.
  [[gnu::always_inline]] void writeInt32(std::int32_t value, std::uint32_t fieldNumber) {
    writeUInt64(static_cast<std::uint64_t>(std::int64_t{value}), fieldNumber);
  }
  [[gnu::always_inline]] void writeSInt32(std::int32_t value, std::uint32_t fieldNumber) {
    const auto shifted = static_cast<std::uint32_t>(value) << 1;
    writeUInt64(shifted ^ static_cast<std::uint32_t>(value >> 31), fieldNumber);
  }
  [[gnu::always_inline]] void writeUInt64(std::uint64_t value, std::uint32_t fieldNumber) {
    std::uint8_t* place = roomFor(kLongestScalar);
    if (fieldNumber != kNoKey) place = putVarint(place, keyOf(fieldNumber, WireType::varint));
    finishAt(putVarint(place, value));
  }
  [[gnu::always_inline]] void writeBool(bool value, std::uint32_t fieldNumber) {
    writeUInt64(value ? 1 : 0, fieldNumber);
  }
  template <class Enumeration>
  [[gnu::always_inline]] void writeEnumeration(Enumeration value, std::uint32_t fieldNumber) {
    writeInt32(static_cast<std::int32_t>(value), fieldNumber);
  }

  void writeBytes(const Data& value, std::uint32_t fieldNumber);
  void writeString(const Text& value, std::uint32_t fieldNumber);
  void writeMessage(const ProtoCodable& message, std::uint32_t fieldNumber);

  /// What is written between these two becomes one length-delimited value. Sections nest.
  void beginSection(WriterMark& mark, std::uint32_t fieldNumber);
  void endSection(const WriterMark& mark);

  /// What has been written so far; valid until the next write.
  [[nodiscard]] std::span<const std::uint8_t> written() const { return {buffer_, size_}; }
  /// Starts afresh and keeps the room.
  void clear() { size_ = 0; }

 private:
  /// A key and a number.
  static constexpr std::size_t kLongestScalar = std::size_t{2} * ProtoReader::kLongestVarint;

  static constexpr std::uint64_t keyOf(std::uint32_t fieldNumber, WireType wireType) {
    return std::uint64_t{fieldNumber} << 3 | static_cast<std::uint64_t>(wireType);
  }

  /// Writes at `place`, where there is room; the place behind it.
  [[gnu::always_inline]] static std::uint8_t* putVarint(std::uint8_t* place, std::uint64_t value) {
    while (value >= 0x80) {
      *place++ = static_cast<std::uint8_t>(value | 0x80);
      value >>= 7;
    }
    *place++ = static_cast<std::uint8_t>(value);
    return place;
  }

  /// Where the next byte goes, with room for `more` of them.
  [[gnu::always_inline]] std::uint8_t* roomFor(std::size_t more) {
    if (capacity_ - size_ < more) [[unlikely]]
      grow(more);
    return buffer_ + size_;
  }
  void finishAt(const std::uint8_t* place) { size_ = static_cast<std::size_t>(place - buffer_); }
  void grow(std::size_t more);
  void writeContent(std::span<const std::uint8_t> content, std::uint32_t fieldNumber);

  /// Nearly every message fits here.
  std::array<std::uint8_t, 512> first_;
  std::unique_ptr<std::uint8_t[]> larger_;
  std::uint8_t* buffer_ = first_.data();
  std::size_t size_ = 0;
  std::size_t capacity_ = first_.size();
};

}  // namespace vesk
