#include "emit.h"

namespace messagegen {

namespace {

Variables enumerationVariables(const Enumeration& enumeration) {
  const std::string scope = enumeration.owner.empty() ? "" : enumeration.owner + "::";
  return {{"name", enumeration.name}, {"type", scope + enumeration.name}};
}

}  // namespace

std::string emitEnumeration(const Enumeration& enumeration) {
  Variables variables = enumerationVariables(enumeration);
  std::string& values = variables["values"];
  for (const Enumerator& value : enumeration.values) {
    values += value.name + " = " + std::to_string(value.number) + ",\n";
  }
  return emitComment(enumeration.comment) + expand(R"code(
enum class $name$ : std::int32_t {
  $values$
};
)code",
                                                   variables);
}

std::string emitNameDeclaration(const Enumeration& enumeration) {
  return expand(R"code(
/// The value's name, or "(unknown: 31)" with its number.
[[nodiscard]] Text nameOf($type$ value);
)code",
                enumerationVariables(enumeration));
}

std::string emitNameFunction(const Enumeration& enumeration) {
  Variables variables = enumerationVariables(enumeration);
  std::string cases;
  for (const Enumerator& value : enumeration.values) {
    variables["value"] = value.name;
    cases += expand(R"code(
case $type$::$value$:
  return "$value$"_text;
)code",
                    variables);
  }
  variables["cases"] = cases;
  return expand(R"code(
Text nameOf($type$ value) {
  switch (value) {
    $cases$
  }
  return unknownName(static_cast<std::int32_t>(value));
}
)code",
                variables);
}

}  // namespace messagegen
