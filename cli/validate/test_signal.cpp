#include "cli/validate/test_signal.h"

#include <cmath>
#include <cstring>

namespace plugcore {
namespace {

constexpr double kPi = 3.14159265358979323846;

// A cheap hash of position and channel: noise that does not depend on the
// order in which blocks are asked for.
float noise_at(long position, int channel) {
  uint32_t x = static_cast<uint32_t>(position) * 2654435761u ^ static_cast<uint32_t>(channel) * 40503u;
  x ^= x >> 15;
  x *= 2246822519u;
  x ^= x >> 13;
  x *= 3266489917u;
  x ^= x >> 16;
  return static_cast<float>(x) / 2147483647.5f - 1.0f;
}

}  // namespace

void fill_test_signal(float* samples, int frames, int channel, long position, double sample_rate) {
  for (int n = 0; n < frames; ++n) {
    const long t = position + n;
    // Alternates every 4096 samples between a sweep (55 Hz to 5 kHz over ~2 s)
    // and full-scale noise, so both tonal and broadband material is driven.
    if ((t / 4096) % 2 == 0) {
      const double seconds = static_cast<double>(t) / sample_rate;
      const double phase = 2.0 * kPi * 55.0 * (std::exp(seconds * 2.25) - 1.0) / 2.25;
      samples[n] = static_cast<float>(std::sin(phase + channel * 0.5));
    } else {
      samples[n] = noise_at(t, channel);
    }
  }
}

std::vector<std::vector<float>> fixed_input(int frames, double sample_rate) {
  std::vector<std::vector<float>> input(2, std::vector<float>(static_cast<size_t>(frames)));
  for (int channel = 0; channel < 2; ++channel) {
    fill_test_signal(input[static_cast<size_t>(channel)].data(), frames, channel, 0, sample_rate);
  }
  return input;
}

std::string first_difference(const std::vector<std::vector<float>>& a,
                             const std::vector<std::vector<float>>& b) {
  if (a.size() != b.size()) {
    return "channel counts differ (" + std::to_string(a.size()) + " and " +
           std::to_string(b.size()) + ")";
  }
  for (size_t channel = 0; channel < a.size(); ++channel) {
    if (a[channel].size() != b[channel].size()) {
      return "lengths differ on channel " + std::to_string(channel);
    }
    for (size_t n = 0; n < a[channel].size(); ++n) {
      if (std::memcmp(&a[channel][n], &b[channel][n], sizeof(float)) != 0) {
        return "channel " + std::to_string(channel) + " sample " + std::to_string(n) + ": " +
               std::to_string(a[channel][n]) + " vs " + std::to_string(b[channel][n]);
      }
    }
  }
  return "";
}

float db_to_amplitude(double db) { return static_cast<float>(std::pow(10.0, db / 20.0)); }

}  // namespace plugcore
