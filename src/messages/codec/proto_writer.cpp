#include "messages/codec/proto_writer.h"

#include <algorithm>
#include <bit>
#include <cstring>

#include "messages/codec/proto_codable.h"

namespace vesk {

namespace {

constexpr std::size_t kLeastCapacity = 128;

std::size_t varintSize(std::uint64_t value) {
  return (static_cast<std::size_t>(std::bit_width(value | 1)) + 6) / 7;
}

std::uint8_t* putVarint(std::uint8_t* place, std::uint64_t value) {
  while (value >= 0x80) {
    *place++ = static_cast<std::uint8_t>(value | 0x80);
    value >>= 7;
  }
  *place++ = static_cast<std::uint8_t>(value);
  return place;
}

}  // namespace

void ProtoWriter::reserve(std::size_t more) {
  if (capacity_ - size_ >= more) return;
  capacity_ = std::max({kLeastCapacity, 2 * capacity_, size_ + more});
  auto larger = std::make_unique_for_overwrite<std::uint8_t[]>(capacity_);
  std::copy_n(buffer_.get(), size_, larger.get());
  buffer_ = std::move(larger);
}

void ProtoWriter::append(std::span<const std::uint8_t> content) {
  reserve(content.size());
  std::copy(content.begin(), content.end(), buffer_.get() + size_);
  size_ += content.size();
}

void ProtoWriter::appendVarint(std::uint64_t value) {
  reserve(ProtoReader::kLongestVarint);
  size_ = static_cast<std::size_t>(putVarint(buffer_.get() + size_, value) - buffer_.get());
}

void ProtoWriter::appendKey(std::uint32_t fieldNumber, WireType wireType) {
  appendVarint(std::uint64_t{fieldNumber} << 3 | static_cast<std::uint64_t>(wireType));
}

void ProtoWriter::writeUInt64(std::uint64_t value, std::uint32_t fieldNumber) {
  if (fieldNumber != kNoKey) appendKey(fieldNumber, WireType::varint);
  appendVarint(value);
}

void ProtoWriter::writeBytes(const Data& value, std::uint32_t fieldNumber) {
  const std::span<const std::uint8_t> content = value.bytes();
  appendKey(fieldNumber, WireType::lengthDelimited);
  appendVarint(content.size());
  append(content);
}

void ProtoWriter::writeString(const Text& value, std::uint32_t fieldNumber) {
  const std::string_view content = value.view();
  appendKey(fieldNumber, WireType::lengthDelimited);
  appendVarint(content.size());
  append({reinterpret_cast<const std::uint8_t*>(content.data()), content.size()});
}

void ProtoWriter::writeMessage(const ProtoCodable& message, std::uint32_t fieldNumber) {
  WriterMark mark{};
  beginSection(mark, fieldNumber);
  message.writeTo(*this);
  endSection(mark);
}

void ProtoWriter::beginSection(WriterMark& mark, std::uint32_t fieldNumber) {
  appendKey(fieldNumber, WireType::lengthDelimited);
  mark.index = size_;
  // Room for the length of a section below 128 bytes, which is nearly every one.
  reserve(1);
  ++size_;
}

void ProtoWriter::endSection(const WriterMark& mark) {
  const std::size_t content = size_ - mark.index - 1;
  const std::size_t prefix = varintSize(content);
  if (prefix > 1) {
    reserve(prefix - 1);
    std::uint8_t* start = buffer_.get() + mark.index;
    std::memmove(start + prefix, start + 1, content);
    size_ += prefix - 1;
  }
  putVarint(buffer_.get() + mark.index, content);
}

}  // namespace vesk
