#pragma once

#include <string>
#include <vector>

#include "schema.h"
#include "snippet.h"

/// Each function writes one piece of the generated code: an operation of a class, or one kind of declaration.
namespace messagegen {

/// What the snippets need to know of a field: its names, types, and the operations that read and write it.
[[nodiscard]] Variables fieldVariables(const Field& field);

/// The fields in the order of their numbers, in which every operation takes them.
[[nodiscard]] std::vector<Field> fieldsByNumber(const MessageType& message);

[[nodiscard]] std::string emitComment(const Comment& comment);
[[nodiscard]] std::string emitEnumeration(const Enumeration& enumeration);
[[nodiscard]] std::string emitNameDeclaration(const Enumeration& enumeration);
[[nodiscard]] std::string emitNameFunction(const Enumeration& enumeration);
[[nodiscard]] std::string emitAccessors(const Field& field);
[[nodiscard]] std::string emitClass(const MessageType& message);

[[nodiscard]] std::string emitReader(const MessageType& message);
[[nodiscard]] std::string emitWriter(const MessageType& message);
[[nodiscard]] std::string emitDictionary(const MessageType& message);
[[nodiscard]] std::string emitCopy(const MessageType& message);
[[nodiscard]] std::string emitDeepCopy(const MessageType& message);
[[nodiscard]] std::string emitMerge(const MessageType& message);
[[nodiscard]] std::string emitEquality(const MessageType& message);
[[nodiscard]] std::string emitHash(const MessageType& message);

[[nodiscard]] std::string emitHeader(const ProtoFile& file);
[[nodiscard]] std::string emitSource(const ProtoFile& file);

}  // namespace messagegen
