// What our writers write, protobuf reads as the same fields and writes as the same bytes.

#include <google/protobuf/dynamic_message.h>

#include "messages/every_message.h"
#include "messages/filled_message.h"
#include "messages/proto_schema.h"
#include "support/decoded.h"

namespace vesk {
namespace {

namespace pb = google::protobuf;

Dictionary dictionaryOf(const pb::Message& message);

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

Dictionary dictionaryOf(const pb::Message& message) {
  Dictionary dictionary;
  std::vector<const FieldDescriptor*> fields;
  message.GetReflection()->ListFields(message, &fields);
  for (const FieldDescriptor* field : fields)
    dictionary.append(Text::copy(field->name()),
                      field->is_repeated() ? Value(arrayOf(message, field)) : valueOf(message, field));
  return dictionary;
}

class PeerAgrees : public testing::TestWithParam<MessageClass> {};
INSTANTIATE_TEST_SUITE_P(Schema, PeerAgrees, testing::ValuesIn(metrics::kEveryMessage), nameOfTest);

TEST_P(PeerAgrees, OnTheFieldsAndOnTheBytes) {
  pb::DynamicMessageFactory factory;
  for (const Filling filling : {Filling::small, Filling::extreme}) {
    const auto ours = GetParam().decode(filledMessage(GetParam().name, filling).payload);
    ProtoWriter writer;
    ours->writeTo(writer);
    const std::unique_ptr<pb::Message> theirs(factory.GetPrototype(&declaredMessage(GetParam().name))->New());
    ASSERT_TRUE(theirs->ParseFromArray(writer.written().data(), static_cast<int>(writer.written().size())));
    EXPECT_TRUE(theirs->GetReflection()->GetUnknownFields(*theirs).empty());
    EXPECT_EQ(dictionaryOf(*theirs), ours->dictionaryRepresentation()) << shown(*ours);

    const std::string bytes = theirs->SerializeAsString();
    EXPECT_EQ(hexOf(Bytes(bytes.begin(), bytes.end())), hexOf(writer.written()));
  }
}

}  // namespace
}  // namespace vesk
