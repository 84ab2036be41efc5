#pragma once

#include <cstdint>
#include <vector>

namespace discart {

constexpr int kSampleRate = 22050;

// A soft wooden tick for every command: 16-bit mono samples.
std::vector<int16_t> SynthesiseClick();
// The start-up tune: a harp flourish, a bell phrase over a warm pad, a rolled closing chord.
std::vector<int16_t> SynthesiseStartupMusic();

}  // namespace discart
