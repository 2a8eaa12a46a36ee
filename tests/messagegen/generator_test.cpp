#include "generator.h"

#include <google/protobuf/compiler/importer.h>
#include <google/protobuf/io/zero_copy_stream_impl_lite.h>
#include <gtest/gtest.h>
#include <map>

namespace messagegen {
namespace {

namespace pb = google::protobuf;
using Files = std::map<std::string, std::string>;

class Sources : public pb::compiler::SourceTree, public pb::compiler::MultiFileErrorCollector {
 public:
  explicit Sources(Files files) : files_(std::move(files)) {}

  pb::io::ZeroCopyInputStream* Open(const std::string& path) override {
    const std::string& source = files_.at(path);
    return new pb::io::ArrayInputStream(source.data(), static_cast<int>(source.size()));
  }
  void AddError(const std::string& path, int line, int /*column*/, const std::string& message) override {
    ADD_FAILURE() << path << ':' << line + 1 << ": " << message << '\n' << files_[path];
  }

 private:
  Files files_;
};

/// What protoc and the generator make of "a.proto".
class Generated : public pb::compiler::GeneratorContext {
 public:
  explicit Generated(const std::string& source, Files imports = {}) {
    imports["a.proto"] = source;
    Sources sources(std::move(imports));
    pb::compiler::Importer importer(&sources, &sources);
    const pb::FileDescriptor* file = importer.Import("a.proto");
    if (file != nullptr) MessageGenerator().GenerateAll({file}, "", this, &error);
  }

  pb::io::ZeroCopyOutputStream* Open(const std::string& path) override {
    return new pb::io::StringOutputStream(&files[path]);
  }

