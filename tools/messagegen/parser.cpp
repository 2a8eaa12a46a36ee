#include "parser.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <optional>
#include <set>

#include "lexer.h"
#include "names.h"

namespace messagegen {

namespace {

/// The reader keeps a field number to 16 bits.
constexpr std::int64_t kLargestFieldNumber = 65535;

class Parser {
 public:
  Parser(const std::string& path, std::string_view source) : lexer_(path, source), token_(lexer_.next()) {
    file_.path = path;
  }

  ProtoFile parse() {
    parseSyntax();
    while (token_.kind != TokenKind::end)
      parseStatement();
    if (file_.package.empty()) lexer_.fail(token_.position, "expected a 'package', got none in the file");
    return std::move(file_);
  }

 private:
  Token take() {
    Token taken = std::move(token_);
    token_ = lexer_.next();
    return taken;
  }

  [[nodiscard]] bool isNext(std::string_view text) const {
    return token_.text == text && token_.kind != TokenKind::string;
  }

  [[noreturn]] void failExpected(const std::string& expected) const {
    lexer_.fail(token_.position, "expected " + expected + ", got " + token_.shown());
  }

  void expect(std::string_view text) {
    if (!isNext(text)) failExpected("'" + std::string(text) + "'");
    take();
  }

  Token takeKind(TokenKind kind, const std::string& expected) {
    if (token_.kind != kind) failExpected(expected);
    return take();
  }

  std::string takeName(const std::string& expected) {
    const Token token = takeKind(TokenKind::identifier, expected);
    if (token.text.find('.') != std::string_view::npos) {
      lexer_.fail(token.position, "expected " + expected + ", got a qualified name");
    }
    return std::string(token.text);
  }

  /// A name that the generated code has as it stands.
  std::string takeNewName(const std::string& expected) {
    const Position position = token_.position;
    std::string name = takeName(expected);
    if (isKeyword(name)) lexer_.fail(position, "'" + name + "' is a keyword of C++");
    return name;
  }

  /// The name of a type that its owner, a message or the file itself, has not declared yet.
  std::string takeTypeName(const std::string& owner, const std::string& expected) {
    const Position position = token_.position;
    std::string name = takeNewName(expected);
    if (!typeNames_.insert(owner + '.' + name).second) lexer_.fail(position, "'" + name + "' is declared already");
    return name;
  }

  std::int64_t takeInteger(const std::string& expected, std::int64_t least, std::int64_t largest) {
    const Position position = token_.position;
    const bool negative = isNext("-");
    if (negative) take();
    const Token token = takeKind(TokenKind::integer, expected);
    const bool hex = token.text.starts_with("0x") || token.text.starts_with("0X");
    const std::string_view digits = hex ? token.text.substr(2) : token.text;
    std::int64_t magnitude = 0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), magnitude, hex ? 16 : 10);
    const bool whole = result.ec == std::errc{} && result.ptr == digits.data() + digits.size();
    const std::int64_t number = negative ? -magnitude : magnitude;
    if (!whole || number < least || number > largest) {
      lexer_.fail(position, "expected " + expected + " from " + std::to_string(least) + " to " +
                                std::to_string(largest) + ", got '" + (negative ? "-" : "") + std::string(token.text) +
                                "'");
    }
    return number;
  }

  void parseSyntax() {
    expect("syntax");
    expect("=");
    if (token_.kind != TokenKind::string || token_.text != "proto2") failExpected("\"proto2\"");
    take();
    expect(";");
  }

  void parseStatement() {
    if (isNext("package")) {
      take();
      file_.package = takeNewName("the package's name");
      expect(";");
    } else if (isNext("import")) {
      take();
      const Token path = takeKind(TokenKind::string, "the path of a .proto file");
      file_.imports.push_back({std::string(path.text), path.position});
      expect(";");
    } else if (isNext("enum")) {
      file_.enumerations.push_back(parseEnumeration(""));
    } else if (isNext("message")) {
      file_.messages.push_back(parseMessage());
    } else {
      failExpected("'package', 'import', 'enum' or 'message'");
    }
  }

  Enumeration parseEnumeration(const std::string& owner) {
    Enumeration enumeration;
    enumeration.comment = take().comment;
    enumeration.owner = owner;
    enumeration.name = takeTypeName(owner, "the enumeration's name");
    expect("{");
    while (!isNext("}")) {
      const Position position = token_.position;
      Enumerator value{takeNewName("a value's name or '}'"), 0};
      expect("=");
      value.number = static_cast<std::int32_t>(
          takeInteger("a value", std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()));
      expect(";");
      const auto clashes = [&](const Enumerator& other) {
        return other.name == value.name || other.number == value.number;
      };
      if (std::any_of(enumeration.values.begin(), enumeration.values.end(), clashes)) {
        lexer_.fail(position, "'" + value.name + "' repeats a name or a number of its enumeration");
      }
      enumeration.values.push_back(std::move(value));
    }
    if (enumeration.values.empty()) failExpected("at least one value");
    take();
    return enumeration;
  }

  MessageType parseMessage() {
    MessageType message;
    message.comment = take().comment;
    message.name = takeTypeName("", "the message's name");
    expect("{");
    while (!isNext("}")) {
      if (isNext("enum")) {
        message.enumerations.push_back(parseEnumeration(message.name));
      } else {
        addField(message, parseField());
      }
    }
    take();
    return message;
  }

  Field parseField() {
    if (!isNext("optional") && !isNext("repeated")) failExpected("'optional', 'repeated', 'enum' or '}'");
    Token label = take();
    Field field{};
    field.comment = std::move(label.comment);
    field.repeated = label.text == "repeated";
    field.typePosition = token_.position;
    field.typeName = takeName("the field's type");
    field.position = token_.position;
    field.name = takeName("the field's name");
    expect("=");
    field.number = static_cast<std::uint32_t>(takeInteger("a field number", 1, kLargestFieldNumber));
    if (isNext("[")) parsePacked(field);
    expect(";");
    return field;
  }

  /// Repeated scalars are written packed whether it is said or not; other tools need it said.
  void parsePacked(const Field& field) {
    if (!field.repeated) failExpected("';'");
    take();
    expect("packed");
    expect("=");
    expect("true");
    expect("]");
  }

  void addField(MessageType& message, Field field) const {
    for (const Field& other : message.fields) {
      if (other.number == field.number || other.name == field.name) {
        lexer_.fail(field.position, "'" + field.name + "' repeats the name or the number of '" + other.name + "'");
      }
    }
    message.fields.push_back(std::move(field));
  }

  Lexer lexer_;
  Token token_;
  ProtoFile file_;
  std::set<std::string> typeNames_;
};

}  // namespace

ProtoFile parseProto(const std::string& path, std::string_view source) {
  return Parser(path, source).parse();
}

}  // namespace messagegen
