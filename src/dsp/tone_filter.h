#pragma once

#include "dsp/biquad_section.h"

// Output tone control: four second-order sections that run from a
// high-frequency shelf (shape up to 0.5) through an eighth-order low-pass
// (just above 0.5) to a resonant low-pass (1).
class ToneFilter {
 public:
  static const int kSectionCount = 4;

  // Redesigns the sections; inactive (shape 0 or frequency too close to
  // Nyquist) keeps the old coefficients. Sections are cleared when the filter
  // comes back on.
  void recompute(float tone_freq, float shape, float sample_rate);
  bool is_active() const { return active_; }
  // In place, only while active.
  void process(float* buf, int n);
  void reset();

  const BiquadSection& section(int i) const { return sections_[i]; }

 private:
  BiquadSection sections_[kSectionCount];
  bool active_ = false;
};
