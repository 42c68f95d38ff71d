// The built-in demo signal: three bars of a band at 120 bpm — bass line, kick,
// snare, hi-hat and a strummed plucked-string guitar — synthesised in code so
// every render starts from the same audio without shipping a sample file.
#pragma once

#include <vector>

namespace basic {

constexpr double kDemoSeconds = 6.0;
constexpr double kDemoPeakDbfs = -6.0;

struct StereoSignal {
  std::vector<float> left;
  std::vector<float> right;
};

// kDemoSeconds of stereo audio at sample_rate, peak normalised to
// kDemoPeakDbfs. Deterministic: the same rate always gives the same samples.
StereoSignal make_demo_signal(double sample_rate);

}  // namespace basic
