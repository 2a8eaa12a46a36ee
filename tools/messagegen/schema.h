#pragma once

#include <google/protobuf/descriptor.h>
#include <stdexcept>
#include <string>
#include <vector>

/// What protoc understood of a .proto file.
namespace messagegen {

using google::protobuf::Descriptor;
using google::protobuf::EnumDescriptor;
using google::protobuf::EnumValueDescriptor;
using google::protobuf::FieldDescriptor;
using google::protobuf::FileDescriptor;
using google::protobuf::SourceLocation;

/// All in the order in which they are declared.
[[nodiscard]] std::vector<const Descriptor*> messagesOf(const FileDescriptor& file);
[[nodiscard]] std::vector<const EnumDescriptor*> enumerationsOf(const FileDescriptor& file);
[[nodiscard]] std::vector<const EnumDescriptor*> enumerationsOf(const Descriptor& message);
[[nodiscard]] std::vector<const EnumValueDescriptor*> valuesOf(const EnumDescriptor& enumeration);
[[nodiscard]] std::vector<const FieldDescriptor*> fieldsOf(const Descriptor& message);
/// In the order of their numbers, in which every operation takes them.
[[nodiscard]] std::vector<const FieldDescriptor*> fieldsByNumber(const Descriptor& message);

/// Where a declaration stands or, with the path that descriptor.proto gives to it, another part of a file.
template <class Declaration, class... Path>
[[nodiscard]] SourceLocation locationOf(const Declaration& declaration, const Path&... path) {
  SourceLocation location{};
  (void)declaration.GetSourceLocation(path..., &location);
  return location;
}

/// The lines of the comment directly before the declaration.
[[nodiscard]] std::vector<std::string> commentLines(const SourceLocation& location);

/// A .proto file is refused; what() is "lte/lte.proto:3:5: what is wrong; what to do".
class Refusal : public std::runtime_error {
 public:
  Refusal(const FileDescriptor& file, const SourceLocation& location, const std::string& text);
};

}  // namespace messagegen
