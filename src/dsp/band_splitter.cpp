#include "dsp/band_splitter.h"

#include <cmath>
#include <utility>

namespace {
const double kPi = 3.14159265358979323846;
const float kHighestSplit = 20000.0f;
const float kBandOffset = 9.313225746154785e-10f;  // 2^-30
const float kSumOffset = 1e-20f;
}  // namespace

BandSplitter::BandSplitter() {
  // Two sections with the damping of a fourth-order Butterworth low-pass.
  const float p[2] = {float(2.0 * std::cos(kPi / 8.0)), float(2.0 * std::cos(3.0 * kPi / 8.0))};
  for (int k = 0; k < kCrossoverCount; ++k) {
    for (int i = 0; i < 2; ++i) {
      TypedBiquadSection& s = sections_[k][i];
      s.set_type(TypedBiquadSection::kLowPass);
      s.set_p(p[i]);
      s.set_q(1.0f);
      s.set_type_coefs();
      s.compute_coefs();
    }
  }
}

void BandSplitter::recompute(const float split[3], float sample_rate) {
  for (int k = 0; k < kCrossoverCount; ++k) split_freq_[k] = split[k];
  const int old_count = band_count_;

  int count = 1;
  while (count < kMaxBands && split_freq_[count - 1] <= kHighestSplit) ++count;

  const float f_max = 0.475f * sample_rate;
  float s[3] = {split_freq_[0], split_freq_[1], split_freq_[2]};
  if (count == 4) {
    if (s[1] < s[0]) std::swap(s[0], s[1]);
    if (s[2] < s[1]) std::swap(s[1], s[2]);
    if (s[2] > f_max) count = 3;
  }
  if (count >= 3) {
    if (s[1] < s[0]) std::swap(s[0], s[1]);
    if (s[1] > f_max) count = 2;
  }
  if (s[0] > f_max) count = 1;
  band_count_ = count;

  for (int k = 0; k <= count - 2; ++k) {
    for (int i = 0; i < 2; ++i) {
      TypedBiquadSection& sec = sections_[k][i];
      sec.set_sample_rate(sample_rate);
      sec.set_frequency(s[k]);
      sec.set_type_coefs();
      sec.compute_coefs();
    }
  }
  // A crossover coming back into use must not carry stale state.
  for (int k = old_count - 1; k <= count - 2; ++k) {
    if (k < 0) continue;
    sections_[k][0].reset();
    sections_[k][1].reset();
  }
}

void BandSplitter::low_pass(int crossover, const float* in, float* out, int n) {
  sections_[crossover][0].process_offset(in, out, n);
  sections_[crossover][1].process_offset(out, out, n);
}

void BandSplitter::split(const float* x, float* const bands[kMaxBands], int n) {
  float* b0 = bands[0];
  float* b1 = bands[1];
  float* b2 = bands[2];
  float* b3 = bands[3];
  switch (band_count_) {
    case 1:
      if (b0 != x)
        for (int i = 0; i < n; ++i) b0[i] = x[i];
      break;
    case 2:
      low_pass(0, x, b0, n);
      for (int i = 0; i < n; ++i) b1[i] = x[i] - b0[i];
      break;
    case 3:
      low_pass(1, x, b1, n);
      for (int i = 0; i < n; ++i) b2[i] = x[i] - b1[i];
      low_pass(0, b1, b0, n);
      for (int i = 0; i < n; ++i) b1[i] = b1[i] - b0[i];
      break;
    default:
      low_pass(1, x, b1, n);
      for (int i = 0; i < n; ++i) b3[i] = x[i] - b1[i];
      low_pass(0, b1, b0, n);
      for (int i = 0; i < n; ++i) b1[i] = b1[i] - b0[i];
      low_pass(2, b3, b2, n);
      for (int i = 0; i < n; ++i) b3[i] = b3[i] - b2[i];
      break;
  }
  if (n <= 0) return;
  for (int b = 0; b < band_count_; ++b) bands[b][0] += kBandOffset;
}

void BandSplitter::sum(float* const bands[kMaxBands], int m) {
  float* b0 = bands[0];
  const float* b1 = bands[1];
  const float* b2 = bands[2];
  const float* b3 = bands[3];
  switch (band_count_) {
    case 2:
      for (int i = 0; i < m; ++i) b0[i] = b1[i] + b0[i];
      break;
    case 3:
      for (int i = 0; i < m; ++i) b0[i] = b2[i] + b1[i] + b0[i];
      break;
    case 4:
      for (int i = 0; i < m; ++i) b0[i] = b2[i] + b1[i] + b3[i] + b0[i];
      break;
    default:
      break;
  }
  if (m <= 0) return;
  for (int b = 0; b < band_count_; ++b) bands[b][m / 2] += kSumOffset;
}

void BandSplitter::reset() {
  for (int k = 0; k <= band_count_ - 2; ++k) {
    sections_[k][0].reset();
    sections_[k][1].reset();
  }
}
