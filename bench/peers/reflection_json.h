#pragma once

#include <google/protobuf/message.h>
#include <string>

namespace vesk::bench {

/// Appends the message as JSON text, by reflection and without anything between: the fields that are present in the
/// order of their declaration, repeated scalars always, enumerations by name, bytes as "0x…" text. But for the order,
/// it is what the project's own dictionary form becomes.
void appendReflectedJson(std::string& out, const google::protobuf::Message& message);

}  // namespace vesk::bench
