#include "app/json_form.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "platform/text_form.h"
#include "platform/utf8.h"

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

std::size_t plainPrefix(std::string_view text) {
  std::size_t size = 0;
  while (size < text.size() && kIsPlain[static_cast<unsigned char>(text[size])])
    ++size;
  return size;
}

void appendCodeUnit(std::string& out, unsigned unit) {
  out += "\\u";
  for (const unsigned shift : {12U, 8U, 4U, 0U})
    out += kHexDigits[unit >> shift & 0x0F];
}

void appendEscaped(std::string& out, char c) {
  switch (c) {
    case '"':
    case '\\':
      out += '\\';
      out += c;
      return;
    case '\n':
      out += "\\n";
      return;
    case '\t':
      out += "\\t";
      return;
    default:
      appendCodeUnit(out, static_cast<unsigned char>(c));
  }
}

/// The control characters U+0080 to U+009F: C2, then a byte below A0.
bool isLateControl(std::string_view character) {
  return character.size() == 2 && character[0] == '\xC2' && static_cast<unsigned char>(character[1]) < 0xA0;
}

struct JsonForm {
  std::string& out;

  void operator()(bool value) const { out += value ? "true" : "false"; }
  void operator()(std::int64_t number) const { appendDecimal(out, number); }
  void operator()(std::uint64_t number) const { appendDecimal(out, number); }
  void operator()(float number) const {
    // JSON has no other numbers.
    if (std::isfinite(number)) {
      appendDecimal(out, number);
    } else {
      out += "null";
    }
  }
  void operator()(const Text& text) const { appendJson(out, text.view()); }
  void operator()(const Data& data) const {
    out += "\"0x";
    appendHex(out, data.bytes());
    out += '"';
  }
  void operator()(const Array& array) const { appendJson(out, array); }
  void operator()(const Dictionary& dictionary) const { appendJson(out, dictionary); }
};

}  // namespace

void appendJson(std::string& out, std::string_view text) {
  out += '"';
  while (!text.empty()) {
    const std::size_t plain = plainPrefix(text);
    out += text.substr(0, plain);
    text.remove_prefix(plain);
    if (text.empty()) break;

    const std::size_t size = std::max<std::size_t>(1, utf8CharacterSize(text));
    const std::string_view character = text.substr(0, size);
    if (isLateControl(character)) {
      appendCodeUnit(out, static_cast<unsigned char>(character[1]));
    } else if (size == 1 && static_cast<unsigned char>(character[0]) < 0x80) {
      appendEscaped(out, character[0]);
    } else {
      appendUtf8(out, character);
    }
    text.remove_prefix(size);
  }
  out += '"';
}

void appendJson(std::string& out, const Value& value) {
  std::visit(JsonForm{out}, value.held());
}

void appendJson(std::string& out, const Array& array) {
  char separator = '[';
  for (const Value& value : array) {
    out += separator;
    appendJson(out, value);
    separator = ',';
  }
  if (array.empty()) out += '[';
  out += ']';
}

void appendJson(std::string& out, const Dictionary& dictionary) {
  char separator = '{';
  for (const auto& [key, value] : dictionary) {
    out += separator;
    appendJson(out, key.view());
    out += ':';
    appendJson(out, value);
    separator = ',';
  }
  if (dictionary.empty()) out += '{';
  out += '}';
}

}  // namespace vesk
