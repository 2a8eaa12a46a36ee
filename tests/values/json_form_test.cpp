#include "values/json_form.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <limits>

#include "support/bytes.h"

namespace vesk {
namespace {

using namespace std::string_view_literals;

template <class Shown>
std::string jsonOf(const Shown& value) {
  std::string out;
  appendJson(out, value);
  return out;
}

TEST(JsonForm, EscapesText) {
  struct Case {
    std::string_view text;
    std::string_view json;
  };
  const Case cases[] = {
      {"", R"("")"},
      {"plain / 'text'", R"("plain / 'text'")"},
      {R"(a"b\c)", R"("a\"b\\c")"},
      {"a\nb\tc\rd", R"("a\nb\tc\u000dd")"},
      {"\0\x1B[2J\x7F"sv, R"("\u0000\u001b[2J\u007f")"},
      {"\u00e9\u20ac\U0001F4F6", "\"\u00e9\u20ac\U0001F4F6\""},
      {"\xC2\x80|\xC2\x9F|\xC2\xA0", "\"\\u0080|\\u009f|\xC2\xA0\""},
      // Not UTF-8: alone, cut off, over-long, a surrogate, beyond the last character.
      {"a\xFFz", "\"a\uFFFDz\""},
      {"\x80", "\"\uFFFD\""},
      {"\xC2", "\"\uFFFD\""},
      {"\xC2\"", "\"\uFFFD\\\"\""},
      {"\xE2\x82", "\"\uFFFD\uFFFD\""},
      {"\xC0\xAF", "\"\uFFFD\uFFFD\""},
      {"\xED\xA0\x80", "\"\uFFFD\uFFFD\uFFFD\""},
      {"\xF4\x90\x80\x80", "\"\uFFFD\uFFFD\uFFFD\uFFFD\""},
  };
  for (const auto& [text, json] : cases)
    EXPECT_EQ(jsonOf(text), json);
}

TEST(JsonForm, WritesEachKindOfValue) {
  struct Case {
    Value value;
    std::string_view json;
  };
  const Case cases[] = {
      {true, "true"},
      {false, "false"},
      {-7, "-7"},
      {std::numeric_limits<std::int64_t>::min(), "-9223372036854775808"},
      {std::numeric_limits<std::uint64_t>::max(), "18446744073709551615"},
      {-19.5F, "-19.5"},
      {20.0F, "20.0"},
      {1e20F, "1.0e+20"},
      {std::numeric_limits<float>::infinity(), "null"},
      {std::numeric_limits<float>::quiet_NaN(), "null"},
      {Text::copy("a\n"), R"("a\n")"},
      {Data::copy(bytesOf("00 FF")), R"("0x00ff")"},
      {Data(), R"("0x")"},
      {Array{}, "[]"},
      {Array{1, Array{}, Dictionary{}}, "[1,[],{}]"},
      {Dictionary{{"b\""_text, 1}, {"a"_text, Array{true, 2.5F}}}, R"({"b\"":1,"a":[true,2.5]})"},
  };
  for (const auto& [value, json] : cases)
    EXPECT_EQ(jsonOf(value), json);
}

}  // namespace
}  // namespace vesk
