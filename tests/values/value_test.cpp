#include "values/value.h"

#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "values/optional_number.h"
#include "values/ordered_lookup.h"

namespace vesk {
namespace {

constexpr std::uint64_t kLargest = std::numeric_limits<std::uint64_t>::max();

TEST(Value, GivesANumberInEveryFormThatHoldsItExactly) {
  struct Row {
    Value value;
    std::optional<std::int64_t> integer;
    std::optional<std::int32_t> integer32;
    std::optional<float> exactFloat;
    std::optional<double> number;
  };
  const std::int64_t beyond32 = std::int64_t{INT32_MAX} + 1;
  const std::vector<Row> rows{
      {7, 7, 7, 7.0F, 7.0},
      {INT32_MIN, INT32_MIN, INT32_MIN, -2147483648.0F, -2147483648.0},
      {beyond32, beyond32, std::nullopt, 2147483648.0F, 2147483648.0},
      {16777217, 16777217, 16777217, std::nullopt, 16777217.0},
      {INT64_MAX, INT64_MAX, std::nullopt, std::nullopt, 9223372036854775808.0},
      {kLargest, std::nullopt, std::nullopt, std::nullopt, 18446744073709551616.0},
      {std::uint64_t{1} << 63, std::nullopt, std::nullopt, 9223372036854775808.0F, 9223372036854775808.0},
      {20.0F, 20, 20, 20.0F, 20.0},
      {-19.5F, std::nullopt, std::nullopt, -19.5F, -19.5},
      {9223372036854775808.0F, std::nullopt, std::nullopt, 9223372036854775808.0F, 9223372036854775808.0},
      {true, std::nullopt, std::nullopt, std::nullopt, std::nullopt},
      {"7"_text, std::nullopt, std::nullopt, std::nullopt, std::nullopt},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.number.value_or(-1));
    EXPECT_EQ(row.value.integer(), row.integer);
    EXPECT_EQ(row.value.integer32(), row.integer32);
    EXPECT_EQ(row.value.exactFloat(), row.exactFloat);
    EXPECT_EQ(row.value.number(), row.number);
  }
}

TEST(Value, EqualsByWhatANumberIsNotByHowItIsHeld) {
  EXPECT_EQ(Value(20), Value(20.0F));
  EXPECT_NE(Value(16777217), Value(16777216.0F));
  EXPECT_EQ(Value(std::uint64_t{1} << 63), Value(9223372036854775808.0F));
  EXPECT_NE(Value(kLargest), Value(-1));
  EXPECT_NE(Value(true), Value(1));
  EXPECT_NE(Value("1"_text), Value(1));
  EXPECT_EQ(Value(Text::copy("idle")), Value("idle"_text));
}

TEST(Dictionary, KeepsTheOrderInWhichKeysCame) {
  Dictionary dictionary{{"b"_text, 1}, {"a"_text, 2}};
  dictionary.set("c"_text, 3);
  dictionary.set("b"_text, 4);
  dictionary.erase("a"_text);
  dictionary.erase("missing"_text);
  ASSERT_EQ(dictionary.size(), 2U);
  EXPECT_EQ(dictionary.begin()[0], (Dictionary::Entry{"b"_text, 4}));
  EXPECT_EQ(dictionary.begin()[1], (Dictionary::Entry{"c"_text, 3}));
  EXPECT_FALSE(dictionary.contains("a"));
  EXPECT_EQ(dictionary, (Dictionary{{"c"_text, 3}, {"b"_text, 4}}));
  EXPECT_NE(dictionary, (Dictionary{{"c"_text, 3}, {"d"_text, 4}}));
}

TEST(Dictionary, IsLookedUpInAnyOrderByAnyKindOfKey) {
  const Dictionary dictionary{{"a"_text, 1}, {Text::copy("b"), 2}, {"c"_text, 3}, {"d"_text, 4}};
  OrderedLookup lookup(dictionary);
  for (const auto& [key, value] : {std::pair{"a"_text, 1},
                                   {"c"_text, 3},
                                   {"b"_text, 2},
                                   {Text::copy("d"), 4},
                                   {"a"_text, 1},
                                   {Text::copy("b"), 2}}) {
    EXPECT_EQ(lookup.find("missing"_text), nullptr);
    ASSERT_NE(lookup.find(key), nullptr) << key.view();
    EXPECT_EQ(*dictionary.find(key), Value(value));
    EXPECT_EQ(*OrderedLookup(dictionary).find(key), Value(value));
  }
  EXPECT_EQ(OrderedLookup(Dictionary()).find("a"_text), nullptr);
}

TEST(OptionalNumber, IsLikeTheStandardOne) {
  const OptionalNumber<double> none;
  const OptionalNumber<double> zero(0.0);
  EXPECT_FALSE(none || !zero);
  EXPECT_TRUE(none == std::nullopt && none < zero && none != zero && zero > OptionalNumber(-1e300));
  EXPECT_EQ(std::optional<double>(none), std::nullopt);
  EXPECT_EQ(OptionalNumber(std::optional(7.5)), 7.5);
  EXPECT_EQ(OptionalNumber<std::int64_t>(std::nullopt).value_or(3), 3);
  EXPECT_LT(OptionalNumber<std::int64_t>(), OptionalNumber<std::int64_t>(INT64_MIN + 1));
}

TEST(Dictionary, ACopyIsUntouchedByChangesToTheOther) {
  const Dictionary inner{{"x"_text, 1}};
  Dictionary original{{"list"_text, Array{1, 2}}, {"inner"_text, inner}};
  const Dictionary copy = original;
  original.set("list"_text, 9);
  original.set("new"_text, Text::copy("text"));
  EXPECT_EQ(copy, (Dictionary{{"list"_text, Array{1, 2}}, {"inner"_text, inner}}));

  Dictionary shrunk = copy;
  shrunk.erase("list"_text);
  EXPECT_EQ(shrunk.size(), 1U);
  EXPECT_EQ(*copy.find("list"), Value(Array{1, 2}));
}

TEST(Array, GrowsAndSharesWithoutLosingElements) {
  Array grown;
  std::vector<Array> stages;
  for (int count = 0; count < 40; ++count) {
    stages.push_back(grown);
    grown.append(Text::copy(std::to_string(count)));
  }
  for (std::size_t count = 0; count < stages.size(); ++count)
    ASSERT_EQ(stages[count].size(), count);
  EXPECT_EQ(grown[39], Value("39"_text));
  EXPECT_EQ(stages[20][19], Value("19"_text));
}

}  // namespace
}  // namespace vesk
