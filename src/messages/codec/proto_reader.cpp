#include "messages/codec/proto_reader.h"

#include <algorithm>
#include <array>

namespace vesk {

std::uint8_t ProtoReader::readByte() {
  if (pos >= length || error) {
    error = true;
    return 0;
  }
  return bytes[pos++];
}

std::uint64_t ProtoReader::readVarint() {
  std::uint64_t value = 0;
  for (unsigned count = 0; count < kLongestVarint; ++count) {
    const std::uint8_t byte = readByte();
    value |= std::uint64_t{byte & 0x7FU} << (7 * count);
    if (byte < 0x80) return error ? 0 : value;
  }
  return 0;
}

std::uint64_t ProtoReader::lastWord(std::uint64_t place) const {
  const std::size_t left = inputSize_ - place;
  std::uint64_t word = 0;
  if (inputSize_ < sizeof word) {
    std::copy_n(bytes + place, left, reinterpret_cast<std::uint8_t*>(&word));
  } else if (left > 0) {
    std::memcpy(&word, bytes + inputSize_ - sizeof word, sizeof word);
    word >>= 8 * (sizeof word - left);
  }
  return word;
}

Text ProtoReader::readString() {
  const std::span<const std::uint8_t> content = readLengthDelimited();
  return Text::copy({reinterpret_cast<const char*>(content.data()), content.size()});
}

Data ProtoReader::readBytes() {
  return Data::copy(readLengthDelimited());
}

std::span<const std::uint8_t> ProtoReader::readLengthDelimited() {
  const std::uint64_t size = readVarint();
  const std::uint64_t start = pos;
  if (!skipBytes(size)) return {};
  return {bytes + start, static_cast<std::size_t>(size)};
}

bool ProtoReader::skipBytes(std::uint64_t count) {
  if (error || count > length - pos) {
    error = true;
    return false;
  }
  pos += count;
  return true;
}

bool ProtoReader::skipField(std::uint32_t fieldNumber, WireType wireType) {
  switch (wireType) {
    case WireType::varint:
      readVarint();
      return !error;
    case WireType::fixed64:
      return skipBytes(8);
    case WireType::lengthDelimited:
      return skipBytes(readVarint());
    case WireType::startGroup:
      return skipGroup(fieldNumber);
    case WireType::fixed32:
      return skipBytes(4);
    case WireType::endGroup:
      break;
  }
  return false;
}

bool ProtoReader::skipGroup(std::uint32_t fieldNumber) {
  std::array<std::uint32_t, kDeepestGroup> open;
  std::size_t depth = 0;
  open[depth++] = fieldNumber;
  while (depth > 0) {
    const FieldKey key = FieldKey::of(readVarint());
    if (error) return false;
    if (key.wireType == WireType::startGroup) {
      if (depth == open.size()) return false;
      open[depth++] = key.number;
    } else if (key.wireType == WireType::endGroup) {
      if (open[--depth] != key.number) return false;
    } else if (!skipField(key.number, key.wireType)) {
      return false;
    }
  }
  return true;
}

}  // namespace vesk
