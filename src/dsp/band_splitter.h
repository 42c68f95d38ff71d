#pragma once

#include "dsp/biquad_section.h"

// Splits a signal into one to four bands that add up to it again (each upper
// band is a signal minus its low-passed part), and sums the bands back.
class BandSplitter {
 public:
  static const int kMaxBands = 4;
  static const int kCrossoverCount = kMaxBands - 1;

  BandSplitter();

  // Split points in parameter order; one at or above the highest split
  // frequency removes the bands from there up, one above 0.475 times the
  // sample rate removes bands from the top. Crossovers newly in use are cleared.
  void recompute(const float split[3], float sample_rate);
  // Fills bands 0..band count - 1 with n samples; x must not be a band buffer
  // unless the band count is 1.
  void split(const float* x, float* const bands[kMaxBands], int n);
  // Adds the upper bands into band 0 over m samples.
  void sum(float* const bands[kMaxBands], int m);
  // Clears the crossovers in use.
  void reset();

  int get_band_count() const { return band_count_; }
  // Crossover k (0..2) is the split between bands k and k + 1.
  const TypedBiquadSection& section(int crossover, int i) const { return sections_[crossover][i]; }

 private:
  void low_pass(int crossover, const float* in, float* out, int n);

  TypedBiquadSection sections_[kCrossoverCount][2];
  float split_freq_[kCrossoverCount] = {20480.0f, 20480.0f, 20480.0f};
  int band_count_ = 1;
};
