#include "peer_messages.h"

#include <google/protobuf/dynamic_message.h>
#include <string>
#include <vector>

#include "messages/proto_schema.h"
#include "support/bytes.h"

namespace vesk {

namespace pb = google::protobuf;

namespace {

Value valueOf(const pb::Message& message, const FieldDescriptor* field) {
  const pb::Reflection& with = *message.GetReflection();
  const std::string letters =
      field->cpp_type() == FieldDescriptor::CPPTYPE_STRING ? with.GetString(message, field) : std::string();
  switch (field->cpp_type()) {
    case FieldDescriptor::CPPTYPE_UINT64:
      return with.GetUInt64(message, field);
    case FieldDescriptor::CPPTYPE_UINT32:
      return with.GetUInt32(message, field);
    case FieldDescriptor::CPPTYPE_INT32:
      return with.GetInt32(message, field);
    case FieldDescriptor::CPPTYPE_BOOL:
      return with.GetBool(message, field);
    case FieldDescriptor::CPPTYPE_ENUM:
      return Text::copy(with.GetEnum(message, field)->name());
    case FieldDescriptor::CPPTYPE_STRING:
      if (field->type() == FieldDescriptor::TYPE_STRING) return Text::copy(letters);
      return Data::copy(Bytes(letters.begin(), letters.end()));
    default:
      return dictionaryOf(with.GetMessage(message, field));
  }
}

Array arrayOf(const pb::Message& message, const FieldDescriptor* field) {
  const pb::Reflection& with = *message.GetReflection();
  Array array;
  for (int index = 0; index < with.FieldSize(message, field); ++index) {
    switch (field->cpp_type()) {
      case FieldDescriptor::CPPTYPE_UINT32:
        array.append(with.GetRepeatedUInt32(message, field, index));
        break;
      case FieldDescriptor::CPPTYPE_INT32:
        array.append(with.GetRepeatedInt32(message, field, index));
        break;
      default:
        array.append(dictionaryOf(with.GetRepeatedMessage(message, field, index)));
    }
  }
  return array;
}

}  // namespace

std::unique_ptr<pb::Message> makePeerMessage(std::string_view className) {
  static pb::DynamicMessageFactory factory;
  return std::unique_ptr<pb::Message>(factory.GetPrototype(&declaredMessage(className))->New());
}

Dictionary dictionaryOf(const pb::Message& message) {
  Dictionary dictionary;
  std::vector<const FieldDescriptor*> fields;
  message.GetReflection()->ListFields(message, &fields);
  for (const FieldDescriptor* field : fields)
    dictionary.append(Text::copy(field->name()),
                      field->is_repeated() ? Value(arrayOf(message, field)) : valueOf(message, field));
  return dictionary;
}

}  // namespace vesk
