#include "snippet.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace messagegen {
namespace {

const Variables kVariables{{"name", "earfcn"},        {"type", "std::uint32_t"}, {"empty", ""},
                           {"lines", "a;\n\n  b;\n"}, {"odd", "$type$ $$"},      {"unended", "a;\nb;"}};

TEST(Snippet, IsFilledIn) {
  struct Case {
    std::string_view snippet;
    std::string_view filled;
  };
  const Case cases[] = {
      {"", ""},
      {"$type$ $name$_;", "std::uint32_t earfcn_;\n"},
      {"$name$$name$", "earfcnearfcn\n"},
      {"a$$b$$", "a$b$\n"},
      {"a $empty$b", "a b\n"},
      // What a variable stands for is not filled in again.
      {"a $odd$", "a $type$ $$\n"},
      {"$odd$", "$type$ $$\n"},
      // The margin is that of the first line; blank lines and deeper ones stay.
      {"\n    {\n      $name$\n\n    }\n  ", "{\n  earfcn\n\n}\n"},
      {"\n    a\n  b\n", "a\nb\n"},
      // A variable alone on its line may have any number of lines.
      {"\n{\n  $lines$\n}\n", "{\n  a;\n\n    b;\n}\n"},
      {"\n{\n  $unended$\n}\n", "{\n  a;\n  b;\n}\n"},
      {"\n{\n  $empty$\n}\n", "{\n}\n"},
      {"$$", "$\n"},
  };
  for (const auto& [snippet, filled] : cases)
    EXPECT_EQ(expand(snippet, kVariables), filled) << snippet;
}

TEST(Snippet, IsQuotedWhenItCannotBeFilledIn) {
  struct Case {
    std::string_view snippet;
    std::string_view message;
  };
  const Case cases[] = {
      {"int $nmae$;", "no variable 'nmae' for the snippet\nint $nmae$;"},
      {"  $nmae$", "no variable 'nmae' for the snippet\n  $nmae$"},
      {"int $name;", "a lone '$' in the snippet\nint $name;"},
  };
  for (const auto& [snippet, message] : cases) {
    try {
      (void)expand(snippet, kVariables);
      ADD_FAILURE() << "filled in: " << snippet;
    } catch (const std::logic_error& error) {
      EXPECT_EQ(error.what(), message);
    }
  }
}

TEST(Snippet, BreaksALineThatIsTooLong) {
  const std::string call = "f(" + std::string(60, 'x') + ");";
  const auto conditionOf = [&](std::size_t width) {
    return std::string(width - 2 - call.size() - std::string_view("if () ").size(), 'c');
  };
  EXPECT_EQ(conditional(conditionOf(120), call), "if (" + conditionOf(120) + ") " + call + "\n");
  EXPECT_EQ(conditional(conditionOf(121), call), "if (" + conditionOf(121) + ") {\n  " + call + "\n}\n");
  const auto headOf = [&](std::size_t width) { return std::string(width - 2 - call.size() - 5, 'h'); };
  EXPECT_EQ(inlineFunction(headOf(120), call), headOf(120) + " { " + call + " }\n");
  EXPECT_EQ(inlineFunction(headOf(121), call), headOf(121) + " {\n  " + call + "\n}\n");
}

}  // namespace
}  // namespace messagegen
