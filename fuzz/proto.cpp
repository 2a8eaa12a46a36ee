// The input is a .proto file, which may import "shared.proto" and nothing else.

#include <algorithm>
#include <string>

#include "emit.h"
#include "names.h"
#include "property.h"
#include "resolver.h"

namespace messagegen {

namespace {

using vesk::require;

const std::string kPath = "fuzzed.proto";
const std::string kImported = "shared.proto";
const std::string kImportedSource = "syntax = \"proto2\";\npackage p;\nenum Shared { S_ONE = 1; }\nmessage Part {}\n";

ProtoFile load(const std::string& source) {
  return loadProto(kPath, [&](const std::string& path) -> std::optional<std::string> {
    if (path == kPath) return source;
    return path == kImported ? std::optional(kImportedSource) : std::nullopt;
  });
}

std::string takeUntil(std::string& text, char separator) {
  const std::size_t end = text.find(separator);
  require(end != std::string::npos, "an error has the form PATH:LINE:COLUMN: message, line, caret");
  std::string taken = text.substr(0, end);
  text.erase(0, end + 1);
  return taken;
}

/// fuzzed.proto:3:12: expected ';', got '}' and so on: the place is one of the file.
void checkError(std::string text, const std::string& source) {
  require(takeUntil(text, ':') == kPath, "an error names its file");
  const std::size_t line = std::stoul(takeUntil(text, ':'));
  const std::size_t column = std::stoul(takeUntil(text, ':'));
  std::size_t start = 0;
  for (std::size_t number = 1; number < line; ++number)
    start = source.find('\n', start) + 1;
  const std::string shown = source.substr(start, source.find('\n', start) - start);
  require(column <= shown.size() + 1, "an error names a column of its line");
  require(text.ends_with('\n' + shown + '\n' + std::string(column - 1, ' ') + "^\n"), "an error shows its line");
}

std::string written(const Comment& comment) {
  std::string out;
  for (const std::string& line : comment)
    out += "// " + line + '\n';
  return out;
}

std::string written(const Enumeration& enumeration) {
  std::string out = written(enumeration.comment) + "enum " + enumeration.name + " {\n";
  for (const Enumerator& value : enumeration.values)
    out += value.name + " = " + std::to_string(value.number) + ";\n";
  return out + "}\n";
}

std::string written(const MessageType& message) {
  std::string out = written(message.comment) + "message " + message.name + " {\n";
  for (const Enumeration& enumeration : message.enumerations)
    out += written(enumeration);
  for (const Field& field : message.fields) {
    out += written(field.comment) + (field.repeated ? "repeated " : "optional ") + field.typeName + ' ' + field.name +
           " = " + std::to_string(field.number) + ";\n";
  }
  return out + "}\n";
}

/// The same schema as a .proto of its own.
std::string written(const ProtoFile& file) {
  std::string out = "syntax = \"proto2\";\npackage " + file.package + ";\n";
  for (const Import& import : file.imports)
    out += "import \"" + import.path + "\";\n";
  for (const Enumeration& enumeration : file.enumerations)
    out += written(enumeration);
  for (const MessageType& message : file.messages)
    out += written(message);
  return out;
}

bool isIdentifier(const std::string& name) {
  const auto isLetter = [](char c) { return ('a' <= c && c <= 'z') || ('A' <= c && c <= 'Z') || c == '_'; };
  const auto isDigit = [](char c) { return '0' <= c && c <= '9'; };
  return !name.empty() && !isDigit(name[0]) &&
         std::all_of(name.begin(), name.end(), [&](char c) { return isLetter(c) || isDigit(c); });
}

void checkNames(const Enumeration& enumeration) {
  require(isIdentifier(enumeration.name), "an enumeration has a name");
  for (const Enumerator& value : enumeration.values)
    require(isIdentifier(value.name), "a value has a name");
}

void checkNames(const ProtoFile& file) {
  require(isIdentifier(file.package), "a package has a name");
  for (const Enumeration& enumeration : file.enumerations)
    checkNames(enumeration);
  for (const MessageType& message : file.messages) {
    require(isIdentifier(message.name), "a message has a name");
    for (const Enumeration& enumeration : message.enumerations)
      checkNames(enumeration);
    for (const Field& field : message.fields)
      require(isIdentifier(propertyOf(field)) && isIdentifier(elementOf(field)), "an accessor has a name");
  }
}

/// A comment of the schema ends in the code where it ends in the schema.
void checkGenerated(const std::string& code) {
  for (std::size_t end = code.find('\n'); end != std::string::npos; end = code.find('\n', end + 1)) {
    const std::size_t last = code.find_last_not_of(" \t\n", end);
    require(last == std::string::npos || code[last] != '\\', "no line of code goes on in the next one");
  }
  require(code.find('\r') == std::string::npos, "every compiler sees the same lines");
}

void checkSchema(const std::string& source) {
  ProtoFile file;
  try {
    file = load(source);
  } catch (const SchemaError& error) {
    checkError(error.text(), source);
    return;
  }
  checkNames(file);
  const std::string header = emitHeader(file);
  const std::string code = emitSource(file);
  checkGenerated(header);
  checkGenerated(code);

  const ProtoFile again = load(written(file));
  require(emitHeader(again) == header && emitSource(again) == code, "a schema that is written and read is the same");
}

}  // namespace

}  // namespace messagegen

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  messagegen::checkSchema(std::string(reinterpret_cast<const char*>(data), size));
  return 0;
}
