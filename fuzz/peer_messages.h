#pragma once

#include <google/protobuf/message.h>
#include <memory>
#include <string_view>

#include "values/value.h"

namespace vesk {

/// An empty message of libprotobuf's, of that class of the schema as protoc understood it.
[[nodiscard]] std::unique_ptr<google::protobuf::Message> makePeerMessage(std::string_view className);

/// Its fields, in the dictionary form of our own messages.
[[nodiscard]] Dictionary dictionaryOf(const google::protobuf::Message& message);

}  // namespace vesk
