#include <algorithm>
#include <iterator>

#include "emit.h"

namespace messagegen {

namespace {

/// A member function whose `$statements$` are the code of each field.
std::string emitOperation(const Descriptor& message, std::string_view FieldCode::*code, std::string_view snippet) {
  return expand(snippet, {{"class", message.name()}, {"statements", emitForEachField(message, code)}});
}

std::string emitCases(const Descriptor& message) {
  const std::vector<const FieldDescriptor*> fields = fieldsByNumber(message);
  std::string cases;
  for (auto field = fields.begin(); field != fields.end(); ++field) {
    Variables variables = fieldVariables(**field);
    variables["statement"] = expand(codeOf(kindOf(**field)).read, variables);
    const auto next = std::next(field);
    // Fields mostly come in the order of their numbers: the key of the next one is tried first.
    variables["next"] =
        next == fields.end()
            ? "break;"
            : expand("if (!cursor.readKeyIf<$number$, $wire$>()) break;\n[[fallthrough]];", fieldVariables(**next));
    cases += expand(R"code(
case $number$:
  $statement$
  $next$
)code",
                    variables);
  }
  return cases;
}

}  // namespace

std::string emitForEachField(const Descriptor& message, std::string_view FieldCode::*code) {
  std::string out;
  for (const FieldDescriptor* field : fieldsByNumber(message))
    out += expandToFit(codeOf(kindOf(*field)).*code, fieldVariables(*field));
  return out;
}

std::string emitReader(const Descriptor& message) {
  return expand(R"code(
bool $class$::readFrom(ProtoReader& reader) {
  FieldCursor cursor(reader);
  while (cursor.readKey()) {
    switch (cursor.fieldNumber()) {
      $cases$
      default:
        if (!readUndeclaredField(kClassName, cursor)) return false;
    }
  }
  return cursor.finish();
}
)code",
                {{"class", message.name()}, {"cases", emitCases(message)}});
}

std::string emitWriter(const Descriptor& message) {
  return emitOperation(message, &FieldCode::write, R"code(
void $class$::writeTo(ProtoWriter& writer) const {
  $statements$
}
)code");
}

std::string emitDictionary(const Descriptor& message) {
  const std::vector<const FieldDescriptor*> fields = fieldsOf(message);
  const auto others = std::count_if(fields.begin(), fields.end(),
                                    [](const FieldDescriptor* field) { return kindOf(*field) != FieldKind::scalar; });
  return expand(R"code(
template <class Fields>
void $class$::giveTo(Fields& fields) const {
  $statements$
}

Dictionary $class$::dictionaryRepresentation() const {
  DictionaryFields fields(presentScalars()$others$);
  giveTo(fields);
  return fields.take();
}

void $class$::writeJson(JsonWriter& json) const {
  JsonFields fields(json);
  giveTo(fields);
  fields.end();
}
)code",
                {{"class", message.name()},
                 {"others", others == 0 ? "" : " + " + std::to_string(others)},
                 {"statements", emitForEachField(message, &FieldCode::give)}});
}

std::string emitCopy(const Descriptor& message) {
  return emitOperation(message, &FieldCode::copy, R"code(
void $class$::copyTo(Self& other) const {
  $statements$
}
)code");
}

std::string emitDeepCopy(const Descriptor& message) {
  if (emitForEachField(message, &FieldCode::deepCopy).empty()) {
    return expand(R"code(
std::shared_ptr<$class$> $class$::copyWithZone() const {
  return makeMessage<$class$>(*this);
}
)code",
                  {{"class", message.name()}});
  }
  return emitOperation(message, &FieldCode::deepCopy, R"code(
std::shared_ptr<$class$> $class$::copyWithZone() const {
  auto copy = makeMessage<$class$>(*this);
  $statements$
  return copy;
}
)code");
}

std::string emitMerge(const Descriptor& message) {
  return emitOperation(message, &FieldCode::merge, R"code(
void $class$::mergeFrom(const Self& other) {
  $statements$
}
)code");
}

std::string emitEquality(const Descriptor& message) {
  return emitOperation(message, &FieldCode::compare, R"code(
bool $class$::hasEqualFields(const Self& other) const {
  $statements$
  return true;
}
)code");
}

std::string emitHash(const Descriptor& message) {
  return emitOperation(message, &FieldCode::hash, R"code(
std::uint64_t $class$::hash() const {
  std::uint64_t result = 0;
  $statements$
  return result;
}
)code");
}

}  // namespace messagegen
