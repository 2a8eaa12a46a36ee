#include <algorithm>

#include "emit.h"
#include "names.h"

namespace messagegen {

namespace {

struct TypeNames {
  std::string held;
  /// The value of a member before it is set.
  std::string initial;
  std::string read;
  std::string write;
};

TypeNames typeNames(const Field& field) {
  switch (field.type) {
    case FieldType::uint32:
      return {"std::uint32_t", " = 0", "readUInt32", "writeUInt32"};
    case FieldType::int32:
      return {"std::int32_t", " = 0", "readInt32", "writeInt32"};
    case FieldType::sint32:
      return {"std::int32_t", " = 0", "readSInt32", "writeSInt32"};
    case FieldType::uint64:
      return {"std::uint64_t", " = 0", "readUInt64", "writeUInt64"};
    case FieldType::boolean:
      return {"bool", " = false", "readBool", "writeBool"};
    case FieldType::enumeration:
      return {field.typeName, "{}", "readEnumeration<" + field.typeName + ">", "writeEnumeration"};
    case FieldType::string:
      return {"std::optional<Text>", "", "readString", "writeString"};
    case FieldType::bytes:
      return {"std::optional<Data>", "", "readBytes", "writeBytes"};
    case FieldType::message:
      return {"std::shared_ptr<" + field.typeName + ">", "", "", ""};
  }
  return {};
}

std::string heldType(const Field& field, const TypeNames& names) {
  if (field.isMessageList()) return "MessageList<" + field.typeName + ">";
  if (field.isRepeatedScalar()) return field.type == FieldType::uint32 ? "RepeatedUInt32" : "RepeatedInt32";
  return names.held;
}

}  // namespace

Variables fieldVariables(const Field& field) {
  const std::string property = propertyOf(field);
  const TypeNames names = typeNames(field);
  return {
      {"key", field.name},
      {"number", std::to_string(field.number)},
      {"property", property},
      {"Property", capitalized(property)},
      {"element", elementOf(field)},
      {"Element", capitalized(elementOf(field))},
      {"member", property + "_"},
      {"bit", "k" + capitalized(property)},
      {"value", names.held},
      {"held", heldType(field, names)},
      {"initial", field.repeated ? "" : names.initial},
      {"default", field.defaultName},
      {"read", names.read},
      {"write", names.write},
  };
}

std::vector<Field> fieldsByNumber(const MessageType& message) {
  std::vector<Field> fields = message.fields;
  std::sort(fields.begin(), fields.end(), [](const Field& a, const Field& b) { return a.number < b.number; });
  return fields;
}

}  // namespace messagegen
