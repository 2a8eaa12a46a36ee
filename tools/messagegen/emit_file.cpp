#include <algorithm>

#include "emit.h"

namespace messagegen {

namespace {

std::string headerPath(const std::string& protoPath) {
  return "messages/" + protoPath.substr(0, protoPath.rfind('.')) + ".h";
}

/// Enumerations of the file itself and of its messages, in the order of declaration.
std::vector<Enumeration> allEnumerations(const ProtoFile& file) {
  std::vector<Enumeration> all = file.enumerations;
  for (const MessageType& message : file.messages) {
    all.insert(all.end(), message.enumerations.begin(), message.enumerations.end());
  }
  return all;
}

std::string emitIncludes(const ProtoFile& file) {
  std::vector<std::string> paths{"messages/codec/message.h"};
  for (const Import& import : file.imports)
    paths.push_back(headerPath(import.path));
  std::sort(paths.begin(), paths.end());
  std::string out;
  for (const std::string& path : paths)
    out += "#include \"" + path + "\"\n";
  return out;
}

std::string joined(const std::vector<std::string>& blocks) {
  std::string out;
  for (const std::string& block : blocks)
    out += (out.empty() ? "" : "\n") + block;
  return out;
}

}  // namespace

std::string emitHeader(const ProtoFile& file) {
  std::vector<std::string> blocks;
  for (const Enumeration& enumeration : file.enumerations) {
    blocks.push_back(emitEnumeration(enumeration));
    blocks.push_back(emitNameDeclaration(enumeration));
  }
  for (const MessageType& message : file.messages) {
    blocks.push_back(emitClass(message));
    for (const Enumeration& enumeration : message.enumerations)
      blocks.push_back(emitNameDeclaration(enumeration));
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
                {{"path", file.path},
                 {"includes", emitIncludes(file)},
                 {"package", file.package},
                 {"declarations", joined(blocks)}});
}

std::string emitSource(const ProtoFile& file) {
  std::vector<std::string> blocks;
  for (const Enumeration& enumeration : allEnumerations(file))
    blocks.push_back(emitNameFunction(enumeration));
  for (const MessageType& message : file.messages) {
    for (const auto emit :
         {emitReader, emitWriter, emitDictionary, emitCopy, emitDeepCopy, emitMerge, emitEquality, emitHash}) {
      blocks.push_back(emit(message));
    }
  }
  return expand(R"code(
// Generated from $path$; do not edit.
#include "$header$"

namespace vesk::$package$ {

$definitions$

}  // namespace vesk::$package$
)code",
                {{"path", file.path},
                 {"header", headerPath(file.path)},
                 {"package", file.package},
                 {"definitions", joined(blocks)}});
}

}  // namespace messagegen
