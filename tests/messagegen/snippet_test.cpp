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
  struct Case {
    std::string line;
    std::string broken;
  };
  const Case cases[] = {
      {"if (!f(x).g($x$)) return (false);", "if (!f(x).g($x$)) {\n  return (false);\n}"},
      {"void f($x$) { g({}); }", "void f($x$) {\n  g({});\n}"},
      {"g($x$);", "g($x$);"},
  };
  for (const auto& [line, broken] : cases) {
    // Below a class, which indents by two.
    const std::size_t room = kLineWidth - 2 - (line.size() - 3);
    const Variables fits{{"x", std::string(room, 'x')}};
    const Variables isTooLong{{"x", std::string(room + 1, 'x')}};
    EXPECT_EQ(expandToFit(line, fits), expand(line, fits));
    EXPECT_EQ(expandToFit(line, isTooLong), expand(broken, isTooLong));
  }
}

}  // namespace
}  // namespace messagegen
