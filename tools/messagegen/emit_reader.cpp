#include "emit.h"

namespace messagegen {

namespace {

std::string_view readStatements(const Field& field) {
  if (field.isMessageList()) return "return readElement($member$, reader);";
  if (field.isMessage()) return "return readObject($member$, reader);";
  if (field.isRepeatedScalar()) {
    return "return readRepeated<&ProtoReader::$read$>($member$, key.wireType, reader);";
  }
  if (field.isObject()) return "$member$ = reader.$read$();\nreturn true;";
  return "assign($bit$, $member$, reader.$read$());\nreturn true;";
}

}  // namespace

std::string emitReader(const MessageType& message) {
  std::string cases;
  for (const Field& field : fieldsByNumber(message)) {
    Variables variables = fieldVariables(field);
    variables["statements"] = expand(readStatements(field), variables);
    cases += expand(R"code(
case $number$:
  $statements$
)code",
                    variables);
  }
  return expand(R"code(
bool $class$::readFrom(ProtoReader& reader) {
  return readFields(reader, [&](FieldKey key) {
    switch (key.number) {
      $cases$
      default:
        return readUndeclaredField(key, kClassName, reader);
    }
  });
}
)code",
                {{"class", message.name}, {"cases", cases}});
}

}  // namespace messagegen
