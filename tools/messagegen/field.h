#pragma once

#include "schema.h"
#include "snippet.h"

namespace messagegen {

/// How a field is held, on which its code depends.
enum class FieldKind {
  /// A number, a boolean or an enumeration: its presence is a bit of its own.
  scalar,
  /// Text or bytes.
  string,
  message,
  repeatedScalar,
  messageList,
};

[[nodiscard]] FieldKind kindOf(const FieldDescriptor& field);

/// What each operation of a class does with a field: snippets to be filled in with fieldVariables().
struct FieldCode {
  std::string_view accessors;
  std::string_view read;
  std::string_view write;
  /// Gives it to a dictionary or to JSON.
  std::string_view give;
  std::string_view copy;
  /// What is shared after a plain copy is copied; empty where nothing is.
  std::string_view deepCopy;
  std::string_view merge;
  std::string_view compare;
  std::string_view hash;
};

[[nodiscard]] const FieldCode& codeOf(FieldKind kind);

/// The names of a field, its types, and the operations that read and write it.
[[nodiscard]] Variables fieldVariables(const FieldDescriptor& field);

[[nodiscard]] bool isSupportedType(FieldDescriptor::Type type);
[[nodiscard]] bool canBeRepeated(FieldDescriptor::Type type);

}  // namespace messagegen
