#include "terminal/panels/event_fields.h"

#include <algorithm>
#include <string_view>

#include "values/json_form.h"

namespace vesk {

namespace {

/// Takes the JSON value off the front of `rest`; what it ends before stays.
std::string takeJsonValue(std::string_view& rest) {
  int depth = 0;
  bool isInText = false;
  std::size_t end = 0;
  for (; end < rest.size(); ++end) {
    const char character = rest[end];
    if (isInText) {
      if (character == '\\') ++end;
      isInText = character != '"';
      continue;
    }
    if (depth == 0 && (character == ',' || character == ':' || character == '}')) break;
    isInText = character == '"';
    if (character == '{' || character == '[') ++depth;
    if (character == '}' || character == ']') --depth;
  }
  std::string_view value = rest.substr(0, end);
  rest.remove_prefix(std::min(end + 1, rest.size()));
  if (value.size() >= 2 && value.front() == '"') value = value.substr(1, value.size() - 2);
  return std::string(value);
}

}  // namespace

std::vector<std::pair<std::string, std::string>> fieldsOf(const insight::TimelineEvent& event) {
  std::string json;
  JsonWriter writer(json);
  writeJson(writer, event);
  writer.finish();
  std::vector<std::pair<std::string, std::string>> fields;
  std::string_view rest = std::string_view(json).substr(1);
  while (!rest.empty()) {
    std::string key = takeJsonValue(rest);
    fields.emplace_back(std::move(key), takeJsonValue(rest));
  }
  return fields;
}

}  // namespace vesk
