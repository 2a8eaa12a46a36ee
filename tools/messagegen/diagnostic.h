#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace messagegen {

/// A place in a source text, both counted from 1.
struct Position {
  std::size_t line = 1;
  std::size_t column = 1;
};

/// The one way in which a fault of the schema is told:
///   lte.proto:3:12: expected ';', got '}'
///     optional uint32 earfcn }
///                            ^
/// Thrown from wherever the fault is found up to main, since nothing can be generated after it.
class SchemaError {
 public:
  SchemaError(std::string_view path, std::string_view source, Position position, std::string_view message);

  [[nodiscard]] const std::string& text() const { return text_; }

 private:
  std::string text_;
};

}  // namespace messagegen
