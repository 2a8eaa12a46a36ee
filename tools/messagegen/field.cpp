#include "field.h"

#include <cctype>

namespace messagegen {

namespace {

/// What a .proto's type is in C++. `$type$` is the name of an enumeration or a message.
struct ValueType {
  std::string_view name;
  /// What stands behind a member of the type to give it its first value.
  std::string_view initial;
  std::string_view read;
  std::string_view write;
  /// How repeated values are held; empty for a type that cannot be repeated.
  std::string_view list;
};

const std::map<FieldDescriptor::Type, ValueType> kValueTypes{
    {FieldDescriptor::TYPE_UINT32, {"std::uint32_t", " = 0", "readUInt32", "writeUInt32", "RepeatedUInt32"}},
    {FieldDescriptor::TYPE_INT32, {"std::int32_t", " = 0", "readInt32", "writeInt32", "RepeatedInt32"}},
    {FieldDescriptor::TYPE_SINT32, {"std::int32_t", " = 0", "readSInt32", "writeSInt32", "RepeatedInt32"}},
    {FieldDescriptor::TYPE_UINT64, {"std::uint64_t", " = 0", "readUInt64", "writeUInt64", ""}},
    {FieldDescriptor::TYPE_BOOL, {"bool", " = false", "readBool", "writeBool", ""}},
    {FieldDescriptor::TYPE_ENUM, {"$type$", "{}", "readEnumeration<$type$>", "writeEnumeration", ""}},
    {FieldDescriptor::TYPE_STRING, {"std::optional<Text>", "", "readString", "writeString", ""}},
    {FieldDescriptor::TYPE_BYTES, {"std::optional<Data>", "", "readBytes", "writeBytes", ""}},
    {FieldDescriptor::TYPE_MESSAGE, {"std::shared_ptr<$type$>", "", "", "writeMessage", "MessageList<$type$>"}},
};

std::string capitalized(std::string name) {
  if (!name.empty()) name.front() = static_cast<char>(std::toupper(static_cast<unsigned char>(name.front())));
  return name;
}

/// The name of the accessors, or of those of one element: Thres_X_highP is thresXHighP.
std::string camelCase(std::string_view key) {
  std::string joined;
  for (std::size_t index = 0; index < key.size(); ++index) {
    const auto letter = static_cast<unsigned char>(key[index]);
    const bool startsWord = index > 0 && key[index - 1] == '_';
    if (letter == '_') continue;
    joined += static_cast<char>(joined.empty() ? std::tolower(letter) : startsWord ? std::toupper(letter) : letter);
  }
  return joined;
}

}  // namespace

bool isSupportedType(FieldDescriptor::Type type) {
  return kValueTypes.contains(type);
}

bool canBeRepeated(FieldDescriptor::Type type) {
  return !kValueTypes.at(type).list.empty();
}

FieldKind kindOf(const FieldDescriptor& field) {
  if (field.message_type() != nullptr) return field.is_repeated() ? FieldKind::messageList : FieldKind::message;
  if (field.is_repeated()) return FieldKind::repeatedScalar;
  return field.cpp_type() == FieldDescriptor::CPPTYPE_STRING ? FieldKind::string : FieldKind::scalar;
}

Variables fieldVariables(const FieldDescriptor& field) {
  const ValueType& type = kValueTypes.at(field.type());
  const std::string element = camelCase(field.name());
  const std::string property = element + (field.is_repeated() && !element.ends_with('s') ? "s" : "");
  const EnumDescriptor* enumeration = field.enum_type();
  const Descriptor* message = field.message_type();
  Variables variables{
      {"key", field.name()},
      {"number", std::to_string(field.number())},
      {"property", property},
      {"Property", capitalized(property)},
      {"element", element},
      {"Element", capitalized(element)},
      {"member", property + "_"},
      {"bit", "k" + capitalized(property)},
      {"type", enumeration != nullptr ? enumeration->name()
               : message != nullptr   ? message->name()
                                      : ""},
      {"first", enumeration != nullptr ? enumeration->value(0)->name() : ""},
      {"wire", kindOf(field) == FieldKind::scalar ? "WireType::varint" : "WireType::lengthDelimited"},
      {"initial", field.is_repeated() ? "" : std::string(type.initial)},
      {"write", std::string(type.write)},
  };
  const auto add = [&](const std::string& name, std::string_view snippet) {
    variables[name] = expandInline(snippet, variables);
  };
  add("value", type.name);
  add("held", field.is_repeated() ? type.list : type.name);
  add("read", type.read);
  add("gotten", enumeration != nullptr ? "has($bit$) ? $member$ : $type$::$first$" : "$member$");
  add("shown", enumeration != nullptr ? "nameOf($member$)" : "$member$");
  return variables;
}

}  // namespace messagegen
