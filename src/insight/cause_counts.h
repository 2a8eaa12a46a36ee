#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

#include "values/text.h"

namespace vesk::insight {

/// How often something happened, by cause. Short names; "NONE" where no cause was given.
class CauseCounts {
 public:
  void add(const std::optional<Text>& cause);

  [[nodiscard]] std::uint64_t total() const { return total_; }
  [[nodiscard]] const std::map<std::string, std::uint64_t, std::less<>>& byCause() const { return byCause_; }

 private:
  /// More than the enumerations have. Numbers beyond them, which only damage brings, are told apart up to here.
  static constexpr std::size_t kMostCauses = 256;

  std::map<std::string, std::uint64_t, std::less<>> byCause_;
  std::uint64_t total_ = 0;
};

}  // namespace vesk::insight
