#include "emit.h"

namespace messagegen {

namespace {

std::string emitPresenceBits(const Descriptor& message) {
  std::string bits;
  for (const FieldDescriptor* field : fieldsByNumber(message)) {
    if (kindOf(*field) == FieldKind::scalar) bits += expand("$bit$,", fieldVariables(*field));
  }
  if (bits.empty()) return "";
  return expand(R"code(
/// Which bit of the presence word is whose.
enum PresenceBit : unsigned {
  $bits$
};
)code",
                {{"bits", bits}}) +
         "\n";
}

/// The smallest unsigned type with a bit for each optional scalar.
std::string presenceWord(const Descriptor& message) {
  int bits = 0;
  for (const FieldDescriptor* field : fieldsOf(message))
    bits += kindOf(*field) == FieldKind::scalar ? 1 : 0;
  for (const int width : {8, 16, 32}) {
    if (bits <= width) return "std::uint" + std::to_string(width) + "_t";
  }
  return "std::uint64_t";
}

std::string classHead(const Descriptor& message) {
  const std::string name = "class " + message.name() + " final";
  const std::string base = ": public Message<" + message.name() + ", " + presenceWord(message) + "> {";
  const bool fits = name.size() + 1 + base.size() <= kLineWidth;
  return name + (fits ? " " : "\n    ") + base;
}

}  // namespace

std::string emitComment(const SourceLocation& location) {
  std::string out;
  for (const std::string& line : commentLines(location))
    out += line.empty() ? "///\n" : "/// " + line + "\n";
  return out;
}

std::string emitAccessors(const FieldDescriptor& field) {
  return expandToFit(codeOf(kindOf(field)).accessors, fieldVariables(field));
}

std::string emitClass(const Descriptor& message) {
  std::string enumerations;
  for (const EnumDescriptor* enumeration : enumerationsOf(message))
    enumerations += emitEnumeration(*enumeration) + "\n";
  std::string accessors;
  std::string members;
  for (const FieldDescriptor* field : fieldsOf(message)) {
    accessors += emitComment(locationOf(*field)) + emitAccessors(*field) + "\n";
    members += expand("$held$ $member$$initial$;", fieldVariables(*field));
  }
  return expand(R"code(
$comment$
$head$
 public:
  $enumerations$
  static constexpr std::string_view kClassName = "$class$";

  $accessors$
  [[nodiscard]] bool readFrom(ProtoReader& reader) override;
  void writeTo(ProtoWriter& writer) const override;
  [[nodiscard]] Dictionary dictionaryRepresentation() const override;
  void writeJson(JsonWriter& json) const override;

  /// Sets in `other` what is present here; objects are shared, not copied.
  void copyTo(Self& other) const;
  /// A message that shares nothing with this one.
  [[nodiscard]] std::shared_ptr<$class$> copyWithZone() const;
  /// Takes over what is present in `other`: lists grow by its elements, single messages merge.
  void mergeFrom(const Self& other);

  [[nodiscard]] bool hasEqualFields(const Self& other) const;
  [[nodiscard]] std::uint64_t hash() const override;

 private:
  /// Gives the fields that are present to `fields`, with their names.
  template <class Fields>
  void giveTo(Fields& fields) const;

  $bits$
  $members$
};
)code",
                {{"comment", emitComment(locationOf(message))},
                 {"class", message.name()},
                 {"head", classHead(message)},
                 {"enumerations", enumerations},
                 {"accessors", accessors},
                 {"bits", emitPresenceBits(message)},
                 {"members", members}});
}

}  // namespace messagegen
