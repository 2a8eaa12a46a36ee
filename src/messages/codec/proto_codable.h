#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "messages/codec/proto_reader.h"
#include "messages/codec/proto_writer.h"
#include "values/json_form.h"
#include "values/value.h"

namespace vesk {

/// A message of the metric stream. Every class has, besides these, the operations that take or make its own
/// kind: initWithData, copyTo, copyWithZone, mergeFrom and the accessors of its fields. A message is not
/// locked: it belongs to one thread at a time.
class ProtoCodable {
 public:
  virtual ~ProtoCodable() = default;

  [[nodiscard]] virtual std::string_view className() const = 0;

  /// Reads fields up to the reader's end and adds them to this message. False when the bytes are no encoding
  /// of a message; the fields read before the fault keep their values.
  [[nodiscard]] virtual bool readFrom(ProtoReader& reader) = 0;
  /// Writes the fields that are present, in the order of their numbers.
  virtual void writeTo(ProtoWriter& writer) const = 0;

  /// The fields that are present under their names, in the order of their numbers; a repeated scalar always.
  [[nodiscard]] virtual Dictionary dictionaryRepresentation() const = 0;
  /// The same as JSON, without the dictionary.
  virtual void writeJson(JsonWriter& json) const = 0;
  void appendJson(std::string& out) const;
  /// The class and the dictionary form, for logs.
  [[nodiscard]] std::string description() const;

  /// Whether `other` is of the same class, with the same fields present and equal.
  [[nodiscard]] virtual bool isEqual(const ProtoCodable& other) const = 0;
  /// Equal messages have equal hashes.
  [[nodiscard]] virtual std::uint64_t hash() const = 0;

 protected:
  ProtoCodable() = default;
  ProtoCodable(const ProtoCodable&) = default;
  ProtoCodable& operator=(const ProtoCodable&) = default;
};

}  // namespace vesk
