#include "names.h"

#include <cctype>

namespace messagegen {

namespace {

char raised(char c) {
  return static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
}
char lowered(char c) {
  return static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
}

}  // namespace

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
