#include "emit.h"

namespace messagegen {

namespace {

std::string sameness(const Field& field) {
  if (field.isMessageList()) return "isSameList($member$, other.$member$)";
  if (field.isRepeatedScalar()) return "$member$.isEqual(other.$member$)";
  if (field.isMessage()) return "isSameObject($member$, other.$member$)";
  if (field.isObject()) return "$member$ == other.$member$";
  return "isSameScalar(other, $bit$, &Self::$member$)";
}

std::string hashTerm(const Field& field) {
  if (field.isRepeatedScalar()) return "$member$.hash()";
  return field.isOptionalScalar() ? "scalarHash($bit$, $member$)" : "objectHash($member$)";
}

}  // namespace

std::string emitEquality(const MessageType& message) {
  std::string tests;
  for (const Field& field : fieldsByNumber(message)) {
    const std::string test = expandLine(sameness(field), fieldVariables(field));
    const bool isComparison = field.isObject() && !field.isMessage();
    tests += conditional(isComparison ? "!(" + test + ")" : "!" + test, "return false;");
  }
  return expand(R"code(
bool $class$::hasEqualFields(const Self& other) const {
  $tests$
  return true;
}
)code",
                {{"class", message.name}, {"tests", tests}});
}

std::string emitHash(const MessageType& message) {
  std::string terms;
  for (const Field& field : fieldsByNumber(message)) {
    terms += expand("result ^= " + hashTerm(field) + ";", fieldVariables(field));
  }
  return expand(R"code(
std::uint64_t $class$::hash() const {
  std::uint64_t result = 0;
  $terms$
  return result;
}
)code",
                {{"class", message.name}, {"terms", terms}});
}

}  // namespace messagegen
