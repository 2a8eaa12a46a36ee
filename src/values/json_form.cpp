#include "values/json_form.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <variant>

#include "values/text_form.h"
#include "values/utf8.h"

namespace vesk {

namespace {

constexpr std::string_view kHexDigits = "0123456789abcdef";

/// Which bytes stand in JSON text as they are: printable ASCII without the quote and the backslash. A table, for every
/// byte of every key and name is asked.
constexpr std::array<bool, 256> kIsPlain = [] {
  std::array<bool, 256> table{};
  for (std::size_t byte = 0x20; byte < 0x7F; ++byte)
    table[byte] = byte != '"' && byte != '\\';
  return table;
}();

}  // namespace

void JsonWriter::write(float number) {
  // JSON has no other numbers.
  if (std::isfinite(number)) {
    flush();
    appendDecimal(out_, number);
  } else {
    writeNull();
  }
}

void JsonWriter::write(const Data& data) {
  put("\"0x");
  for (const std::uint8_t byte : data.bytes()) {
    put(kHexDigits[byte >> 4]);
    put(kHexDigits[byte & 0x0F]);
  }
  put('"');
}

void JsonWriter::write(const Array& array) {
  writeJsonArray(*this, array, [this](const Value& value) { write(value); });
}

void JsonWriter::write(const Dictionary& dictionary) {
  JsonObject object(*this);
  for (const auto& [key, value] : dictionary) {
    object.key(key.view());
    write(value);
  }
  object.end();
}

void JsonWriter::write(const Value& value) {
  std::visit([this](const auto& held) { write(held); }, value.held());
}

void JsonWriter::write(std::string_view text) {
  put('"');
  for (text.remove_prefix(putPlain(text)); !text.empty(); text.remove_prefix(putPlain(text))) {
    const std::size_t size = std::max<std::size_t>(1, utf8CharacterSize(text));
    putEscaped(text.substr(0, size));
    text.remove_prefix(size);
  }
  put('"');
}

std::size_t JsonWriter::putPlain(std::string_view text) {
  std::size_t count = 0;
  for (;;) {
    const std::size_t end = std::min(text.size(), count + gathered_.size() - size_);
    char* place = gathered_.data() + size_;
    const std::size_t start = count;
    while (count < end && kIsPlain[static_cast<unsigned char>(text[count])])
      *place++ = text[count++];
    size_ += count - start;
    if (count < end || end == text.size()) return count;
    flush();
  }
}

void JsonWriter::putEscaped(std::string_view character) {
  const char32_t codePoint = utf8CharacterSize(character) == 0 ? U'\uFFFD' : codePointOf(character);
  if (codePoint < 0x80) {
    putEscaped(character[0]);
  } else if (isControl(codePoint)) {
    putCodeUnit(codePoint);
  } else {
    flush();
    appendUtf8(out_, character);
  }
}

void JsonWriter::putEscaped(char character) {
  switch (character) {
    case '"':
    case '\\':
      put('\\');
      put(character);
      return;
    case '\n':
      put("\\n");
      return;
    case '\t':
      put("\\t");
      return;
    default:
      putCodeUnit(static_cast<unsigned char>(character));
  }
}

void JsonWriter::putCodeUnit(unsigned unit) {
  put("\\u");
  for (const unsigned shift : {12U, 8U, 4U, 0U})
    put(kHexDigits[unit >> shift & 0x0F]);
}

}  // namespace vesk
