#include "bench/agreement.h"

#include <algorithm>
#include <google/protobuf/descriptor.h>
#include <google/protobuf/struct.pb.h>
#include <google/protobuf/util/json_util.h>
#include <google/protobuf/util/message_differencer.h>

#include "bench/stop.h"
#include "messages/codec/proto_writer.h"
#include "values/text_form.h"

namespace vesk::bench {

namespace {

using google::protobuf::FieldDescriptor;
using google::protobuf::Reflection;

[[noreturn]] void disagree(const Event& event, std::string_view what) {
  std::string line(event.kind->name);
  line += ' ';
  appendHex(line, event.payload);
  line += ": ";
  line += what;
  stop(line);
}

std::uint64_t sumOf(const LibprotobufMessage& message);

std::uint64_t sumOf(const LibprotobufMessage& message, const Reflection& with, const FieldDescriptor* field) {
  switch (field->cpp_type()) {
    case FieldDescriptor::CPPTYPE_UINT64:
      return with.GetUInt64(message, field);
    case FieldDescriptor::CPPTYPE_UINT32:
      return with.GetUInt32(message, field);
    case FieldDescriptor::CPPTYPE_INT32:
      return static_cast<std::uint64_t>(std::int64_t{with.GetInt32(message, field)});
    case FieldDescriptor::CPPTYPE_BOOL:
      return with.GetBool(message, field) ? 1 : 0;
    case FieldDescriptor::CPPTYPE_ENUM:
      return static_cast<std::uint64_t>(std::int64_t{with.GetEnumValue(message, field)});
    case FieldDescriptor::CPPTYPE_STRING:
      return with.GetString(message, field).size();
    default:
      return sumOf(with.GetMessage(message, field));
  }
}

std::uint64_t sumOfElement(const LibprotobufMessage& message, const Reflection& with, const FieldDescriptor* field,
                           int index) {
  switch (field->cpp_type()) {
    case FieldDescriptor::CPPTYPE_UINT32:
      return with.GetRepeatedUInt32(message, field, index);
    case FieldDescriptor::CPPTYPE_INT32:
      return static_cast<std::uint64_t>(std::int64_t{with.GetRepeatedInt32(message, field, index)});
    default:
      return sumOf(with.GetRepeatedMessage(message, field, index));
  }
}

/// What a visit of all fields adds up.
std::uint64_t sumOf(const LibprotobufMessage& message) {
  const Reflection& with = *message.GetReflection();
  std::vector<const FieldDescriptor*> fields;
  with.ListFields(message, &fields);
  std::uint64_t sum = 0;
  for (const FieldDescriptor* field : fields) {
    if (!field->is_repeated()) {
      sum += sumOf(message, with, field);
      continue;
    }
    for (int index = 0; index < with.FieldSize(message, field); ++index)
      sum += sumOfElement(message, with, field, index);
  }
  return sum;
}

/// Whether two JSON objects differ in nothing but the order of their keys.
bool isSameObject(const std::string& a, const std::string& b) {
  google::protobuf::Struct left;
  google::protobuf::Struct right;
  return google::protobuf::util::JsonStringToMessage(a, &left).ok() &&
         google::protobuf::util::JsonStringToMessage(b, &right).ok() &&
         google::protobuf::util::MessageDifferencer::Equals(left, right);
}

void requireSameJson(const Event& event) {
  std::string ours;
  std::string theirs;
  ReflectionWalk walk;
  if (!event.kind->ours.readIntoJson(event.payload, ours)) disagree(event, "vesk does not read it");
  if (!event.kind->libprotobuf.readIntoJsonByReflection(event.payload, walk, theirs))
    disagree(event, "libprotobuf does not read it");
  if (ours != theirs && !isSameObject(ours, theirs)) disagree(event, "vesk reads " + ours + ", libprotobuf " + theirs);
  std::string byUtility;
  if (!event.kind->libprotobuf.readIntoJsonByUtility(event.payload, byUtility))
    disagree(event, "libprotobuf's utility makes no JSON of it");
}

void requireSameBytes(const Event& event, const LibprotobufMessage& read) {
  ProtoWriter writer;
  const Data ours = event.kind->ours.write(*event.kind->ours.make(event.payload), writer);
  const auto written = event.kind->libprotobuf.make(ours.bytes());
  if (written == nullptr || !google::protobuf::util::MessageDifferencer::Equals(*written, read))
    disagree(event, "libprotobuf reads something else from what vesk writes");
  if (event.kind->libprotobuf.write(read).size() != ours.bytes().size())
    disagree(event, "vesk and libprotobuf do not write the same number of bytes");
}

void requireSameSum(const Event& event, const LibprotobufMessage& read) {
  if (event.kind->visitByProtozero(event.payload) != sumOf(read))
    disagree(event, "protozero does not visit the fields that libprotobuf reads");
}

}  // namespace

void requireAgreement(const Corpus& corpus) {
  for (const Event& event : corpus.events()) {
    requireSameJson(event);
    const auto read = event.kind->libprotobuf.make(event.payload);
    requireSameBytes(event, *read);
    requireSameSum(event, *read);
  }
}

}  // namespace vesk::bench
