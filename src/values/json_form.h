#pragma once

#include <algorithm>
#include <array>
#include <charconv>
#include <concepts>
#include <cstddef>
#include <string>
#include <string_view>

#include "values/value.h"

namespace vesk {

/// Appends JSON to a text: numbers and booleans as such, bytes as "0x…" text, invalid UTF-8 as U+FFFD. Control
/// characters are escaped, those beyond ASCII too, so that a terminal may show what comes out. Small pieces are
/// gathered: all is in the text after finish().
class JsonWriter {
 public:
  explicit JsonWriter(std::string& out) : out_(out) {}
  JsonWriter(const JsonWriter&) = delete;
  JsonWriter& operator=(const JsonWriter&) = delete;

  void finish() { flush(); }

  void write(std::same_as<bool> auto value) { put(value ? "true" : "false"); }
  template <std::integral Number>
  requires(!std::same_as<Number, bool>) void write(Number number) {
    char* const place = roomFor(kLongestNumber);
    size_ += static_cast<std::size_t>(std::to_chars(place, place + kLongestNumber, number).ptr - place);
  }
  void write(float number);
  void writeNull() { put("null"); }
  void write(std::string_view text);
  void write(const Text& text) { write(text.view()); }
  void write(const Data& data);
  void write(const Array& array);
  void write(const Dictionary& dictionary);
  void write(const Value& value);

  static constexpr std::size_t kLongestPlainKey = 256;
  /// A separator, a name and a colon. The name is no longer than that and holds nothing to be escaped, as an
  /// identifier.
  void putPlainKey(char separator, std::string_view name) {
    const std::size_t size = name.size() + 4;
    char* const place = roomFor(size);
    place[0] = separator;
    place[1] = '"';
    std::copy_n(name.data(), name.size(), place + 2);
    place[size - 2] = '"';
    place[size - 1] = ':';
    size_ += size;
  }

  /// A character of JSON's own.
  void put(char character) {
    if (size_ == gathered_.size()) flush();
    gathered_[size_++] = character;
  }

 private:
  static constexpr std::size_t kLongestNumber = 24;

  char* roomFor(std::size_t more) {
    if (gathered_.size() - size_ < more) flush();
    return gathered_.data() + size_;
  }

  void put(std::string_view characters) {
    for (const char character : characters)
      put(character);
  }
  /// Puts the characters from the start that stand in JSON text as they are; how many.
  std::size_t putPlain(std::string_view text);
  /// A character that does not, or a byte that is none.
  void putEscaped(std::string_view character);
  void putEscaped(char character);
  void putCodeUnit(unsigned unit);
  void flush() {
    out_.append(gathered_.data(), size_);
    size_ = 0;
  }

  std::string& out_;
  std::array<char, 512> gathered_;
  std::size_t size_ = 0;
};

/// Writes one JSON object, field by field.
class JsonObject {
 public:
  explicit JsonObject(JsonWriter& json) : json_(json) {}

  /// Starts a field, whose value must follow.
  void key(std::string_view name) {
    separate();
    json_.write(name);
    json_.put(':');
  }
  /// The same under a name that holds nothing to be escaped.
  void plainKey(std::string_view name) {
    if (name.size() > JsonWriter::kLongestPlainKey) return key(name);
    json_.putPlainKey(separator_, name);
    separator_ = ',';
  }
  void end() {
    if (separator_ == '{') json_.put('{');
    json_.put('}');
  }

 private:
  void separate() {
    json_.put(separator_);
    separator_ = ',';
  }

  JsonWriter& json_;
  char separator_ = '{';
};

/// Writes the elements of a range as a JSON array; `write` writes one.
template <class Range, class Write>
void writeJsonArray(JsonWriter& json, const Range& range, Write write) {
  char separator = '[';
  for (const auto& each : range) {
    json.put(separator);
    separator = ',';
    write(each);
  }
  if (separator == '[') json.put('[');
  json.put(']');
}

template <class Written>
void appendJson(std::string& out, const Written& value) {
  JsonWriter json(out);
  json.write(value);
  json.finish();
}

}  // namespace vesk
