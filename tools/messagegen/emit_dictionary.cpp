#include <algorithm>

#include "emit.h"

namespace messagegen {

namespace {

std::string presenceTest(const Field& field) {
  if (field.isMessageList()) return "countOf($member$) != 0";
  return field.isObject() ? "$member$" : "has($bit$)";
}

std::string dictionaryValue(const Field& field) {
  if (field.isMessageList()) return "arrayOf($member$)";
  if (field.isRepeatedScalar()) return "$member$.toArray()";
  if (field.isMessage()) return "$member$->dictionaryRepresentation()";
  if (field.isObject()) return "*$member$";
  return field.type == FieldType::enumeration ? "nameOf($member$)" : "$member$";
}

std::string appendStatement(const Field& field) {
  const Variables variables = fieldVariables(field);
  const std::string append =
      expandLine("dictionary.append(\"$key$\"_text, " + dictionaryValue(field) + ");", variables);
  if (field.isRepeatedScalar()) return append + "\n";
  return conditional(expandLine(presenceTest(field), variables), append);
}

}  // namespace

std::string emitDictionary(const MessageType& message) {
  std::string statements;
  for (const Field& field : fieldsByNumber(message))
    statements += appendStatement(field);
  const auto others = std::count_if(message.fields.begin(), message.fields.end(),
                                    [](const Field& field) { return !field.isOptionalScalar(); });
  return expand(R"code(
Dictionary $class$::dictionaryRepresentation() const {
  Dictionary dictionary;
  dictionary.reserve(presentScalars()$others$);
  $statements$
  return dictionary;
}
)code",
                {{"class", message.name},
                 {"others", others == 0 ? "" : " + " + std::to_string(others)},
                 {"statements", statements}});
}

}  // namespace messagegen
