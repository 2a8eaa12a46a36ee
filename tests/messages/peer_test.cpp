// What our writers write, the library that everybody uses reads as the same fields, and the other way round.

#include <cstdlib>
#include <fstream>
#include <google/protobuf/descriptor.pb.h>
#include <google/protobuf/dynamic_message.h>
#include <limits>

#include "messages/every_message.h"
#include "support/decoded.h"

namespace vesk {
namespace {

namespace pb = google::protobuf;
using pb::FieldDescriptor;

/// Makes messages of the schema, as protoc understood it.
class Peer {
 public:
  Peer() {
    std::ifstream file(VESK_DESCRIPTORS, std::ios::binary);
    pb::FileDescriptorSet files;
    if (!files.ParseFromIstream(&file)) std::abort();
    for (const pb::FileDescriptorProto& each : files.file()) {
      if (pool_.BuildFile(each) == nullptr) std::abort();
    }
  }

  std::unique_ptr<pb::Message> make(std::string_view className) {
    const pb::Descriptor* type = pool_.FindMessageTypeByName("metrics." + std::string(className));
    return std::unique_ptr<pb::Message>(factory_.GetPrototype(type)->New());
  }

 private:
  pb::DescriptorPool pool_;
  pb::DynamicMessageFactory factory_;
};

enum class Filling { least, largest };

/// Sets every field, lists to two elements.
void fill(pb::Message& message, Filling filling) {
  const bool isLeast = filling == Filling::least;
  const pb::Reflection& with = *message.GetReflection();
  for (int index = 0; index < message.GetDescriptor()->field_count(); ++index) {
    const FieldDescriptor* field = message.GetDescriptor()->field(index);
    const auto unsigned32 = isLeast ? 0U : std::numeric_limits<std::uint32_t>::max();
    const auto signed32 = isLeast ? std::numeric_limits<std::int32_t>::min() : std::numeric_limits<std::int32_t>::max();
    const std::string letters = isLeast ? "" : "\u00e9" + field->name();
    for (int count = 0; field->is_repeated() && count < 2; ++count) {
      switch (field->cpp_type()) {
        case FieldDescriptor::CPPTYPE_UINT32:
          with.AddUInt32(&message, field, unsigned32);
          break;
        case FieldDescriptor::CPPTYPE_INT32:
          with.AddInt32(&message, field, signed32);
          break;
        default:
          fill(*with.AddMessage(&message, field), filling);
      }
    }
    if (field->is_repeated()) continue;
    switch (field->cpp_type()) {
      case FieldDescriptor::CPPTYPE_UINT64:
        with.SetUInt64(&message, field, isLeast ? 0 : std::numeric_limits<std::uint64_t>::max());
        break;
      case FieldDescriptor::CPPTYPE_UINT32:
        with.SetUInt32(&message, field, unsigned32);
        break;
      case FieldDescriptor::CPPTYPE_INT32:
        with.SetInt32(&message, field, signed32);
        break;
      case FieldDescriptor::CPPTYPE_BOOL:
        with.SetBool(&message, field, !isLeast);
        break;
      case FieldDescriptor::CPPTYPE_ENUM:
        with.SetEnum(&message, field, field->enum_type()->value(isLeast ? 0 : field->enum_type()->value_count() - 1));
        break;
      case FieldDescriptor::CPPTYPE_STRING:
        with.SetString(&message, field, letters);
        break;
      default:
        fill(*with.MutableMessage(&message, field), filling);
    }
  }
}

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

template <class M>
class PeerAgrees : public testing::Test {};
TYPED_TEST_SUITE(PeerAgrees, metrics::EveryMessage);

TYPED_TEST(PeerAgrees, OnTheFieldsAndOnTheBytes) {
  static Peer peer;
  for (const Filling filling : {Filling::least, Filling::largest}) {
    const auto theirs = peer.make(TypeParam::kClassName);
    fill(*theirs, filling);
    const std::string bytes = theirs->SerializeAsString();
    const auto ours = TypeParam::initWithData({reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
    ASSERT_NE(ours, nullptr);
    EXPECT_EQ(ours->dictionaryRepresentation(), dictionaryOf(*theirs)) << shown(*ours);

    ProtoWriter writer;
    ours->writeTo(writer);
    const auto back = peer.make(TypeParam::kClassName);
    ASSERT_TRUE(back->ParseFromArray(writer.written().data(), static_cast<int>(writer.written().size())));
    EXPECT_TRUE(back->GetReflection()->GetUnknownFields(*back).empty());
    EXPECT_EQ(dictionaryOf(*back), dictionaryOf(*theirs));
    EXPECT_EQ(hexOf(writer.written()), hexOf(Bytes(bytes.begin(), bytes.end())));
  }
}

}  // namespace
}  // namespace vesk
