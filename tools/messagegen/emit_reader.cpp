#include <iterator>

#include "emit.h"

namespace messagegen {

namespace {

std::string_view readStatement(const Field& field) {
  if (field.isMessageList()) {
    return R"code(
do {
  if (!readElement($member$, cursor)) return false;
} while (cursor.readKeyIf<$number$, $wire$>());
)code";
  }
  if (field.isMessage()) return "if (!readObject($member$, cursor)) return false;";
  if (field.isRepeatedScalar()) return "if (!readRepeated<&FieldCursor::$read$>($member$, cursor)) return false;";
  if (field.isObject()) return "$member$ = cursor.$read$();";
  return "assign($bit$, $member$, cursor.$read$());";
}

std::string_view wireType(const Field& field) {
  return field.isObject() || field.repeated ? "WireType::lengthDelimited" : "WireType::varint";
}

/// How a case goes on. Fields mostly come in the order of their numbers: the key of the next one is tried first.
std::string emitNext(const Field* next) {
  if (next == nullptr) return "break;";
  Variables variables = fieldVariables(*next);
  variables["wire"] = wireType(*next);
  return expand("if (!cursor.readKeyIf<$number$, $wire$>()) break;\n[[fallthrough]];", variables);
}

std::string emitCases(const std::vector<Field>& fields) {
  std::string cases;
  for (auto field = fields.begin(); field != fields.end(); ++field) {
    const auto next = std::next(field);
    Variables variables = fieldVariables(*field);
    variables["wire"] = wireType(*field);
    variables["statement"] = expand(readStatement(*field), variables);
    variables["next"] = emitNext(next == fields.end() ? nullptr : &*next);
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

std::string emitReader(const MessageType& message) {
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
                {{"class", message.name}, {"cases", emitCases(fieldsByNumber(message))}});
}

}  // namespace messagegen
