#pragma once

#include <string_view>
#include <vector>

#include "support/bytes.h"
#include "values/value.h"

namespace vesk {

enum class Filling { small, extreme };

/// A message with every field set, made from the schema without the help of its class.
struct FilledMessage {
  Bytes payload;
  /// Where each field of the payload ends, the last one at the payload's end.
  std::vector<std::size_t> fieldEnds;
  Dictionary dictionary;
};

[[nodiscard]] FilledMessage filledMessage(std::string_view className, Filling filling);

}  // namespace vesk
