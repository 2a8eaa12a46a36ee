#include "messages/codec/proto_reader.h"

#include <array>

namespace vesk {

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
    const FieldKey key = readKey();
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

bool ProtoReader::enterSection(ReaderMark& mark) {
  const std::uint64_t size = readVarint();
  if (error || size > length - pos) return false;
  mark.length = length;
  length = pos + size;
  return true;
}

}  // namespace vesk
