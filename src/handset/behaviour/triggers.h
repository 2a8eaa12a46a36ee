#pragma once

#include <cstdint>

namespace vesk::handset {

/// What the service is asked for the SIM files with.
inline constexpr std::int64_t kSimFilesTrigger = 0x7F0013;
/// What the handset raises by itself.
inline constexpr std::int64_t kHandoverTrigger = 0x7F0101;
inline constexpr std::int64_t kTechnologyChangeTrigger = 0x7F0102;

}  // namespace vesk::handset
