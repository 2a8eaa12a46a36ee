#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <utility>

#include "values/shared_bytes.h"

namespace vesk {

/// An immutable byte string, one pointer wide, shared by its copies.
class Data {
 public:
  Data() = default;
  static Data copy(std::span<const std::uint8_t> bytes) {
    return Data(SharedBytes::copy({reinterpret_cast<const char*>(bytes.data()), bytes.size()}));
  }

  [[nodiscard]] std::span<const std::uint8_t> bytes() const {
    const std::string_view view = bytes_.view();
    return {reinterpret_cast<const std::uint8_t*>(view.data()), view.size()};
  }

  friend bool operator==(const Data&, const Data&) = default;

 private:
  explicit Data(SharedBytes bytes) : bytes_(std::move(bytes)) {}

  SharedBytes bytes_;
};

}  // namespace vesk
