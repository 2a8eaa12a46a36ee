#include "bench/peers/reflection_walk.h"

#include <cstdint>
#include <google/protobuf/descriptor.h>
#include <span>
#include <string_view>

#include "values/json_form.h"
#include "values/text_form.h"

namespace vesk::bench {

namespace {

using google::protobuf::Descriptor;

void appendInteger(std::string& out, std::int64_t number) {
  appendDecimal(out, number);
}

/// Names of the schema need no escapes.
void appendName(std::string& out, const std::string& name) {
  out += '"';
  out += name;
  out += '"';
}

void appendBytes(std::string& out, const std::string& bytes) {
  out += "\"0x";
  appendHex(out, {reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
  out += '"';
}

}  // namespace

void ReflectionWalk::appendJson(std::string& out, const Message& message) {
  if (present_.size() == depth_) present_.emplace_back();
  std::vector<const Field*>& present = present_[depth_];
  present.clear();
  const Reflection& with = *message.GetReflection();
  with.ListFields(message, &present);

  char separator = '{';
  const auto startField = [&](const Field* field) {
    out += separator;
    separator = ',';
    appendName(out, field->name());
    out += ':';
  };
  ++depth_;
  for (const Field* field : present) {
    startField(field);
    if (field->is_repeated()) {
      appendElements(out, message, with, field);
    } else {
      appendValue(out, message, with, field);
    }
  }
  --depth_;

  const Descriptor& type = *message.GetDescriptor();
  for (int index = 0; index < type.field_count(); ++index) {
    const Field* field = type.field(index);
    const bool isRepeatedScalar = field->is_repeated() && field->cpp_type() != Field::CPPTYPE_MESSAGE;
    if (!isRepeatedScalar || with.FieldSize(message, field) > 0) continue;
    startField(field);
    out += "[]";
  }
  if (separator == '{') out += '{';
  out += '}';
}

void ReflectionWalk::appendValue(std::string& out, const Message& message, const Reflection& with, const Field* field) {
  switch (field->cpp_type()) {
    case Field::CPPTYPE_UINT64:
      return appendDecimal(out, std::uint64_t{with.GetUInt64(message, field)});
    case Field::CPPTYPE_UINT32:
      return appendInteger(out, with.GetUInt32(message, field));
    case Field::CPPTYPE_INT32:
      return appendInteger(out, with.GetInt32(message, field));
    case Field::CPPTYPE_BOOL:
      out += with.GetBool(message, field) ? "true" : "false";
      return;
    case Field::CPPTYPE_ENUM:
      return appendName(out, with.GetEnum(message, field)->name());
    case Field::CPPTYPE_STRING: {
      std::string scratch;
      const std::string& content = with.GetStringReference(message, field, &scratch);
      if (field->type() == Field::TYPE_BYTES) return appendBytes(out, content);
      return vesk::appendJson(out, content);
    }
    default:
      return appendJson(out, with.GetMessage(message, field));
  }
}

void ReflectionWalk::appendElements(std::string& out, const Message& message, const Reflection& with,
                                    const Field* field) {
  const int size = with.FieldSize(message, field);
  out += '[';
  for (int index = 0; index < size; ++index) {
    if (index > 0) out += ',';
    appendElement(out, message, with, field, index);
  }
  out += ']';
}

void ReflectionWalk::appendElement(std::string& out, const Message& message, const Reflection& with, const Field* field,
                                   int index) {
  switch (field->cpp_type()) {
    case Field::CPPTYPE_UINT32:
      return appendInteger(out, with.GetRepeatedUInt32(message, field, index));
    case Field::CPPTYPE_INT32:
      return appendInteger(out, with.GetRepeatedInt32(message, field, index));
    default:
      return appendJson(out, with.GetRepeatedMessage(message, field, index));
  }
}

}  // namespace vesk::bench
