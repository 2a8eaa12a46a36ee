#include "diagnostic.h"

namespace messagegen {

namespace {

std::string_view lineOf(std::string_view source, std::size_t line) {
  for (; line > 1; --line)
    source.remove_prefix(source.find('\n') + 1);
  return source.substr(0, source.find('\n'));
}

}  // namespace

SchemaError::SchemaError(std::string_view path, std::string_view source, Position position, std::string_view message) {
  text_ += path;
  text_ += ':' + std::to_string(position.line) + ':' + std::to_string(position.column) + ": ";
  text_ += message;
  text_ += '\n';
  text_ += lineOf(source, position.line);
  text_ += '\n' + std::string(position.column - 1, ' ') + "^\n";
}

}  // namespace messagegen
