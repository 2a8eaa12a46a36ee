#pragma once

#include <cstdint>

namespace vesk {

/// How many bytes the program has asked operator new for since its start. A program that links allocations.cpp counts.
[[nodiscard]] std::uint64_t allocatedBytes();

}  // namespace vesk
