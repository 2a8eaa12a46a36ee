#include "app/json_form.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <variant>

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

/// The control characters U+0080 to U+009F: C2, then a byte below A0.
bool isLateControl(std::string_view character) {
  return character.size() == 2 && character[0] == '\xC2' && static_cast<unsigned char>(character[1]) < 0xA0;
}

/// Gathers the many small pieces of JSON text, so that the string it is for grows by a few large ones.
class JsonWriter {
 public:
  explicit JsonWriter(std::string& out) : out_(out) {}
  JsonWriter(const JsonWriter&) = delete;
  JsonWriter& operator=(const JsonWriter&) = delete;
  ~JsonWriter() { flush(); }

  void operator()(bool value) { put(value ? "true" : "false"); }
  void operator()(std::int64_t number) { putInteger(number); }
  void operator()(std::uint64_t number) { putInteger(number); }
  void operator()(float number) {
    // JSON has no other numbers.
    if (std::isfinite(number)) {
      flush();
      appendDecimal(out_, number);
    } else {
      put("null");
    }
  }
  void operator()(const Text& text) { write(text.view()); }
  void operator()(const Data& data) {
    put("\"0x");
    for (const std::uint8_t byte : data.bytes()) {
      put(kHexDigits[byte >> 4]);
      put(kHexDigits[byte & 0x0F]);
    }
    put('"');
  }
  void operator()(const Array& array) { write(array); }
  void operator()(const Dictionary& dictionary) { write(dictionary); }

  void write(const Value& value) { std::visit(*this, value.held()); }

  void write(const Array& array) {
    char separator = '[';
    for (const Value& value : array) {
      put(separator);
      write(value);
      separator = ',';
    }
    if (array.empty()) put('[');
    put(']');
  }

  void write(const Dictionary& dictionary) {
    char separator = '{';
    for (const auto& [key, value] : dictionary) {
      put(separator);
      write(key.view());
      put(':');
      write(value);
      separator = ',';
    }
    if (dictionary.empty()) put('{');
    put('}');
  }

  void write(std::string_view text) {
    put('"');
    for (text.remove_prefix(putPlain(text)); !text.empty(); text.remove_prefix(putPlain(text))) {
      const std::size_t size = std::max<std::size_t>(1, utf8CharacterSize(text));
      putEscaped(text.substr(0, size));
      text.remove_prefix(size);
    }
    put('"');
  }

 private:
  /// Room for the longest number.
  static constexpr std::size_t kLongestNumber = 24;

  void put(char character) {
    if (size_ == gathered_.size()) flush();
    gathered_[size_++] = character;
  }
  void put(std::string_view characters) {
    for (const char character : characters)
      put(character);
  }
  template <class Number>
  void putInteger(Number number) {
    if (gathered_.size() - size_ < kLongestNumber) flush();
    char* const place = gathered_.data() + size_;
    size_ += static_cast<std::size_t>(std::to_chars(place, place + kLongestNumber, number).ptr - place);
  }

  /// Puts the characters from the start that stand in JSON text as they are; how many.
  std::size_t putPlain(std::string_view text) {
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

  /// A character that does not stand in JSON text as it is, or a byte that is none.
  void putEscaped(std::string_view character) {
    if (isLateControl(character)) {
      putCodeUnit(static_cast<unsigned char>(character[1]));
    } else if (character.size() == 1 && static_cast<unsigned char>(character[0]) < 0x80) {
      putEscaped(character[0]);
    } else {
      flush();
      appendUtf8(out_, character);
    }
  }
  void putEscaped(char character) {
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
  void putCodeUnit(unsigned unit) {
    put("\\u");
    for (const unsigned shift : {12U, 8U, 4U, 0U})
      put(kHexDigits[unit >> shift & 0x0F]);
  }

  void flush() {
    out_.append(gathered_.data(), size_);
    size_ = 0;
  }

  std::string& out_;
  std::array<char, 512> gathered_;
  std::size_t size_ = 0;
};

}  // namespace

void appendJson(std::string& out, std::string_view text) {
  JsonWriter(out).write(text);
}
void appendJson(std::string& out, const Value& value) {
  JsonWriter(out).write(value);
}
void appendJson(std::string& out, const Array& array) {
  JsonWriter(out).write(array);
}
void appendJson(std::string& out, const Dictionary& dictionary) {
  JsonWriter(out).write(dictionary);
}

}  // namespace vesk
