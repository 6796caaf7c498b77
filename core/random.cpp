#include "core/random.h"

#include <chrono>

namespace kavu {

SplitMix64 SplitMix64::FromClock() {
  const auto ticks = std::chrono::high_resolution_clock::now().time_since_epoch().count();
  return SplitMix64(static_cast<std::uint64_t>(ticks));
}

double SplitMix64::Next() {
  state_ += 0x9E3779B97F4A7C15ULL;
  std::uint64_t z = state_;
  z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ULL;
  z = (z ^ (z >> 27)) * 0x94D049BB133111EBULL;
  z ^= z >> 31;
  return static_cast<double>(z >> 11) * 0x1.0p-53;
}

}  // namespace kavu
