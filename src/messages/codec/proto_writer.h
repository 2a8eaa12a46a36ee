#pragma once

#include <cstdint>
#include <memory>
#include <span>

#include "messages/codec/proto_reader.h"
#include "platform/data.h"
#include "platform/text.h"

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

  void writeUInt32(std::uint32_t value, std::uint32_t fieldNumber) { writeUInt64(value, fieldNumber); }
  /// A negative value takes ten bytes, as its extension to 64 bits does.
  void writeInt32(std::int32_t value, std::uint32_t fieldNumber) {
    writeUInt64(static_cast<std::uint64_t>(std::int64_t{value}), fieldNumber);
  }
  void writeSInt32(std::int32_t value, std::uint32_t fieldNumber) {
    const auto shifted = static_cast<std::uint32_t>(value) << 1;
    writeUInt64(shifted ^ static_cast<std::uint32_t>(value >> 31), fieldNumber);
  }
  void writeUInt64(std::uint64_t value, std::uint32_t fieldNumber);
  void writeBool(bool value, std::uint32_t fieldNumber) { writeUInt64(value ? 1 : 0, fieldNumber); }
  template <class Enumeration>
  void writeEnumeration(Enumeration value, std::uint32_t fieldNumber) {
    writeInt32(static_cast<std::int32_t>(value), fieldNumber);
  }

  void writeBytes(const Data& value, std::uint32_t fieldNumber);
  void writeString(const Text& value, std::uint32_t fieldNumber);
  void writeMessage(const ProtoCodable& message, std::uint32_t fieldNumber);

  /// What is written between these two becomes one length-delimited value. Sections nest.
  void beginSection(WriterMark& mark, std::uint32_t fieldNumber);
  void endSection(const WriterMark& mark);

  /// What has been written so far; valid until the next write.
  [[nodiscard]] std::span<const std::uint8_t> written() const { return {buffer_.get(), size_}; }
  /// Starts afresh and keeps the room.
  void clear() { size_ = 0; }

 private:
  void reserve(std::size_t more);
  void append(std::span<const std::uint8_t> content);
  void appendVarint(std::uint64_t value);
  void appendKey(std::uint32_t fieldNumber, WireType wireType);

  std::unique_ptr<std::uint8_t[]> buffer_;
  std::size_t size_ = 0;
  std::size_t capacity_ = 0;
};

}  // namespace vesk
