#pragma once

#include "field.h"

/// Each function writes one piece of the generated code: an operation of a class, or one kind of declaration. What it
/// is given has passed checkSupported().
namespace messagegen {

/// The code of the fields of a message in one operation, in the order of their numbers.
[[nodiscard]] std::string emitForEachField(const Descriptor& message, std::string_view FieldCode::*code);

[[nodiscard]] std::string emitComment(const SourceLocation& location);
[[nodiscard]] std::string emitEnumeration(const EnumDescriptor& enumeration);
[[nodiscard]] std::string emitNameDeclaration(const EnumDescriptor& enumeration);
[[nodiscard]] std::string emitNameFunction(const EnumDescriptor& enumeration);
/// Without the comment of the field.
[[nodiscard]] std::string emitAccessors(const FieldDescriptor& field);
[[nodiscard]] std::string emitClass(const Descriptor& message);

[[nodiscard]] std::string emitReader(const Descriptor& message);
[[nodiscard]] std::string emitWriter(const Descriptor& message);
[[nodiscard]] std::string emitDictionary(const Descriptor& message);
[[nodiscard]] std::string emitCopy(const Descriptor& message);
[[nodiscard]] std::string emitDeepCopy(const Descriptor& message);
[[nodiscard]] std::string emitMerge(const Descriptor& message);
[[nodiscard]] std::string emitEquality(const Descriptor& message);
[[nodiscard]] std::string emitHash(const Descriptor& message);

[[nodiscard]] std::string emitHeader(const FileDescriptor& file);
[[nodiscard]] std::string emitSource(const FileDescriptor& file);

}  // namespace messagegen
