#include <gtest/gtest.h>
#include <limits>

#include "support/bytes.h"
#include "values/json_form.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using namespace std::string_view_literals;

struct FormsRow {
  Value value;
  std::string_view text;
  std::string_view json;
};

void expectForms(std::initializer_list<FormsRow> rows) {
  for (const auto& [value, text, expectedJson] : rows) {
    std::string json;
    appendJson(json, value);
    EXPECT_EQ(textOf(value), text);
    EXPECT_EQ(json, expectedJson);
  }
}

TEST(ValueForms, ShowEveryKindOfValue) {
  expectForms({
      {true, "true", "true"},
      {std::numeric_limits<std::int64_t>::min(), "-9223372036854775808", "-9223372036854775808"},
      {std::numeric_limits<std::uint64_t>::max(), "18446744073709551615", "18446744073709551615"},
      {20.0F, "20.0", "20.0"},
      {1.4F, "1.4", "1.4"},
      {1e20F, "100000000000000000000.0", "100000000000000000000.0"},
      {-1.25e5F, "-125000.0", "-125000.0"},
      {1.5e-7F, "0.00000015", "0.00000015"},
      {std::numeric_limits<float>::infinity(), "inf", "null"},
      {Data::copy(bytesOf("00 1F A0 EF")), "0x001fa0ef", R"("0x001fa0ef")"},
      {Array{1, Array{}, Dictionary{}}, "[1, [], {}]", "[1,[],{}]"},
      {Dictionary{{"b\""_text, 1}, {"a"_text, Array{true, 2.5F}}}, "{b\": 1, a: [true, 2.5]}",
       R"({"b\"":1,"a":[true,2.5]})"},
  });
}

TEST(ValueForms, EscapeTextAndReplaceWhatIsNotUtf8) {
  const auto text = [](std::string_view bytes) { return Value(Text::copy(bytes)); };
  expectForms({
      {text(R"(a"b\c/'d')"), R"(a"b\c/'d')", R"("a\"b\\c/'d'")"},
      {text("a\nb\tc\rd"), "a\nb\tc\rd", R"("a\nb\tc\u000dd")"},
      {text("\0\x1B[2J\x7F"sv), "\0\x1B[2J\x7F"sv, R"("\u0000\u001b[2J\u007f")"},
      {text("\xC2\x80\xC2\x9F\xC2\xA0"), "\xC2\x80\xC2\x9F\xC2\xA0", "\"\\u0080\\u009f\xC2\xA0\""},
      {text("é€📶\xF4\x8F\xBF\xBF"), "é€📶\U0010FFFF", "\"é€📶\U0010FFFF\""},
      {text("a\xC3"), "a\uFFFD", "\"a\uFFFD\""},
      {text("a\xC3z\xFF"), "a\uFFFDz\uFFFD", "\"a\uFFFDz\uFFFD\""},
      {text("\xC0\x80"), "\uFFFD\uFFFD", "\"\uFFFD\uFFFD\""},
      {text("\xE0\x9F\xBF"), "\uFFFD\uFFFD\uFFFD", "\"\uFFFD\uFFFD\uFFFD\""},
      {text("\xED\xA0\x80"), "\uFFFD\uFFFD\uFFFD", "\"\uFFFD\uFFFD\uFFFD\""},
      {text("\xF4\x90\x80\x80"), "\uFFFD\uFFFD\uFFFD\uFFFD", "\"\uFFFD\uFFFD\uFFFD\uFFFD\""},
  });
}

}  // namespace
}  // namespace vesk
