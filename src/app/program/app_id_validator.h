#pragma once

#include <cstdint>
#include <optional>

#include "values/value.h"

namespace vesk {

/// Tells whether an event is meant for this application.
class AppIDValidator {
 public:
  /// True when the dictionary has this application's identifier, as an integer, under corvik::kKeyAppID.
  bool isForThisApplication(const Dictionary& event);

  /// The identifier that was found last; absent when there was none.
  [[nodiscard]] std::optional<std::int64_t> appID() const { return appID_; }

 private:
  static constexpr std::int64_t myAppID = 2;

  std::optional<std::int64_t> appID_;
};

}  // namespace vesk
