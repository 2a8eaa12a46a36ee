#pragma once

#include <deque>
#include <google/protobuf/message.h>
#include <string>
#include <vector>

namespace vesk::bench {

/// Writes messages as JSON text by reflection, with nothing between: the fields that are present in the order of their
/// numbers, enumerations by name, bytes as "0x…" text; repeated scalars without values at the end. But for that order,
/// it is what the project's own dictionary form becomes. To be kept: it keeps its room from message to message.
class ReflectionWalk {
 public:
  void appendJson(std::string& out, const google::protobuf::Message& message);

 private:
  using Message = google::protobuf::Message;
  using Reflection = google::protobuf::Reflection;
  using Field = google::protobuf::FieldDescriptor;

  void appendValue(std::string& out, const Message& message, const Reflection& with, const Field* field);
  void appendElements(std::string& out, const Message& message, const Reflection& with, const Field* field);
  void appendElement(std::string& out, const Message& message, const Reflection& with, const Field* field, int index);

  /// The fields that are present, of the message at each depth.
  std::deque<std::vector<const Field*>> present_;
  std::size_t depth_ = 0;
};

}  // namespace vesk::bench
