#include <gtest/gtest.h>
#include <map>

#include "resolver.h"

namespace messagegen {
namespace {

std::string errorOf(const std::map<std::string, std::string>& files, const std::string& path) {
  try {
    (void)loadProto(path, [&](const std::string& wanted) {
      const auto found = files.find(wanted);
      return found == files.end() ? std::nullopt : std::optional(found->second);
    });
  } catch (const SchemaError& error) {
    return error.text();
  }
  return "none";
}

/// The error in a file whose third line, below syntax and package, is `line`.
std::string errorOf(const std::string& line) {
  return errorOf({{"a.proto", "syntax = \"proto2\";\npackage p;\n" + line + "\n"}}, "a.proto");
}

TEST(Schema, TellsWhereAndWhatIsWrong) {
  struct Case {
    std::string line;
    std::string column;
    std::string message;
  };
  const std::string number = "expected a field number from 1 to 65535, got ";
  const Case cases[] = {
      {"message M { optional uint32 a = 1 }", "35", "expected ';', got '}'"},
      {"message M { required uint32 a = 1; }", "13",
       "expected 'optional', 'repeated', 'enum' or '}', got identifier 'required'"},
      {"message M { optional uint32 = 1; }", "29", "expected the field's name, got '='"},
      {"message M { optional other.Type a = 1; }", "22", "expected the field's type, got a qualified name"},
      {"message M { optional uint32 a = 0; }", "33", number + "'0'"},
      {"message M { optional uint32 a = -1; }", "33", number + "'-1'"},
      {"message M { optional uint32 a = 0x10000; }", "33", number + "'0x10000'"},
      {"message M { optional uint32 a = 1x; }", "33", number + "'1x'"},
      {"message M { optional uint32 a = 99999999999999999999; }", "33", number + "'99999999999999999999'"},
      {"message M { optional uint32 a = \"1\"; }", "33", "expected a field number, got string \"1\""},
      {"message M { optional uint32 a = 1 [packed = true]; }", "35", "expected ';', got '['"},
      {"message M { repeated uint32 a = 1 [packed = false]; }", "45", "expected 'true', got identifier 'false'"},
      {"message M { optional uint32 a = 1; optional bool b = 1; }", "50", "'b' repeats the name or the number of 'a'"},
      {"message M { optional uint32 a = 1; optional bool a = 2; }", "50", "'a' repeats the name or the number of 'a'"},
      {"message M {", "1", "expected 'optional', 'repeated', 'enum' or '}', got end of file"},
      {"enum E { }", "10", "expected at least one value, got '}'"},
      {"enum E { A = 1; B = 1; }", "17", "'B' repeats a name or a number of its enumeration"},
      {"enum E { A = 2147483648; }", "14", "expected a value from -2147483648 to 2147483647, got '2147483648'"},
      {"message M { } enum M { A = 1; }", "20", "'M' is declared already"},
      {"message M { enum E { A = 1; } enum E { B = 1; } }", "36", "'E' is declared already"},
      {"service S { }", "1", "expected 'package', 'import', 'enum' or 'message', got identifier 'service'"},
      {"import a.proto;", "8", "expected the path of a .proto file, got identifier 'a.proto'"},
      {"import \"a.proto", "8", "a string that never ends"},
      {"  /* a", "3", "a comment that never ends"},
      {"  // a\\", "3", "a comment that ends in a backslash"},
      {"  // a\\ \t", "3", "a comment that ends in a backslash"},
      {"// a\r b", "1", "a comment with a control character"},
      {"message class { }", "9", "'class' is a keyword of C++"},
      {"enum E { static_assert = 1; }", "10", "'static_assert' is a keyword of C++"},
      {"message M { % }", "13", "unexpected character '%'"},

      {"message M { optional Unknown a = 1; }", "22", "unknown type 'Unknown'"},
      {"message M { repeated string a = 1; }", "22", "a repeated field is of type uint32, int32, sint32 or a message"},
      {"message M { optional M a = 1; }", "22", "'M' contains itself"},
      {"message N { optional M m = 1; } message M { repeated N n = 1; }", "54", "'N' contains itself"},
      {"message M { optional bool a_b = 1; optional bool A_b = 2; }", "50",
       "the accessor 'aB' has its name from something else already"},
      {"message M { optional bool has_up = 1; optional bool up = 2; }", "53",
       "the accessor 'hasUp' has its name from something else already"},
      {"message M { optional uint32 as_count = 1; repeated uint32 a = 2; }", "59",
       "the accessor 'asCount' has its name from something else already"},
      {"message M { optional bool class = 1; }", "27", "the accessor 'class' has its name from something else already"},
      {"message m { optional bool m = 1; }", "27", "the accessor 'm' has its name from something else already"},
      {"message M { enum kind { A = 1; } optional bool kind = 1; }", "48",
       "the accessor 'kind' has its name from something else already"},
      {"message M { optional bool _1 = 1; }", "27", "the accessor '1' is no name"},
      {"message M { optional bool write_to = 1; }", "27",
       "the accessor 'writeTo' has its name from something else already"},
  };
  for (const Case& row : cases) {
    const bool isBelow = row.message.ends_with("end of file");
    const std::string shown = isBelow ? "" : row.line;
    EXPECT_EQ(errorOf(row.line), "a.proto:" + std::string(isBelow ? "4" : "3") + ":" + row.column + ": " + row.message +
                                     "\n" + shown + "\n" + std::string(std::stoul(row.column) - 1, ' ') + "^\n");
  }
}

TEST(Schema, TellsOfFilesThatCannotBeRead) {
  EXPECT_EQ(errorOf({}, "a.proto"), "a.proto:1:1: cannot be read\n\n^\n");
  EXPECT_EQ(errorOf({{"a.proto", "syntax = \"proto3\";"}}, "a.proto"),
            "a.proto:1:10: expected \"proto2\", got string \"proto3\"\nsyntax = \"proto3\";\n         ^\n");
  const std::string start = "syntax = \"proto2\"; package p;";
  EXPECT_EQ(errorOf({{"a.proto", start + "\nimport \"b.proto\";"}}, "a.proto"),
            "a.proto:2:8: import \"b.proto\" cannot be read\nimport \"b.proto\";\n       ^\n");
  EXPECT_EQ(errorOf({{"a.proto", start + " import \"b.proto\";"}, {"b.proto", "x"}}, "a.proto"),
            "b.proto:1:1: expected 'syntax', got identifier 'x'\nx\n^\n");

  const std::string imports = start + " import \"b.proto\"; message M {}";
  const std::string shown = "\n" + imports + "\n" + std::string(37, ' ') + "^\n";
  EXPECT_EQ(errorOf({{"a.proto", imports}, {"b.proto", start + " enum M { A = 1; }"}}, "a.proto"),
            "a.proto:1:38: import \"b.proto\" declares 'M', which is declared already" + shown);
  EXPECT_EQ(errorOf({{"a.proto", imports}, {"b.proto", "syntax = \"proto2\"; package q;"}}, "a.proto"),
            "a.proto:1:38: import \"b.proto\" is of another package" + shown);
}

TEST(Schema, RefusesMessagesThatNestWithoutBoundWhicheverIsDeclaredFirst) {
  const std::string start = "syntax = \"proto2\"; package p;\n";
  const auto link = [](int outer, int inner) {
    return "message M" + std::to_string(outer) + " { optional M" + std::to_string(inner) + " m = 1; }\n";
  };
  std::string outermostFirst = start;
  std::string innermostFirst = start + "message M0 {}\n";
  for (int depth = 0; depth < 1'000; ++depth) {
    outermostFirst += link(depth, depth + 1);
    innermostFirst += link(depth + 1, depth);
  }
  outermostFirst += "message M1000 {}\n";
  const std::string reason = ":24: messages nest more than 32 deep\n";
  const std::string mark = std::string(23, ' ') + "^\n";
  EXPECT_EQ(errorOf({{"a.proto", outermostFirst}}, "a.proto"), "a.proto:33" + reason + link(31, 32) + mark);
  EXPECT_EQ(errorOf({{"a.proto", innermostFirst}}, "a.proto"), "a.proto:34" + reason + link(32, 31) + mark);
}

TEST(Schema, OrdersMessagesByUseAndFindsImportedTypes) {
  const std::string start = "syntax = \"proto2\"; package p; ";
  const std::map<std::string, std::string> files{
      {"a.proto", start + "import \"b.proto\"; message A { optional B b = 1; optional E e = 2; optional C c = 3; } "
                          "message B { optional C c = 1; }"},
      {"b.proto", start + "enum E { FIRST = 3; } message C {}"},
  };
  const ProtoFile file = loadProto("a.proto", [&](const std::string& path) { return std::optional(files.at(path)); });
  ASSERT_EQ(file.messages.size(), 2U);
  EXPECT_EQ(file.messages[0].name, "B");
  EXPECT_EQ(file.messages[1].name, "A");
  EXPECT_EQ(file.messages[1].fields[1].type, FieldType::enumeration);
  EXPECT_EQ(file.messages[1].fields[1].defaultName, "FIRST");
}

TEST(Schema, TakesAMessageForOneThoughItIsCalledLikeAScalar) {
  const std::string source = "syntax = \"proto2\"; package p; message uint32 { optional uint32 a = 1; }";
  const ProtoFile file = loadProto("a.proto", [&](const std::string&) { return std::optional(source); });
  EXPECT_EQ(file.messages[0].fields[0].type, FieldType::uint32);
}

TEST(Schema, TakesLinesThatEndAsOnWindows) {
  const std::string source = "syntax = \"proto2\";\r\npackage p;\r\n// Said.\r\nenum E { A = 1; }\r\n";
  const ProtoFile file = loadProto("a.proto", [&](const std::string&) { return std::optional(source); });
  EXPECT_EQ(file.enumerations[0].comment, Comment{"Said."});
}

}  // namespace
}  // namespace messagegen
