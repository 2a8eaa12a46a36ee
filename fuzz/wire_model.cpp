#include "wire_model.h"

#include <map>
#include <set>
#include <string>
#include <vector>

#include "messages/proto_schema.h"

namespace vesk {

namespace {

/// Thrown where the bytes are no encoding of a message.
struct Malformed {};

constexpr std::size_t kLongestVarint = 10;
constexpr int kDeepestGroup = 100;

/// Field numbers under which a sender may wrap a message: the low 16 bits of every metric's identifier.
const std::set<std::uint64_t> kMetricNumbers{
    19,    11788, 12300, 16578, 19972, 19992, 20005, 20330, 53249, 53250, 53251, 53257, 53260, 53506, 53507, 53508,
    53509, 53522, 53523, 54017, 54018, 54027, 54030, 54031, 54032, 54035, 54537, 54538, 54539, 54540, 54541};

/// What is left of a payload, or of a section of one.
class Rest {
 public:
  explicit Rest(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  [[nodiscard]] bool empty() const { return bytes_.empty(); }

  std::span<const std::uint8_t> take(std::uint64_t count) {
    if (count > bytes_.size()) throw Malformed{};
    const auto taken = bytes_.first(static_cast<std::size_t>(count));
    bytes_ = bytes_.subspan(taken.size());
    return taken;
  }

  /// Seven bits a byte, the lowest first. One of ten bytes of which not even the last ends it is worth 0.
  std::uint64_t varint() {
    std::vector<std::uint8_t> groups;
    do {
      groups.push_back(take(1)[0]);
    } while (groups.back() >= 128 && groups.size() < kLongestVarint);
    if (groups.back() >= 128) return 0;
    std::uint64_t value = 0;
    for (; !groups.empty(); groups.pop_back())
      value = value * 128 + groups.back() % 128;
    return value;
  }

  std::span<const std::uint8_t> section() { return take(varint()); }

 private:
  std::span<const std::uint8_t> bytes_;
};

struct Key {
  std::uint64_t number;
  std::uint64_t wireType;
};

Key keyOf(Rest& rest) {
  const std::uint64_t key = rest.varint();
  return {key / 8 % 65536, key % 8};
}

/// `depth` is that of the groups around the value.
void skip(Key key, Rest& rest, int depth);

void skipGroup(std::uint64_t number, Rest& rest, int depth) {
  if (depth > kDeepestGroup) throw Malformed{};
  for (;;) {
    const Key key = keyOf(rest);
    if (key.wireType != 4) {
      skip(key, rest, depth);
    } else if (key.number == number) {
      return;
    } else {
      throw Malformed{};
    }
  }
}

void skip(Key key, Rest& rest, int depth) {
  switch (key.wireType) {
    case 0:
      rest.varint();
      break;
    case 1:
      rest.take(8);
      break;
    case 2:
      rest.section();
      break;
    case 3:
      skipGroup(key.number, rest, depth + 1);
      break;
    case 5:
      rest.take(4);
      break;
    default:
      throw Malformed{};
  }
}

Value nameOf(const google::protobuf::EnumDescriptor& enumeration, std::int32_t number) {
  const auto* value = enumeration.FindValueByNumber(number);
  return Text::copy(value != nullptr ? value->name() : "(unknown: " + std::to_string(number) + ")");
}

/// Whether its values come as varints.
bool isScalar(const FieldDescriptor& field) {
  return FieldDescriptor::IsTypePackable(field.type());
}

/// A message as it is put together from what arrives, field by field.
class MessageModel {
 public:
  explicit MessageModel(const Descriptor& type) : type_(type) {}

  void read(Rest rest) {
    while (!rest.empty()) {
      const Key key = keyOf(rest);
      if (key.wireType == 4) return;
      if (const FieldDescriptor* field = declared(key.number)) {
        readField(*field, key, rest);
      } else if (kMetricNumbers.contains(key.number)) {
        // The length of a section around the message itself, whose content follows.
        rest.varint();
      } else {
        skip(key, rest, 0);
      }
    }
  }

  [[nodiscard]] Dictionary dictionary() const {
    Dictionary dictionary;
    for (const auto& [number, field] : fieldsByNumber(type_)) {
      const auto found = arrived_.find(number);
      const bool hasArrived = found != arrived_.end() && !found->second.empty();
      if (hasArrived && !field->is_repeated()) {
        dictionary.set(Text::copy(field->name()), found->second.back());
      } else if (hasArrived || field->is_packable()) {
        Array array;
        if (hasArrived) {
          for (const Value& each : found->second)
            array.append(each);
        }
        dictionary.set(Text::copy(field->name()), array);
      }
    }
    return dictionary;
  }

 private:
  [[nodiscard]] const FieldDescriptor* declared(std::uint64_t number) const {
    return type_.FindFieldByNumber(static_cast<int>(number));
  }

  void readField(const FieldDescriptor& field, Key key, Rest& rest) {
    std::vector<Value>& values = arrived_[field.number()];
    if (field.is_packable() && key.wireType == 2) {
      for (Rest packed(rest.section()); !packed.empty();)
        values.push_back(scalar(field, packed.varint()));
    } else if (isScalar(field)) {
      values.push_back(scalar(field, rest.varint()));
    } else {
      values.push_back(object(field, rest.section()));
    }
  }

  [[nodiscard]] static Value scalar(const FieldDescriptor& field, std::uint64_t varint) {
    const auto low = static_cast<std::uint32_t>(varint);
    const auto signedLow = static_cast<std::int32_t>(low);
    switch (field.type()) {
      case FieldDescriptor::TYPE_UINT64:
        return varint;
      case FieldDescriptor::TYPE_INT32:
        return signedLow;
      case FieldDescriptor::TYPE_SINT32:
        // 0, -1, 1, -2, 2 and so on.
        return low % 2 == 0 ? std::int64_t{low / 2} : -std::int64_t{low / 2} - 1;
      case FieldDescriptor::TYPE_BOOL:
        return varint != 0;
      case FieldDescriptor::TYPE_ENUM:
        return nameOf(*field.enum_type(), signedLow);
      default:
        return low;
    }
  }

  [[nodiscard]] static Value object(const FieldDescriptor& field, std::span<const std::uint8_t> section) {
    if (field.type() == FieldDescriptor::TYPE_BYTES) return Data::copy(section);
    if (field.type() == FieldDescriptor::TYPE_STRING) return Text::copy(std::string(section.begin(), section.end()));
    MessageModel message(*field.message_type());
    message.read(Rest(section));
    return message.dictionary();
  }

  const Descriptor& type_;
  /// The values of each field in the order in which they came.
  std::map<int, std::vector<Value>> arrived_;
};

}  // namespace

std::optional<Dictionary> modelledDictionary(std::string_view className, std::span<const std::uint8_t> payload) {
  try {
    MessageModel message(declaredMessage(className));
    message.read(Rest(payload));
    return message.dictionary();
  } catch (const Malformed&) {
    return std::nullopt;
  }
}

}  // namespace vesk
