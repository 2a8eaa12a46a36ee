#include <algorithm>

#include "emit.h"

namespace messagegen {

namespace {

std::string presenceTest(const Field& field) {
  if (field.isMessageList()) return "countOf($member$) != 0";
  return field.isObject() ? "$member$" : "has($bit$)";
}

std::string shownValue(const Field& field) {
  if (field.isRepeatedScalar() || field.isMessage() || field.isMessageList()) return "$member$";
  if (field.isObject()) return "*$member$";
  return field.type == FieldType::enumeration ? "nameOf($member$)" : "$member$";
}

std::string appendStatement(const Field& field) {
  const Variables variables = fieldVariables(field);
  const std::string append = expandLine("fields.append(\"$key$\"_text, " + shownValue(field) + ");", variables);
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
                {{"class", message.name},
                 {"others", others == 0 ? "" : " + " + std::to_string(others)},
                 {"statements", statements}});
}

}  // namespace messagegen
