#include "names.h"

#include <algorithm>
#include <cctype>
#include <set>

namespace messagegen {

namespace {

const std::set<std::string_view> kKeywords{
    "alignas",     "alignof",  "and",        "and_eq",    "asm",       "auto",         "bitand",
    "bitor",       "bool",     "break",      "case",      "catch",     "char",         "char16_t",
    "char32_t",    "char8_t",  "class",      "co_await",  "co_return", "co_yield",     "compl",
    "concept",     "const",    "const_cast", "consteval", "constexpr", "constinit",    "continue",
    "decltype",    "default",  "delete",     "do",        "double",    "dynamic_cast", "else",
    "enum",        "explicit", "export",     "extern",    "false",     "float",        "for",
    "friend",      "goto",     "if",         "inline",    "int",       "long",         "mutable",
    "namespace",   "new",      "noexcept",   "not",       "not_eq",    "nullptr",      "operator",
    "or",          "or_eq",    "private",    "protected", "public",    "register",     "reinterpret_cast",
    "requires",    "return",   "short",      "signed",    "sizeof",    "static",       "static_assert",
    "static_cast", "struct",   "switch",     "template",  "this",      "thread_local", "throw",
    "true",        "try",      "typedef",    "typeid",    "typename",  "union",        "unsigned",
    "using",       "virtual",  "void",       "volatile",  "wchar_t",   "while",        "xor",
    "xor_eq"};

char raised(char c) {
  return static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
}
char lowered(char c) {
  return static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
}

}  // namespace

bool isKeyword(std::string_view name) {
  return kKeywords.contains(name);
}

bool isIdentifier(std::string_view name) {
  const auto isDigit = [](char c) { return std::isdigit(static_cast<unsigned char>(c)) != 0; };
  const auto isPart = [](char c) { return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_'; };
  return !name.empty() && !isDigit(name.front()) && std::all_of(name.begin(), name.end(), isPart);
}

std::string capitalized(std::string_view name) {
  std::string result(name);
  if (!result.empty()) result.front() = raised(result.front());
  return result;
}

std::string elementOf(const Field& field) {
  std::string joined;
  std::string_view rest = field.name;
  while (!rest.empty()) {
    const std::string_view word = rest.substr(0, rest.find('_'));
    joined += capitalized(word);
    rest.remove_prefix(word.size() == rest.size() ? word.size() : word.size() + 1);
  }
  if (!joined.empty()) joined.front() = lowered(joined.front());
  return joined;
}

std::string propertyOf(const Field& field) {
  std::string property = elementOf(field);
  if (field.repeated && !property.ends_with('s')) property += 's';
  return property;
}

}  // namespace messagegen
