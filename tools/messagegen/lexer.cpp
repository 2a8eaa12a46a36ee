#include "lexer.h"

#include <algorithm>
#include <cctype>

namespace messagegen {

namespace {

bool isDigit(char c) {
  return std::isdigit(static_cast<unsigned char>(c)) != 0;
}
bool isWordStart(char c) {
  return std::isalpha(static_cast<unsigned char>(c)) != 0 || c == '_';
}
bool isWordPart(char c) {
  return isWordStart(c) || isDigit(c);
}
bool isControl(char c) {
  return std::iscntrl(static_cast<unsigned char>(c)) != 0 && c != '\t';
}
/// A name may be qualified, and is one token then.
bool isNamePart(char c) {
  return isWordPart(c) || c == '.';
}

constexpr std::string_view kSymbols = "{}[]()<>=;,-";

}  // namespace

std::string Token::shown() const {
  std::string quoted = "'" + std::string(text) + "'";
  switch (kind) {
    case TokenKind::identifier:
      return "identifier " + quoted;
    case TokenKind::integer:
      return "number " + quoted;
    case TokenKind::string:
      return "string \"" + std::string(text) + "\"";
    case TokenKind::symbol:
      return quoted;
    case TokenKind::end:
      break;
  }
  return "end of file";
}

char Lexer::peek(std::size_t ahead) const {
  return offset_ + ahead < source_.size() ? source_[offset_ + ahead] : '\0';
}

void Lexer::advance(std::size_t count) {
  for (; count > 0; --count) {
    if (source_[offset_++] == '\n') {
      ++position_.line;
      position_.column = 1;
    } else {
      ++position_.column;
    }
  }
}

std::string Lexer::takeLineComment() {
  const std::size_t end = std::min(source_.find('\n', offset_), source_.size());
  std::string_view text = source_.substr(offset_ + 2, end - offset_ - 2);
  if (text.starts_with(' ')) text.remove_prefix(1);
  if (text.ends_with('\r')) text.remove_suffix(1);
  // It becomes a comment of the generated code, and must end there where it ends here.
  if (std::any_of(text.begin(), text.end(), isControl)) fail(position_, "a comment with a control character");
  if (text.substr(0, text.find_last_not_of(" \t") + 1).ends_with('\\'))
    fail(position_, "a comment that ends in a backslash");
  advance(end - offset_);
  return std::string(text);
}

void Lexer::skipBlockComment() {
  const std::size_t end = source_.find("*/", offset_ + 2);
  if (end == std::string_view::npos) fail(position_, "a comment that never ends");
  advance(end + 2 - offset_);
}

std::vector<std::string> Lexer::skipToToken() {
  std::vector<std::string> comment;
  std::size_t lineFeeds = 0;
  // What stands behind a token on its line says nothing of the next one.
  bool isBehindToken = offset_ > 0;
  while (offset_ < source_.size()) {
    if (peek() == '/' && peek(1) == '/') {
      std::string line = takeLineComment();
      if (!isBehindToken) comment.push_back(std::move(line));
      lineFeeds = 0;
    } else if (peek() == '/' && peek(1) == '*') {
      skipBlockComment();
    } else if (std::isspace(static_cast<unsigned char>(peek())) != 0) {
      if (peek() == '\n') {
        isBehindToken = false;
        if (++lineFeeds > 1) comment.clear();
      }
      advance();
    } else {
      break;
    }
  }
  return comment;
}

Token Lexer::next() {
  std::vector<std::string> comment = skipToToken();
  Token token{TokenKind::end, {}, position_, std::move(comment)};
  if (offset_ == source_.size()) return token;

  const char first = peek();
  std::size_t size = 1;
  if (isWordStart(first)) {
    token.kind = TokenKind::identifier;
    while (isNamePart(peek(size)))
      ++size;
  } else if (isDigit(first)) {
    token.kind = TokenKind::integer;
    while (isWordPart(peek(size)))
      ++size;
  } else if (first == '"') {
    token.kind = TokenKind::string;
    while (peek(size) != '"') {
      if (peek(size) == '\0' || peek(size) == '\n') fail(position_, "a string that never ends");
      ++size;
    }
    token.text = source_.substr(offset_ + 1, size - 1);
    advance(size + 1);
    return token;
  } else if (kSymbols.find(first) != std::string_view::npos) {
    token.kind = TokenKind::symbol;
  } else {
    fail(position_, "unexpected character '" + std::string(1, first) + "'");
  }
  token.text = source_.substr(offset_, size);
  advance(size);
  return token;
}

void Lexer::fail(Position position, std::string_view message) const {
  throw SchemaError(path_, source_, position, message);
}

}  // namespace messagegen
