#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "diagnostic.h"

namespace messagegen {

enum class TokenKind { identifier, integer, string, symbol, end };

struct Token {
  TokenKind kind;
  /// As written; a string without its quotes.
  std::string_view text;
  Position position;
  /// The lines of the comment that stands directly above, without their slashes.
  std::vector<std::string> comment;

  /// "identifier 'earfcn'", "';'", "end of file".
  [[nodiscard]] std::string shown() const;
};

/// Cuts a .proto text into tokens. The path and the source must outlive it.
class Lexer {
 public:
  Lexer(std::string_view path, std::string_view source) : path_(path), source_(source) {}

  /// Throws SchemaError on a character or a string that cannot be part of a token.
  Token next();

  [[noreturn]] void fail(Position position, std::string_view message) const;

 private:
  [[nodiscard]] char peek(std::size_t ahead = 0) const;
  void advance(std::size_t count = 1);
  [[nodiscard]] std::vector<std::string> skipToToken();
  [[nodiscard]] std::string takeLineComment();
  void skipBlockComment();

  std::string_view path_;
  std::string_view source_;
  std::size_t offset_ = 0;
  Position position_;
};

}  // namespace messagegen
