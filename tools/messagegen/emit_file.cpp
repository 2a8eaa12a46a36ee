#include <algorithm>
#include <functional>

#include "emit.h"

namespace messagegen {

namespace {

std::string headerPath(const FileDescriptor& file) {
  return "messages/" + file.name().substr(0, file.name().rfind('.')) + ".h";
}

std::string emitIncludes(const FileDescriptor& file) {
  std::vector<std::string> paths{"messages/codec/message.h"};
  for (int index = 0; index < file.dependency_count(); ++index)
    paths.push_back(headerPath(*file.dependency(index)));
  std::sort(paths.begin(), paths.end());
  std::string out;
  for (const std::string& path : paths)
    out += expand("#include \"$path$\"", {{"path", path}});
  return out;
}

/// Each message behind those that it contains: C++ wants a class declared before it is used, a .proto file does not.
std::vector<const Descriptor*> messagesByUse(const FileDescriptor& file) {
  std::vector<const Descriptor*> ordered;
  const std::function<void(const Descriptor&)> place = [&](const Descriptor& message) {
    if (message.file() != &file || std::find(ordered.begin(), ordered.end(), &message) != ordered.end()) return;
    for (const FieldDescriptor* field : fieldsOf(message)) {
      if (field->message_type() != nullptr) place(*field->message_type());
    }
    ordered.push_back(&message);
  };
  for (const Descriptor* message : messagesOf(file))
    place(*message);
  return ordered;
}

/// The blocks with an empty line between them.
std::string joined(const std::vector<std::string>& blocks) {
  std::string out;
  for (const std::string& block : blocks)
    out += (out.empty() ? "" : "\n") + block;
  return out;
}

}  // namespace

std::string emitHeader(const FileDescriptor& file) {
  std::vector<std::string> blocks;
  for (const EnumDescriptor* enumeration : enumerationsOf(file)) {
    blocks.push_back(emitEnumeration(*enumeration));
    blocks.push_back(emitNameDeclaration(*enumeration));
  }
  for (const Descriptor* message : messagesByUse(file)) {
    blocks.push_back(emitClass(*message));
    for (const EnumDescriptor* enumeration : enumerationsOf(*message))
      blocks.push_back(emitNameDeclaration(*enumeration));
  }
  return expand(R"code(
// Generated from $path$; do not edit.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>

$includes$

namespace vesk::$package$ {

$declarations$

}  // namespace vesk::$package$
)code",
                {{"path", file.name()},
                 {"includes", emitIncludes(file)},
                 {"package", file.package()},
                 {"declarations", joined(blocks)}});
}

std::string emitSource(const FileDescriptor& file) {
  const std::vector<const Descriptor*> messages = messagesByUse(file);
  std::vector<std::string> blocks;
  for (const EnumDescriptor* enumeration : enumerationsOf(file))
    blocks.push_back(emitNameFunction(*enumeration));
  for (const Descriptor* message : messages) {
    for (const EnumDescriptor* enumeration : enumerationsOf(*message))
      blocks.push_back(emitNameFunction(*enumeration));
  }
  for (const Descriptor* message : messages) {
    for (const auto emit :
         {emitReader, emitWriter, emitDictionary, emitCopy, emitDeepCopy, emitMerge, emitEquality, emitHash}) {
      blocks.push_back(emit(*message));
    }
  }
  return expand(R"code(
// Generated from $path$; do not edit.
#include "$header$"

namespace vesk::$package$ {

$definitions$

}  // namespace vesk::$package$
)code",
                {{"path", file.name()},
                 {"header", headerPath(file)},
                 {"package", file.package()},
                 {"definitions", joined(blocks)}});
}

}  // namespace messagegen
