// The run's pseudo-random generator (SplitMix64): seeded from the clock, or
// from a fixed seed so that a run can be repeated.
#pragma once

#include <cstdint>

namespace kavu {

class SplitMix64 {
 public:
  SplitMix64() = default;
  explicit SplitMix64(std::uint64_t seed) : state_(seed) {}
  static SplitMix64 FromClock();
  // Uniform in [0, 1).
  double Next();

 private:
  std::uint64_t state_ = 0;
};

}  // namespace kavu
