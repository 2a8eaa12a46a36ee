#include "peers/reflection_json.h"

#include <cstdint>
#include <google/protobuf/descriptor.h>
#include <span>

#include "app/json_form.h"
#include "platform/text_form.h"

namespace vesk::bench {

namespace {

using google::protobuf::Descriptor;
using google::protobuf::EnumValueDescriptor;
using google::protobuf::FieldDescriptor;
using google::protobuf::Message;
using google::protobuf::Reflection;

void appendInteger(std::string& out, std::int64_t number) {
  appendDecimal(out, number);
}

/// Names of the schema need no escapes.
void appendQuoted(std::string& out, const std::string& name) {
  out += '"';
  out += name;
  out += '"';
}

void appendBytes(std::string& out, const std::string& bytes) {
  out += "\"0x";
  appendHex(out, {reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
  out += '"';
}

void appendSingle(std::string& out, const Message& message, const Reflection& with, const FieldDescriptor* field) {
  switch (field->cpp_type()) {
    case FieldDescriptor::CPPTYPE_UINT64:
      return appendDecimal(out, std::uint64_t{with.GetUInt64(message, field)});
    case FieldDescriptor::CPPTYPE_UINT32:
      return appendInteger(out, with.GetUInt32(message, field));
    case FieldDescriptor::CPPTYPE_INT32:
      return appendInteger(out, with.GetInt32(message, field));
    case FieldDescriptor::CPPTYPE_BOOL:
      out += with.GetBool(message, field) ? "true" : "false";
      return;
    case FieldDescriptor::CPPTYPE_ENUM:
      return appendQuoted(out, with.GetEnum(message, field)->name());
    case FieldDescriptor::CPPTYPE_STRING: {
      std::string scratch;
      const std::string& content = with.GetStringReference(message, field, &scratch);
      if (field->type() == FieldDescriptor::TYPE_BYTES) return appendBytes(out, content);
      return appendJson(out, content);
    }
    default:
      return appendReflectedJson(out, with.GetMessage(message, field));
  }
}

void appendElement(std::string& out, const Message& message, const Reflection& with, const FieldDescriptor* field,
                   int index) {
  switch (field->cpp_type()) {
    case FieldDescriptor::CPPTYPE_UINT32:
      return appendInteger(out, with.GetRepeatedUInt32(message, field, index));
    case FieldDescriptor::CPPTYPE_INT32:
      return appendInteger(out, with.GetRepeatedInt32(message, field, index));
    default:
      return appendReflectedJson(out, with.GetRepeatedMessage(message, field, index));
  }
}

void appendList(std::string& out, const Message& message, const Reflection& with, const FieldDescriptor* field,
                int size) {
  out += '[';
  for (int index = 0; index < size; ++index) {
    if (index > 0) out += ',';
    appendElement(out, message, with, field, index);
  }
  out += ']';
}

}  // namespace

void appendReflectedJson(std::string& out, const Message& message) {
  const Descriptor& type = *message.GetDescriptor();
  const Reflection& with = *message.GetReflection();
  char separator = '{';
  const auto startField = [&](const FieldDescriptor* field) {
    out += separator;
    separator = ',';
    appendQuoted(out, field->name());
    out += ':';
  };
  for (int index = 0; index < type.field_count(); ++index) {
    const FieldDescriptor* field = type.field(index);
    if (field->is_repeated()) {
      const int size = with.FieldSize(message, field);
      if (size == 0 && field->cpp_type() == FieldDescriptor::CPPTYPE_MESSAGE) continue;
      startField(field);
      appendList(out, message, with, field, size);
    } else if (with.HasField(message, field)) {
      startField(field);
      appendSingle(out, message, with, field);
    }
  }
  if (separator == '{') out += '{';
  out += '}';
}

}  // namespace vesk::bench
