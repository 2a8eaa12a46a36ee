#include "messages/codec/message.h"

#include <functional>
#include <string>

#include "messages/registry/metric_utility.h"
#include "system/system_log.h"

namespace vesk {

namespace {

std::uint64_t bytesHash(std::string_view bytes) {
  return std::hash<std::string_view>{}(bytes);
}

}  // namespace

bool readUndeclaredField(FieldKey key, std::string_view messageClass, ProtoReader& reader) {
  if (!KBBMetricUtility::isValidMetricIdTag(key.number, messageClass)) {
    return reader.skipField(key.number, key.wireType);
  }
  const auto value = static_cast<std::uint32_t>(reader.readVarint());
  SystemLog::write("Unknown tag: %x:%u", key.number, value);
  return true;
}

std::uint64_t objectHash(const std::optional<Text>& text) {
  return text ? bytesHash(text->view()) : 0;
}

std::uint64_t objectHash(const std::optional<Data>& data) {
  if (!data) return 0;
  return bytesHash({reinterpret_cast<const char*>(data->bytes().data()), data->bytes().size()});
}

Text unknownName(std::int32_t value) {
  return Text::copy("(unknown: " + std::to_string(value) + ")");
}

}  // namespace vesk
