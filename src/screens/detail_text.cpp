#include "screens/detail_text.h"

#include <algorithm>
#include <string>

#include "values/text_form.h"
#include "values/utf8.h"

namespace vesk {

namespace {

bool hasLines(const Value& value) {
  if (const Dictionary* dictionary = value.dictionary()) return !dictionary->empty();
  const Array* array = value.array();
  return array != nullptr && std::any_of(array->begin(), array->end(), hasLines);
}

/// Appends the lines of a value; all but the first are indented by `indentation`.
void appendLines(std::string& out, const Value& value, std::size_t indentation) {
  if (!hasLines(value)) {
    appendText(out, value);
    return;
  }
  std::string lineBreak;
  const auto startLine = [&] {
    out += lineBreak;
    lineBreak = "\n" + std::string(indentation, ' ');
  };
  if (const Array* array = value.array()) {
    for (const Value& element : *array) {
      startLine();
      out += "- ";
      appendLines(out, element, indentation + 2);
    }
    return;
  }
  for (const auto& [key, entry] : *value.dictionary()) {
    startLine();
    appendUtf8(out, key.view());
    out += ':';
    out += hasLines(entry) ? "\n" + std::string(indentation + 2, ' ') : " ";
    appendLines(out, entry, indentation + 2);
  }
}

}  // namespace

Text detailTextOf(const Value& value) {
  if (const Text* text = value.text()) return *text;
  std::string out;
  appendLines(out, value, 0);
  return Text::copy(out);
}

}  // namespace vesk
