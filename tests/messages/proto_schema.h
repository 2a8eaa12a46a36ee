#pragma once

#include <google/protobuf/descriptor.h>
#include <map>
#include <string_view>
#include <vector>

/// The .proto files themselves, as libprotobuf reads them.
namespace vesk {

using google::protobuf::Descriptor;
using google::protobuf::FieldDescriptor;

[[nodiscard]] const std::vector<const Descriptor*>& declaredMessages();
/// Ends the program when there is none of that name.
[[nodiscard]] const Descriptor& declaredMessage(std::string_view name);

[[nodiscard]] std::map<int, const FieldDescriptor*> fieldsByNumber(const Descriptor& message);

}  // namespace vesk
