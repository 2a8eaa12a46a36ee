#include "emit.h"

namespace messagegen {

namespace {

/// One accessor: what stands before its body, and the body.
struct Accessor {
  std::string_view head;
  std::string_view statement;
};

std::string emitAll(std::initializer_list<Accessor> accessors, const Variables& variables) {
  std::string out;
  for (const auto& [head, statement] : accessors) {
    out += inlineFunction(expandLine(head, variables), expandLine(statement, variables));
  }
  return out;
}

std::string emitScalarAccessors(const Field& field, const Variables& variables) {
  const Accessor getter =
      field.type == FieldType::enumeration
          ? Accessor{"[[nodiscard]] $value$ $property$() const", "return has($bit$) ? $member$ : $value$::$default$;"}
          : Accessor{"[[nodiscard]] $value$ $property$() const", "return $member$;"};
  return emitAll({getter,
                  {"void set$Property$($value$ value)", "assign($bit$, $member$, value);"},
                  {"[[nodiscard]] bool has$Property$() const", "return has($bit$);"},
                  {"void setHas$Property$(bool present)", "setPresence($bit$, present);"}},
                 variables);
}

std::string emitObjectAccessors(const Variables& variables) {
  return emitAll({{"[[nodiscard]] const $held$& $property$() const", "return $member$;"},
                  {"void set$Property$($held$ value)", "$member$ = std::move(value);"},
                  {"[[nodiscard]] bool has$Property$() const", "return static_cast<bool>($member$);"}},
                 variables);
}

std::string emitListAccessors(const Variables& variables) {
  return emitAll(
      {{"[[nodiscard]] const $held$& $property$() const", "return $member$;"},
       {"void set$Property$($held$ list)", "$member$ = std::move(list);"},
       {"void clear$Property$()", "clearElements($member$);"},
       {"void add$Element$($value$ element)", "addElement($member$, std::move(element));"},
       {"[[nodiscard]] std::size_t $property$Count() const", "return countOf($member$);"},
       {"[[nodiscard]] const auto& $element$AtIndex(std::size_t index) const", "return elementAt($member$, index);"}},
      variables);
}

std::string emitRepeatedAccessors(const Variables& variables) {
  return emitAll({{"[[nodiscard]] const $value$* $property$() const", "return $member$.values();"},
                  {"[[nodiscard]] std::size_t $property$Count() const", "return $member$.count();"},
                  {"void clear$Property$()", "$member$.clear();"},
                  {"void add$Element$($value$ value)", "$member$.add(value);"},
                  {"[[nodiscard]] $value$ $element$AtIndex(std::size_t index) const", "return $member$.at(index);"},
                  {"void set$Property$(const $value$* values, std::size_t count)", "$member$.set(values, count);"}},
                 variables);
}

}  // namespace

std::string emitAccessors(const Field& field) {
  const Variables variables = fieldVariables(field);
  const std::string comment = emitComment(field.comment);
  if (field.isMessageList()) return comment + emitListAccessors(variables);
  if (field.isRepeatedScalar()) return comment + emitRepeatedAccessors(variables);
  if (field.isObject()) return comment + emitObjectAccessors(variables);
  return comment + emitScalarAccessors(field, variables);
}

}  // namespace messagegen
