#pragma once

#include <array>
#include <bit>
#include <cstdint>

namespace vesk::handset {

/// The chance in the model: the same numbers for the same seed, whatever the compiler and its library.
class Random {
 public:
  explicit Random(std::uint64_t seed) {
    for (std::uint64_t& word : state_)
      word = splitMix(seed);
  }

  /// 64 random bits (xoshiro256**).
  std::uint64_t next() {
    const std::uint64_t result = std::rotl(state_[1] * 5, 7) * 9;
    const std::uint64_t shifted = state_[1] << 17;
    state_[2] ^= state_[0];
    state_[3] ^= state_[1];
    state_[1] ^= state_[2];
    state_[0] ^= state_[3];
    state_[2] ^= shifted;
    state_[3] = std::rotl(state_[3], 45);
    return result;
  }

  /// At least 0, below 1.
  double uniform() { return static_cast<double>(next() >> 11) * 0x1p-53; }
  double between(double low, double high) { return low + (high - low) * uniform(); }
  /// Below `count`, which must not be 0.
  std::uint32_t below(std::uint32_t count) { return static_cast<std::uint32_t>((next() >> 32) * count >> 32); }
  bool chance(double probability) { return uniform() < probability; }

  /// Mean 0, deviation 1: the sum of twelve uniform numbers, which needs no function of the mathematical library and
  /// never leaves -6 to 6.
  double normal() {
    double sum = -6;
    for (int count = 0; count < 6; ++count) {
      const std::uint64_t bits = next();
      sum += (static_cast<double>(bits >> 32) + static_cast<double>(bits & 0xFFFFFFFF)) * 0x1p-32;
    }
    return sum;
  }

 private:
  static std::uint64_t splitMix(std::uint64_t& seed) {
    std::uint64_t mixed = seed += 0x9E3779B97F4A7C15;
    mixed = (mixed ^ mixed >> 30) * 0xBF58476D1CE4E5B9;
    mixed = (mixed ^ mixed >> 27) * 0x94D049BB133111EB;
    return mixed ^ mixed >> 31;
  }

  std::array<std::uint64_t, 4> state_;
};

}  // namespace vesk::handset
