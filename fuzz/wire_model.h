#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "values/value.h"

namespace vesk {

/// The rules of the wire told a second time, slowly, over the .proto files as they stand: the dictionary form of the
/// message of that class in `payload`; absent when it is no encoding of one. Shares no code with the codec and the
/// generated classes, which must agree with it on every payload.
[[nodiscard]] std::optional<Dictionary> modelledDictionary(std::string_view className,
                                                           std::span<const std::uint8_t> payload);

}  // namespace vesk
