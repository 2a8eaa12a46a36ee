#include "emit.h"

namespace messagegen {

namespace {

Variables enumerationVariables(const EnumDescriptor& enumeration) {
  const Descriptor* owner = enumeration.containing_type();
  return {{"name", enumeration.name()}, {"type", (owner == nullptr ? "" : owner->name() + "::") + enumeration.name()}};
}

/// The snippet once for each value.
std::string forEachValue(const EnumDescriptor& enumeration, std::string_view snippet) {
  Variables variables = enumerationVariables(enumeration);
  std::string out;
  for (const EnumValueDescriptor* value : valuesOf(enumeration)) {
    variables["value"] = value->name();
    variables["number"] = std::to_string(value->number());
    out += expand(snippet, variables);
  }
  return out;
}

}  // namespace

std::string emitEnumeration(const EnumDescriptor& enumeration) {
  Variables variables = enumerationVariables(enumeration);
  variables["comment"] = emitComment(locationOf(enumeration));
  variables["values"] = forEachValue(enumeration, "$value$ = $number$,");
  return expand(R"code(
$comment$
enum class $name$ : std::int32_t {
  $values$
};
)code",
                variables);
}

std::string emitNameDeclaration(const EnumDescriptor& enumeration) {
  return expand(R"code(
/// The value's name, or "(unknown: 31)" with its number.
[[nodiscard]] Text nameOf($type$ value);
)code",
                enumerationVariables(enumeration));
}

std::string emitNameFunction(const EnumDescriptor& enumeration) {
  Variables variables = enumerationVariables(enumeration);
  variables["cases"] = forEachValue(enumeration, R"code(
case $type$::$value$:
  return "$value$"_text;
)code");
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
