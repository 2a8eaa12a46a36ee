#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "diagnostic.h"

/// What the .proto files say, with every type name resolved.
namespace messagegen {

using Comment = std::vector<std::string>;

struct Enumerator {
  std::string name;
  std::int32_t number;
};

struct Enumeration {
  Comment comment;
  std::string name;
  /// The message it is nested in; empty at file level.
  std::string owner;
  std::vector<Enumerator> values;
};

/// How a field is laid out on the wire and held in the class.
enum class FieldType { uint32, int32, sint32, uint64, boolean, enumeration, string, bytes, message };

struct Field {
  Comment comment;
  std::string name;
  Position position;
  bool repeated;
  FieldType type = FieldType::uint32;
  /// As written: a scalar's name, or that of an enumeration or message.
  std::string typeName;
  Position typePosition;
  /// The first value of an enumeration, which is its default.
  std::string defaultName;
  std::uint32_t number;

  [[nodiscard]] bool isMessage() const { return type == FieldType::message; }
  [[nodiscard]] bool isObject() const { return isMessage() || type == FieldType::string || type == FieldType::bytes; }
  [[nodiscard]] bool isMessageList() const { return repeated && isMessage(); }
  [[nodiscard]] bool isRepeatedScalar() const { return repeated && !isMessage(); }
  /// A scalar with a presence bit.
  [[nodiscard]] bool isOptionalScalar() const { return !repeated && !isObject(); }
};

struct MessageType {
  Comment comment;
  std::string name;
  std::vector<Enumeration> enumerations;
  /// In the order in which they are declared.
  std::vector<Field> fields;
};

struct Import {
  /// Relative to the schema's root.
  std::string path;
  Position position;
};

struct ProtoFile {
  /// Relative to the schema's root, as imports name it.
  std::string path;
  std::string package;
  std::vector<Import> imports;
  std::vector<Enumeration> enumerations;
  /// Each after the messages that it contains.
  std::vector<MessageType> messages;
};

}  // namespace messagegen
