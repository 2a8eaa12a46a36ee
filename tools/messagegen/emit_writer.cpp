#include "emit.h"

namespace messagegen {

namespace {

std::string writeStatement(const Field& field) {
  const Variables variables = fieldVariables(field);
  if (field.isMessageList()) return expand("writeElements($member$, $number$, writer);", variables);
  if (field.isRepeatedScalar()) {
    return expand("writePacked<&ProtoWriter::$write$>($member$, $number$, writer);", variables);
  }
  if (field.isMessage()) return expand("if ($member$) writer.writeMessage(*$member$, $number$);", variables);
  if (field.isObject()) return expand("if ($member$) writer.$write$(*$member$, $number$);", variables);
  return expand("if (has($bit$)) writer.$write$($member$, $number$);", variables);
}

}  // namespace

std::string emitWriter(const MessageType& message) {
  std::string statements;
  for (const Field& field : fieldsByNumber(message))
    statements += writeStatement(field);
  return expand(R"code(
void $class$::writeTo(ProtoWriter& writer) const {
  $statements$
}
)code",
                {{"class", message.name}, {"statements", statements}});
}

}  // namespace messagegen
