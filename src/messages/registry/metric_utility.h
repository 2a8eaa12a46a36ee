#pragma once

#include <cstdint>
#include <string_view>

namespace vesk {

/// The fixed table of the metric identifiers, in their 16-bit form.
class KBBMetricUtility {
 public:
  /// Whether `tag` is a metric identifier; says so in the system log when it is. The class of the message
  /// that asks plays no part. May be asked from any thread.
  [[nodiscard]] static bool isValidMetricIdTag(std::uint64_t tag, std::string_view messageClass);
};

}  // namespace vesk
