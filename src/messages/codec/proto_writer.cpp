#include "messages/codec/proto_writer.h"

#include <algorithm>
#include <bit>
#include <cstring>

#include "messages/codec/proto_codable.h"

namespace vesk {

namespace {

std::size_t varintSize(std::uint64_t value) {
  return (static_cast<std::size_t>(std::bit_width(value | 1)) + 6) / 7;
}

}  // namespace

void ProtoWriter::grow(std::size_t more) {
  capacity_ = std::max(2 * capacity_, size_ + more);
  auto larger = std::make_unique_for_overwrite<std::uint8_t[]>(capacity_);
  std::copy_n(buffer_, size_, larger.get());
  larger_ = std::move(larger);
  buffer_ = larger_.get();
}

void ProtoWriter::writeContent(std::span<const std::uint8_t> content, std::uint32_t fieldNumber) {
  std::uint8_t* place = roomFor(kLongestScalar + content.size());
  place = putVarint(place, keyOf(fieldNumber, WireType::lengthDelimited));
  place = putVarint(place, content.size());
  finishAt(std::copy(content.begin(), content.end(), place));
}

void ProtoWriter::writeBytes(const Data& value, std::uint32_t fieldNumber) {
  writeContent(value.bytes(), fieldNumber);
}

void ProtoWriter::writeString(const Text& value, std::uint32_t fieldNumber) {
  const std::string_view content = value.view();
  writeContent({reinterpret_cast<const std::uint8_t*>(content.data()), content.size()}, fieldNumber);
}

void ProtoWriter::writeMessage(const ProtoCodable& message, std::uint32_t fieldNumber) {
  WriterMark mark{};
  beginSection(mark, fieldNumber);
  message.writeTo(*this);
  endSection(mark);
}

void ProtoWriter::beginSection(WriterMark& mark, std::uint32_t fieldNumber) {
  // The length of nearly every section takes one byte.
  std::uint8_t* place = roomFor(ProtoReader::kLongestVarint + 1);
  finishAt(putVarint(place, keyOf(fieldNumber, WireType::lengthDelimited)) + 1);
  mark.index = size_ - 1;
}

void ProtoWriter::endSection(const WriterMark& mark) {
  const std::size_t content = size_ - mark.index - 1;
  const std::size_t prefix = varintSize(content);
  if (prefix > 1) {
    roomFor(prefix - 1);
    std::uint8_t* start = buffer_ + mark.index;
    std::memmove(start + prefix, start + 1, content);
    size_ += prefix - 1;
  }
  putVarint(buffer_ + mark.index, content);
}

}  // namespace vesk
