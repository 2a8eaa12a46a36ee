#include "values/text_form.h"

#include <array>
#include <gtest/gtest.h>
#include <limits>
#include <vector>

#include "values/utf8.h"

namespace vesk {
namespace {

TEST(TextForm, ShowsEveryKindOfValue) {
  const std::array<std::uint8_t, 3> bytes{0x00, 0x1F, 0xA0};
  struct Row {
    Value value;
    std::string_view text;
  };
  const std::vector<Row> rows{
      {-70, "-70"},
      {std::numeric_limits<std::uint64_t>::max(), "18446744073709551615"},
      {true, "true"},
      {false, "false"},
      {20.0F, "20.0"},
      {1.4F, "1.4"},
      {-19.5F, "-19.5"},
      {0.0F, "0.0"},
      {1e20F, "1.0e+20"},
      {1.5e-20F, "1.5e-20"},
      {"text, as it is"_text, "text, as it is"},
      {Data::copy(bytes), "0x001fa0"},
      {Data(), "0x"},
      {Array{1, 3, 7}, "[1, 3, 7]"},
      {Array{}, "[]"},
      {Dictionary{{"a"_text, 1}, {"b"_text, Array{Dictionary{{"c"_text, 2.5F}}}}}, "{a: 1, b: [{c: 2.5}]}"},
      {Dictionary{}, "{}"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(textOf(row.value), row.text);
}

TEST(TextForm, ReplacesWhatIsNotUtf8) {
  struct Row {
    std::string_view bytes;
    std::string_view shown;
  };
  const std::vector<Row> rows{
      {"caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x93\xB6", "café € 📶"},
      {"\xFF", "\uFFFD"},
      {"a\xC3", "a\uFFFD"},
      {"a\xC3z", "a\uFFFDz"},
      {"\xC0\x80", "\uFFFD\uFFFD"},
      {"\xE0\x9F\xBF", "\uFFFD\uFFFD\uFFFD"},
      {"\xED\xA0\x80", "\uFFFD\uFFFD\uFFFD"},
      {"\xF4\x90\x80\x80", "\uFFFD\uFFFD\uFFFD\uFFFD"},
      {"\xF4\x8F\xBF\xBF", "\U0010FFFF"},
      {"\xE2\x82", "\uFFFD\uFFFD"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(textOf(Value(Text::copy(row.bytes))), row.shown);
}

}  // namespace
}  // namespace vesk
