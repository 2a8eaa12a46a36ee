#pragma once

#include <bit>
#include <cstdint>

#include "messages/codec/proto_reader.h"

namespace vesk {

/// The place of a loop over fields in the reader's bytes. It decodes keys and scalars itself and must never leave the
/// loop's function, so that the place stays in a register; the reader gets it back for everything else.
class FieldCursor {
 public:
  explicit FieldCursor(ProtoReader& reader) : reader_(reader), pos_(reader.pos) {}

  [[nodiscard]] bool hasMore() const { return pos_ < reader_.length && !reader_.error; }

  /// Reads the key of the next field. False at the reader's end, an end-group key, or when the key is not all there.
  [[nodiscard, gnu::always_inline]] bool readKey() {
    if (!hasMore()) return false;
    key_ = FieldKey::of(readVarint());
    return key_.wireType != WireType::endGroup && !reader_.error;
  }
  /// Reads the key of the next field if it is this one, in its shortest form.
  template <std::uint32_t number, WireType wireType>
  [[nodiscard, gnu::always_inline]] bool readKeyIf() {
    constexpr std::uint32_t kKey = number << 3 | static_cast<std::uint32_t>(wireType);
    if constexpr (kKey < 0x80) {
      if (!hasMore() || reader_.bytes[pos_] != kKey) return false;
      ++pos_;
    } else {
      constexpr std::uint8_t kFirst = (kKey & 0x7F) | 0x80;
      if (kKey >= 0x4000 || reader_.length - pos_ < 2 || reader_.error) return false;
      if (reader_.bytes[pos_] != kFirst || reader_.bytes[pos_ + 1] != kKey >> 7) return false;
      pos_ += 2;
    }
    key_ = {number, wireType};
    return true;
  }
  [[nodiscard]] FieldKey key() const { return key_; }
  [[nodiscard]] std::uint32_t fieldNumber() const { return key_.number; }

  /// Gives the place back to the reader; whether all was there.
  [[nodiscard]] bool finish() {
    reader_.pos = pos_;
    return !reader_.error;
  }

  /// Lets the reader read at this place, and goes on where that ended.
  template <class Read>
  [[gnu::always_inline]] auto withReader(Read read) {
    reader_.pos = pos_;
    auto result = read(reader_);
    pos_ = reader_.pos;
    return result;
  }

  [[gnu::always_inline]] std::uint32_t readUInt32() { return static_cast<std::uint32_t>(readVarint()); }
  [[gnu::always_inline]] std::int32_t readInt32() { return static_cast<std::int32_t>(readUInt32()); }
  [[gnu::always_inline]] std::int32_t readSInt32() {
    const std::uint32_t zigZag = readUInt32();
    return static_cast<std::int32_t>((zigZag >> 1) ^ (0U - (zigZag & 1)));
  }
  [[gnu::always_inline]] std::uint64_t readUInt64() { return readVarint(); }
  [[gnu::always_inline]] bool readBool() { return readVarint() != 0; }
  template <class Enumeration>
  [[gnu::always_inline]] Enumeration readEnumeration() {
    return static_cast<Enumeration>(readInt32());
  }

  [[gnu::always_inline]] Text readString() {
    return withReader([](ProtoReader& reader) { return reader.readString(); });
  }
  [[gnu::always_inline]] Data readBytes() {
    return withReader([](ProtoReader& reader) { return reader.readBytes(); });
  }

  /// Reads the length of a section and gives its content to `read`, which answers whether it could read it.
  template <class Read>
  [[nodiscard, gnu::always_inline]] bool readSection(Read read) {
    const std::uint64_t size = readVarint();
    reader_.pos = pos_;
    ReaderMark mark{};
    if (!reader_.enterSection(mark, size) || !read(reader_)) return false;
    reader_.leaveSection(mark);
    pos_ = reader_.pos;
    return true;
  }

 private:
  static constexpr std::uint64_t kHighBits = 0x8080808080808080;

  [[gnu::always_inline]] std::uint64_t readVarint() {
    if (pos_ < reader_.length) [[likely]] {
      const std::uint8_t first = reader_.bytes[pos_];
      if (first < 0x80) {
        ++pos_;
        return first;
      }
    }
    return readLongVarint();
  }

  [[gnu::always_inline]] std::uint64_t readLongVarint() {
    // How long a number is is as good as random, and a mispredicted branch costs more than all of this.
    const std::uint64_t word = reader_.nextWord(pos_);
    const std::uint64_t ends = ~word & kHighBits;
    if (ends != 0) [[likely]] {
      const auto size = (static_cast<std::uint64_t>(std::countr_zero(ends)) + 1) / 8;
      if (size <= reader_.length - pos_) [[likely]] {
        pos_ += size;
        return withoutHighBits(word & (ends ^ (ends - 1)));
      }
    }
    return withReader([](ProtoReader& reader) { return reader.readVarint(); });
  }

  /// The low seven bits of each byte, side by side.
  [[gnu::always_inline]] static std::uint64_t withoutHighBits(std::uint64_t word) {
    word = (word & 0x007F007F007F007F) | (word & 0x7F007F007F007F00) >> 1;
    word = (word & 0x00003FFF00003FFF) | (word & 0x3FFF00003FFF0000) >> 2;
    return (word & 0x000000000FFFFFFF) | (word & 0x0FFFFFFF00000000) >> 4;
  }

  ProtoReader& reader_;
  std::uint64_t pos_;
  FieldKey key_{};
};

}  // namespace vesk
