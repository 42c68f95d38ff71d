// The signals the battery feeds: a full-scale (0 dBFS) mixture of a sine
// sweep and white noise, reproducible from a seed, and the comparisons of
// what comes out.
#pragma once

#include <cstdint>
#include <random>
#include <string>
#include <vector>

namespace plugcore {

using BatteryRandom = std::mt19937;

// Writes frames samples of the full-scale test signal for one channel,
// continuing from position (frames already generated on that channel).
void fill_test_signal(float* samples, int frames, int channel, long position, double sample_rate);

// A fixed stereo input of frames samples per channel: the test signal.
std::vector<std::vector<float>> fixed_input(int frames, double sample_rate);

// Empty when a and b are equal bit for bit, else where they first differ.
std::string first_difference(const std::vector<std::vector<float>>& a,
                             const std::vector<std::vector<float>>& b);

// 10^(dB/20).
float db_to_amplitude(double db);

}  // namespace plugcore