  std::string error;
  Files files;
};

const std::string kStart = "syntax = \"proto2\"; package p;\n";

/// The error in a file whose second line, below syntax and package, is `line`.
std::string errorOf(const std::string& line) {
  return Generated(kStart + line + "\n").error;
}

TEST(Generator, RefusesWhatItCannotGenerate) {
  struct Case {
    std::string line;
    std::string column;
    std::string message;
  };
  const std::string isNot = " is not supported; docs/fields.md shows what is";
  const std::string notInCpp = "' in C++, which is taken or cannot be a name; call it something else";
  const Case cases[] = {
      {"service S {}", "1", "'service'" + isNot},
      {"option java_package = \"p\";", "1", "'options'" + isNot},
      {"message M { message N {} }", "13", "'message_type.nested_type'" + isNot},
      {"message M { optional group G = 1 {} }", "13", "'message_type.nested_type'" + isNot},
      {"message M { oneof o { bool a = 1; } }", "13", "'message_type.oneof_decl'" + isNot},
      {"message M { extensions 4; }", "13", "'message_type.extension_range'" + isNot},
      {"message M { reserved 4; }", "13", "'message_type.reserved_range'" + isNot},
      {"message M { optional uint32 a = 1 [default = 3]; }", "46", "'field.default_value'" + isNot},
      {"message M { optional uint32 a = 1 [deprecated = true]; }", "36", "'options.deprecated'" + isNot},
      {"enum E { option allow_alias = true; A = 1; B = 1; }", "10", "'enum_type.options'" + isNot},

      {"message M { map<int32, bool> a = 1; }", "13", "the type map" + isNot},
      {"message M { optional fixed32 a = 1; }", "13", "the type fixed32" + isNot},
      {"message M { required bool a = 1; }", "13", "a required field is not supported; make it optional"},
      {"message M { repeated string a = 1; }", "13", "a repeated string" + isNot},
      {"message M { repeated int32 a = 1 [packed = false]; }", "13",
       "repeated numbers are always written packed; take the option away"},
      {"message M { optional bool a = 65536; }", "13", "the field number is above 65535; take a smaller one"},
      {"message M { optional M a = 1; }", "13", "'M' contains itself; take one of its fields away"},
      {"message N { optional M m = 1; } message M { repeated N n = 1; }", "45",
       "'N' contains itself; take one of its fields away"},
      {"message M { enum E { A = 1; } optional E e = 1; } message N { optional M.E e = 1; }", "63",
       "'E' means nothing or something else here; declare it by itself and under another name"},
      {"enum E { B = 1; } message M { enum E { A = 1; } optional .p.E e = 1; }", "49",
       "'E' means nothing or something else here; declare it by itself and under another name"},
      {"/* a\\\n */ enum E { A = 1; }", "5",
       "its comment has a control character or a line that ends in a backslash; take that away"},

      {"enum E { static_assert = 1; }", "10", "'static_assert' is a keyword of C++; call it something else"},
      {"message M {}", "1", "the message has no fields; give it one"},
      {"message m {}", "1", "the type 'm' does not begin with a capital letter; let it do so"},
      {"message Text {}", "1", "'Text' would be 'Text" + notInCpp},
      {"message M { enum Self { A = 1; } optional Self a = 1; }", "13", "'Self' would be 'Self" + notInCpp},
      {"message M { optional bool class = 1; }", "13", "'class' would be 'class" + notInCpp},
      {"message M { optional bool _1 = 1; }", "13", "'_1' would be '1" + notInCpp},
      {"message M { optional bool a_b = 1; optional bool A_b = 2; }", "36", "'A_b' would be 'aB" + notInCpp},
      {"message M { optional bool has_up = 1; optional bool up = 2; }", "39", "'up' would be 'hasUp" + notInCpp},
      {"message M { optional bytes a = 1; repeated int32 set_a = 2; optional string set_as = 3; }", "61",
       "'set_as' would be 'setAs" + notInCpp},
      {"message M { optional uint32 as_count = 1; repeated M2 a = 2; } message M2 { optional bool b = 1; }", "43",
       "'a' would be 'asCount" + notInCpp},
      {"message M { optional bool up = 1; optional bytes k_up = 2; }", "35", "'k_up' would be 'kUp" + notInCpp},
      {"message M { optional bool class_name = 1; }", "13", "'class_name' would be 'className" + notInCpp},
      {"message M { optional bool append_json = 1; }", "13", "'append_json' would be 'appendJson" + notInCpp},
      {"message M { optional bool count_of = 1; }", "13", "'count_of' would be 'countOf" + notInCpp},
  };
  for (const auto& [line, column, message] : cases) {
    const std::string row = line.find('\n') == std::string::npos ? "2" : "3";
    EXPECT_EQ(errorOf(line),
              std::string("a.proto:").append(row).append(":").append(column).append(": ").append(message))
        << line;
  }
  EXPECT_EQ(errorOf("message M { optional bool read_fields = 1; repeated int32 a = 2 [packed = true]; }"), "");
}

TEST(Generator, RefusesFilesThatBelongNowhere) {
  EXPECT_EQ(Generated("syntax = \"proto3\";").error,
            "a.proto:1:1: the syntax is not supported; write the file in proto2");
  EXPECT_EQ(Generated("syntax = \"proto2\"; package p.q;").error,
            "a.proto:1:20: the package 'p.q' is no name for a namespace; give it one");
  EXPECT_EQ(Generated(kStart + "import \"b.proto\";", {{"b.proto", "syntax = \"proto2\"; package q;"}}).error,
            "a.proto:2:1: the import is of another package; make it the same");
  EXPECT_EQ(Generated(kStart + "import public \"b.proto\";", {{"b.proto", kStart}}).error,
            "a.proto:2:8: 'public_dependency' is not supported; docs/fields.md shows what is");
}

TEST(Generator, RefusesMessagesThatAreTooDeepOrTooWide) {
  std::string nested = kStart + "message M1 { optional bool b = 1; }\n";
  for (int depth = 2; depth <= 33; ++depth) {
    nested += "message M" + std::to_string(depth) + " { optional M" + std::to_string(depth - 1) + " m = 1; }\n";
  }
  EXPECT_EQ(Generated(nested).error, "a.proto:34:15: messages nest more than 32 deep; make them flatter");

  std::string wide = kStart + "message M {\n";
  for (int number = 1; number <= 65; ++number)
    wide += "optional bool a" + std::to_string(number) + " = " + std::to_string(number) + ";\n";
  EXPECT_EQ(Generated(wide + "}").error, "a.proto:67:1: the message has more than 64 optional scalars; divide it");
}

TEST(Generator, WritesCodeThatReadsAsIfWrittenByHand) {
  const std::string longName(53, 'n');
  const Generated generated(kStart + R"(
// A cell.
//
// As heard.
message Cell {
  // In dB.
  optional Level level = 2;  // Not shown.
  repeated uint32 multi_band_info = 1;
  optional bool )" + longName +
                            R"( = 3;
}
message Level {
  optional bool is_low = 1;
}
)");
  const std::string& header = generated.files.at("a.h");
  EXPECT_LT(header.find("class Level final"), header.find("class Cell final"));
  const std::string wanted = R"(
/// A cell.
///
/// As heard.
class Cell final : public Message<Cell, std::uint8_t> {
 public:
  static constexpr std::string_view kClassName = "Cell";

  /// In dB.
  [[nodiscard]] const std::shared_ptr<Level>& level() const { return level_; }
  void setLevel(std::shared_ptr<Level> value) { level_ = std::move(value); }
  [[nodiscard]] bool hasLevel() const { return static_cast<bool>(level_); }

  [[nodiscard]] const std::uint32_t* multiBandInfos() const { return multiBandInfos_.values(); }
)";
  EXPECT_NE(header.find(wanted), std::string::npos) << header;
  EXPECT_NE(header.find("  void setHasN" + longName.substr(1) + "(bool present) {\n    setPresence("),
            std::string::npos)
      << header;
}

}  // namespace
}  // namespace messagegen
