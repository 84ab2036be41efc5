#pragma once

#include <cstdint>

namespace discart {

// Small seeded generator: the same seed gives the same pictures on every machine, which the
// standard library's distributions do not promise.
class Random {
  public:
    explicit Random(uint64_t seed) : state(seed) {}
    uint64_t Next();
    // Uniform in [0, 1).
    float Unit();
    float Range(float lo, float hi) { return lo + (hi - lo) * Unit(); }

  private:
    uint64_t state;
};

// Deterministic hash of a lattice point into [0, 1).
float Hash2(int x, int y, uint32_t seed);
// Smoothly interpolated lattice noise in [0, 1).
float ValueNoise(float x, float y, uint32_t seed);
// Sum of octaves of value noise, normalised to [0, 1).
float Fbm(float x, float y, int octaves, uint32_t seed);

}  // namespace discart
