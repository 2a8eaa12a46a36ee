#include "emit.h"

namespace messagegen {

namespace {

std::string copyStatement(const Field& field) {
  if (field.isMessageList()) return "copyElements($member$, other.$member$);";
  if (field.isRepeatedScalar()) return "copyValues($member$, other.$member$);";
  if (field.isObject()) return "if ($member$) other.$member$ = $member$;";
  return "copyScalar(other, $bit$, &Self::$member$);";
}

std::string mergeStatement(const Field& field) {
  if (field.isMessageList()) return "mergeElements(other.$member$, $member$);";
  if (field.isRepeatedScalar()) return "$member$.append(other.$member$);";
  if (field.isMessage()) return "mergeObject(other.$member$, $member$);";
  if (field.isObject()) return "if (other.$member$) $member$ = other.$member$;";
  return "other.copyScalar(*this, $bit$, &Self::$member$);";
}

std::string statementsOf(const MessageType& message, std::string (*statement)(const Field&)) {
  std::string out;
  for (const Field& field : fieldsByNumber(message))
    out += expand(statement(field), fieldVariables(field));
  return out;
}

}  // namespace

std::string emitCopy(const MessageType& message) {
  return expand(R"code(
void $class$::copyTo(Self& other) const {
  $statements$
}
)code",
                {{"class", message.name}, {"statements", statementsOf(message, copyStatement)}});
}

std::string emitDeepCopy(const MessageType& message) {
  std::string statements;
  for (const Field& field : fieldsByNumber(message)) {
    if (field.isMessage()) statements += expand("copy->$member$ = deepCopy($member$);", fieldVariables(field));
  }
  const Variables variables{{"class", message.name}, {"statements", statements}};
  if (statements.empty()) {
    return expand(R"code(
std::shared_ptr<$class$> $class$::copyWithZone() const {
  return makeMessage<$class$>(*this);
}
)code",
                  variables);
  }
  return expand(R"code(
std::shared_ptr<$class$> $class$::copyWithZone() const {
  auto copy = makeMessage<$class$>(*this);
  $statements$
  return copy;
}
)code",
                variables);
}

std::string emitMerge(const MessageType& message) {
  return expand(R"code(
void $class$::mergeFrom(const Self& other) {
  $statements$
}
)code",
                {{"class", message.name}, {"statements", statementsOf(message, mergeStatement)}});
}

}  // namespace messagegen
